#include "generated_model.h"

#include <algorithm>
#include <iterator>
#include <random>

namespace tessal::bench {

namespace {

/// Draws operands. Calls are statements of their own: the order of the draws makes the model.
class Draw final {
 public:
  /// One of the first variables of a kind, or the number where there are not two.
  Operand One(std::string_view kind, int count) {
    if (count < 2) return {};
    return {kind, static_cast<int>(1 + random() % static_cast<unsigned>(count - 1))};
  }

 private:
  std::mt19937 random{1};
};

GeneratedExpression Limitation(Draw& draw, const GeneratedModel& model, int place) {
  const Operand former = draw.One(kind::kAuxiliary, place);
  const Operand scale = draw.One(kind::kConstant, model.constants);
  const Operand forcing = draw.One(kind::kForcing, model.forcings);
  const Operand slope = draw.One(kind::kConstant, model.constants);
  return {GeneratedExpression::Form::Limitation, {slope, forcing, scale, former}};
}

GeneratedExpression Threshold(Draw& draw, const GeneratedModel& model, int place) {
  const Operand former = draw.One(kind::kProcess, place);
  const Operand constant = draw.One(kind::kConstant, model.constants);
  const Operand factor = draw.One(kind::kAuxiliary, static_cast<int>(model.auxiliaries.size()));
  const Operand state = draw.One(kind::kStateVariable, model.stateVariables);
  return {GeneratedExpression::Form::Threshold, {state, factor, constant, former}};
}

GeneratedExpression Balance(Draw& draw, const GeneratedModel& model) {
  const int processes = static_cast<int>(model.processes.size());
  const Operand loss = draw.One(kind::kProcess, processes);
  const Operand gain = draw.One(kind::kProcess, processes);
  return {GeneratedExpression::Form::Balance, {gain, loss, {}, {}}};
}

void AppendOperand(std::string& text, const Operand& operand, const Dialect& dialect) {
  if (operand.place == 0) {
    text.append(dialect.numberStart).append("1.5").append(dialect.numberEnd);
  } else {
    text.append(dialect.nameStart).append(NameOf(operand.kind, operand.place)).append(dialect.nameEnd);
  }
}

}  // namespace

std::string NameOf(std::string_view kind, int place) {
  return std::string(kind) + std::to_string(place);
}

std::string DescriptionOf(const std::string& name) {
  return "What " + name + " means in the model";
}

std::string Write(const GeneratedExpression& expression, const Dialect& dialect) {
  std::string text;
  std::string_view rest = dialect.patterns[static_cast<std::size_t>(expression.form)];
  for (std::size_t mark = rest.find('$'); mark != std::string_view::npos; mark = rest.find('$')) {
    text.append(rest.substr(0, mark));
    AppendOperand(text, expression.operands[static_cast<std::size_t>(rest[mark + 1] - '1')], dialect);
    rest.remove_prefix(mark + 2);
  }
  return text.append(rest);
}

std::vector<std::string> NamesIn(const GeneratedExpression& expression) {
  std::vector<std::string> names;
  for (const Operand& operand : expression.operands) {
    if (operand.place == 0) continue;
    std::string name = NameOf(operand.kind, operand.place);
    if (std::find(names.begin(), names.end(), name) == names.end()) names.push_back(std::move(name));
  }
  return names;
}

GeneratedModel::GeneratedModel(int elements)
    : stateVariables(elements * 6 / 100), constants(elements * 30 / 100), forcings(elements * 14 / 100) {
  const int others = elements * 25 / 100;
  Draw draw;
  for (int place = 1; place <= others; ++place) auxiliaries.push_back(Limitation(draw, *this, place));
  for (int place = 1; place <= others; ++place) processes.push_back(Threshold(draw, *this, place));
  for (int place = 1; place <= stateVariables; ++place) equations.push_back(Balance(draw, *this));
}

GeneratedModel GeneratedModel::OfConstants(int count) {
  GeneratedModel model(0);
  model.constants = count;
  return model;
}

std::vector<GeneratedExpression> GeneratedModel::Expressions() const {
  std::vector<GeneratedExpression> all;
  for (const auto* part : {&auxiliaries, &processes, &equations}) {
    std::copy(part->begin(), part->end(), std::back_inserter(all));
  }
  return all;
}

}  // namespace tessal::bench
