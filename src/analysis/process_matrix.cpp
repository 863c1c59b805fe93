#include "analysis/process_matrix.h"

#include <algorithm>
#include <map>
#include <span>

#include "analysis/declared_values.h"
#include "analysis/flows.h"
#include "analysis/symbol_index.h"
#include "core/template_core.h"

namespace tessal {

namespace {

MatrixElement Described(const CEL_Element& element) {
  return {element.GetUid(), element.symbol.TextOf(), std::string(DeclaredUnit(element).value_or("")),
          element.description.TextOf()};
}

class MatrixMaking final {
 public:
  MatrixMaking(const TemplateCore& core, MatrixProcesses whichProcesses)
      : index(core), algebra(index, Brackets::Kept), flows(algebra), processes(whichProcesses) {}

  void AddColumn(const SymbolRecord& state) {
    const std::size_t column = matrix.states.size();
    matrix.states.push_back(Described(*state.element));
    matrix.other.emplace_back();
    const RecordExpression equation = ExpressionOf(state);
    if (equation.tree == nullptr) return AddFault(column, "the equation does not parse");
    const std::optional<ProductSum> sum = algebra.Expand(equation.text, *equation.tree);
    if (!sum) return AddFault(column, algebra.Failure());
    const FlowForm form =
        FlowFormOf(algebra, processes == MatrixProcesses::Elementary ? flows.Elementary(*sum) : *sum);
    for (const auto& [flow, factor] : form.factors) {
      rows[algebra.At(flow).record->sequence].push_back({column, algebra.Text(factor)});
    }
    if (!form.rest.empty()) matrix.other.back() = algebra.Text(form.rest);
  }

  ProcessMatrix Take() {
    for (auto& [sequence, cells] : rows) {
      const SymbolRecord& process = *index.Template().FindRecordBySequence(sequence);
      matrix.rows.push_back(
          {Described(*process.element), std::move(cells), std::string(ExpressionOf(process).text)});
    }
    return std::move(matrix);
  }

 private:
  void AddFault(std::size_t column, std::string reason) {
    matrix.faults.push_back({column, std::move(reason)});
  }

  SymbolIndex index;
  Algebra algebra;
  Flows flows;
  MatrixProcesses processes;
  ProcessMatrix matrix;
  std::map<std::uint32_t, std::vector<MatrixCell>> rows;  ///< by the numbers of the records
};

template <class State>
ProcessMatrix MatrixOf(const TemplateCore& core, const Sequence<State>& states, MatrixProcesses processes) {
  MatrixMaking making(core, processes);
  for (const auto& state : states) making.AddColumn(*core.RecordOfElement(*state));
  return making.Take();
}

}  // namespace

ProcessMatrix BuildProcessMatrix(const TemplateCore& core, MatrixProcesses processes) {
  return MatrixOf(core, core.StateVariables(), processes);
}

ProcessMatrix BuildProcessMatrix(const TemplateCore& core, const CEL_Lagrange_Specie& specie,
                                 MatrixProcesses processes) {
  return MatrixOf(core, specie.stateVariables, processes);
}

}  // namespace tessal
