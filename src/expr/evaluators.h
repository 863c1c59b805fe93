// The code behind the function catalogue: which evaluator computes which function.
// The catalogue takes its evaluators from this table at set-up; rows that stand in the catalogue and not here
// (they need the simulation engine) have none.
#pragma once

#include <span>
#include <string_view>

#include "expr/numeric/evaluator.h"

namespace tessal {

/// One function: its upper-case catalogue name and the code that computes it.
struct EvaluatorRow {
  std::string_view name;
  Evaluator evaluator;
};

/// All functions that can be computed, in catalogue order. An evaluator that is given fewer values than its
/// function takes answers NaN; values too many are ignored.
std::span<const EvaluatorRow> Evaluators();

}  // namespace tessal
