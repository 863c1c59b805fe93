#include "template_sbml.h"

#include <sbml/SBMLTypes.h>
#include <sbml/math/L3Parser.h>

#include <array>
#include <cmath>
#include <cstdlib>
#include <memory>
#include <optional>
#include <set>
#include <string_view>
#include <variant>

#include "analysis/declared_values.h"
#include "analysis/symbol_index.h"
#include "analysis/unit_text.h"
#include "core/template_core.h"
#include "expr/expression_shape.h"
#include "expr/function_reference.h"
#include "platform/ascii.h"

namespace tessal::bench {

namespace {

/// Functions of the catalogue that SBML has a word for; `$1`, `$2` are the arguments.
struct FunctionWord {
  std::string_view name;
  std::string_view before;
  std::string_view after;
};
constexpr FunctionWord kFunctionWords[] = {
    {"ABS", "abs(", ")"},     {"EXP", "exp(", ")"},   {"LN", "ln(", ")"},
    {"SQRT", "sqrt(", ")"},   {"POW", "pow(", ")"},   {"SQR", "pow(", ", 2)"},
    {"FLOOR", "floor(", ")"}, {"CEIL", "ceil(", ")"}, {"LOG", "log10(", ")"},
};

struct FunctionBody {
  std::string_view name;
  std::string_view lambda;
};
constexpr FunctionBody kFunctionBodies[] = {
    {"MICHAELIS_MENTEN1", "lambda(c, k, c/(c + k))"},
    {"MICHAELIS_MENTEN2", "lambda(c, k, c*c/(c*c + k))"},
    {"LAMBERT_BEER_AVR", "lambda(l, d, e, l*(1 - exp(-e*d))/(e*d))"},
};

template <class Row, std::size_t count>
const Row* RowOf(const Row (&rows)[count], std::string_view name) {
  for (const Row& row : rows) {
    if (row.name == name) return &row;
  }
  return nullptr;
}

constexpr std::array<UnitKind_t, kBaseUnits> kBaseKinds = {
    UNIT_KIND_SECOND, UNIT_KIND_METRE, UNIT_KIND_KILOGRAM, UNIT_KIND_AMPERE,
    UNIT_KIND_KELVIN, UNIT_KIND_MOLE,  UNIT_KIND_CANDELA};

class SbmlMaking final {
 public:
  explicit SbmlMaking(const TemplateCore& converted)
      : core(converted), index(core), document(3, 1), model(*document.createModel()) {
    model.setId("converted");
    UnitDefinition& day = *model.createUnitDefinition();
    day.setId("day");
    AddUnit(day, UNIT_KIND_SECOND, 1, 86400);
    model.setTimeUnits("day");
  }

  TemplateSbml Make() {
    for (const SymbolRecord& record : core.SymbolTable()) {
      if (IsHeld(record)) AddParameter(record);
    }
    for (const SymbolRecord& record : core.SymbolTable()) {
      if (IsHeld(record) && record.expression != nullptr) AddRule(record);
    }
    const std::unique_ptr<char, decltype(&std::free)> text(writeSBMLToString(&document), &std::free);
    made.text = text.get();
    return std::move(made);
  }

 private:
  static bool IsHeld(const SymbolRecord& record) {
    return record.kind >= ElementKind::StateVariable && record.kind <= ElementKind::DerivedOutput;
  }

  static std::string IdOf(const SymbolRecord& record) {
    std::string id = RecordSymbol(record);
    for (char& character : id) {
      if (character == ' ') character = '_';
    }
    return id;
  }

  static void AddUnit(UnitDefinition& definition, UnitKind_t kind, double exponent, double multiplier) {
    ::Unit& unit = *definition.createUnit();
    unit.setKind(kind);
    unit.setExponent(exponent);
    unit.setScale(0);
    unit.setMultiplier(multiplier);
  }

  /// The id of the unit of a text; empty where it can not be read.
  std::string UnitId(std::string_view text) {
    const tessal::Unit* read = reader.Read(text);
    if (read == nullptr) return {};
    const auto [place, isNew] =
        unitIds.try_emplace(std::string(text), "unit_" + std::to_string(unitIds.size()));
    if (!isNew) return place->second;
    UnitDefinition& definition = *model.createUnitDefinition();
    definition.setId(place->second);
    // The factor goes into the first base unit.
    double factor = std::exp(read->logFactor);
    for (std::size_t base = 0; base < kBaseUnits; ++base) {
      const double power = read->powers[base];
      if (power == 0) continue;
      AddUnit(definition, kBaseKinds[base], power, std::pow(factor, 1 / power));
      factor = 1;
    }
    if (definition.getNumUnits() == 0) AddUnit(definition, UNIT_KIND_DIMENSIONLESS, 1, factor);
    return place->second;
  }

  Parameter& NewParameter(const std::string& id, std::string_view unitText) {
    Parameter& parameter = *model.createParameter();
    parameter.setId(id);
    parameter.setConstant(false);
    const std::string unit = UnitId(unitText);
    if (!unit.empty()) parameter.setUnits(unit);
    return parameter;
  }

  void AddParameter(const SymbolRecord& record) {
    Parameter& parameter = NewParameter(IdOf(record), DeclaredUnit(*record.element).value_or(""));
    if (record.expression == nullptr) parameter.setConstant(record.kind == ElementKind::Constant);
    if (const auto value = DeclaredValueOf(*record.element)) parameter.setValue(value->value);
  }

  void AddRule(const SymbolRecord& record) {
    const RecordExpression expression = ExpressionOf(record);
    const std::optional<std::string> formula =
        expression.tree == nullptr ? std::nullopt : FormulaOf(*expression.tree);
    const std::unique_ptr<ASTNode> math(formula ? SBML_parseL3FormulaWithModel(formula->c_str(), &model)
                                                : nullptr);
    if (math == nullptr) {
      made.leftOut.push_back(RecordSymbol(record));
      return;
    }
    Rule* rule = nullptr;
    if (record.kind == ElementKind::StateVariable) {
      rule = model.createRateRule();
    } else {
      rule = model.createAssignmentRule();
    }
    rule->setVariable(IdOf(record));
    rule->setMath(math.get());
    made.sequences[IdOf(record)] = record.sequence;
  }

  /// The expression in libSBML's own language; none where SBML has no word for a part of it.
  std::optional<std::string> FormulaOf(const ExpressionNode& tree) {
    std::string formula;
    std::vector<Piece> open{&tree};
    while (!open.empty()) {
      const Piece piece = open.back();
      open.pop_back();
      if (const auto* text = std::get_if<std::string>(&piece)) {
        formula += *text;
        continue;
      }
      std::vector<Piece> pieces;
      if (!TakeApart(*std::get<const ExpressionNode*>(piece), pieces)) return std::nullopt;
      open.insert(open.end(), pieces.rbegin(), pieces.rend());
    }
    return formula;
  }

  using Piece = std::variant<const ExpressionNode*, std::string>;

  bool TakeApart(const ExpressionNode& node, std::vector<Piece>& pieces) {
    switch (node.Kind()) {
      case NodeKind::Identifier:
      case NodeKind::Number:
        pieces = {std::string(node.Text())};
        return true;
      case NodeKind::Arithmetic:
        pieces = {"(", node.Child(1), std::string(node.Text()), node.Child(2), ")"};
        return true;
      case NodeKind::Negate:
        pieces = {"(-", node.Child(1), ")"};
        return true;
      case NodeKind::Comparison:
        pieces = ConditionOf(node);
        return true;
      case NodeKind::Conditional: {
        const Branches branches = BranchesOf(node);
        pieces = {"piecewise(", &branches.then, ", ", &branches.condition, ", ", &branches.otherwise, ")"};
        return true;
      }
      case NodeKind::Call:
        return TakeCallApart(node, pieces);
      default:
        return false;
    }
  }

  static std::vector<Piece> ConditionOf(const ExpressionNode& node) {
    const std::optional<Logic> logic = LogicOf(node);
    if (!logic) return {"(", node.Child(1), std::string(node.Text()), node.Child(2), ")"};
    if (logic->which == Logic::Operator::Not) return {"(!", &logic->left, ")"};
    return {"(", &logic->left, logic->which == Logic::Operator::And ? "&&" : "||", &logic->right, ")"};
  }

  bool TakeCallApart(const ExpressionNode& node, std::vector<Piece>& pieces) {
    const std::string name = UpperCase(node.Text());
    const FunctionWord* word = RowOf(kFunctionWords, name);
    const FunctionBody* body = RowOf(kFunctionBodies, name);
    if (word == nullptr && body == nullptr) return TakeResult(name, pieces);
    if (body != nullptr && functions.insert(name).second) {
      FunctionDefinition& definition = *model.createFunctionDefinition();
      definition.setId(name);
      const std::unique_ptr<ASTNode> lambda(SBML_parseL3Formula(std::string(body->lambda).c_str()));
      definition.setMath(lambda.get());
    }
    pieces.emplace_back(word != nullptr ? std::string(word->before) : name + "(");
    bool isFirst = true;
    for (const ExpressionNode* argument : ArgumentsOf(node)) {
      if (!isFirst) pieces.emplace_back(", ");
      isFirst = false;
      pieces.emplace_back(argument);
    }
    pieces.emplace_back(word != nullptr ? std::string(word->after) : ")");
    return true;
  }

  /// Puts a parameter in the place of a call.
  bool TakeResult(const std::string& name, std::vector<Piece>& pieces) {
    const FunctionReference* function = ReferenceOfFunction(name);
    if (function == nullptr) return false;
    const std::optional<UnitRule> rule = RuleOfUnit(*function, function->resultUnit);
    if (!rule || rule->kind != UnitRule::Kind::Fixed) return false;
    const std::string id = "result_of_" + name;
    if (functions.insert(id).second) NewParameter(id, rule->unit);
    pieces = {id};
    return true;
  }

  const TemplateCore& core;
  SymbolIndex index;
  SBMLDocument document;
  Model& model;
  UnitReader reader;
  std::map<std::string, std::string> unitIds;
  std::set<std::string> functions;
  TemplateSbml made;
};

}  // namespace

TemplateSbml ToSbml(const TemplateCore& core) {
  return SbmlMaking(core).Make();
}

}  // namespace tessal::bench
