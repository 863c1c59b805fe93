// What is found out about a template beyond its form: units, mass balance, likely slips, and which process
// changes what.
#pragma once

#include <string>
#include <vector>

#include "tessal/export.h"
#include "tessal/message.h"

namespace tessal {
inline namespace v1 {

class Template;

/// Units that do not go together.
TESSAL_API std::vector<TemplateMessage> UnitMessages(const Template& model);
/// The same with substances as dimensions: "mmol N" is no "mmol C".
TESSAL_API std::vector<TemplateMessage> StrictUnitMessages(const Template& model);

/// What is well formed and still most likely a slip.
TESSAL_API std::vector<TemplateMessage> LintMessages(const Template& model);

/// Whether the processes keep the amount of a pool.
enum class Verdict { Closed, Open, Unknown };

/// A process whose gains and losses of a pool do not cancel.
struct Leak {
  std::string process{};  ///< its symbol; empty for what is of no process
  std::string net{};      ///< what one unit of the process adds to the pool, as an expression
  double value = 0.0;     ///< the same at the default values
};

struct BalanceOfPool {
  std::string pool{};
  Verdict verdict = Verdict::Unknown;
  std::vector<Leak> leaks{};  ///< of an open pool
  std::string reason{};       ///< why it could not be judged
};

/// The verdict about each pool that the template's file holds.
TESSAL_API std::vector<BalanceOfPool> Balance(const Template& model);

/// Which process changes which state variable, and by which factor.
struct MatrixOfProcesses {
  std::vector<std::string> states{};                ///< the columns
  std::vector<std::string> processes{};             ///< the rows
  std::vector<std::string> rates{};                 ///< of each process its expression
  std::vector<std::vector<std::string>> factors{};  ///< by row and column, as expressions; empty for none
  std::vector<std::string> other{};  ///< of each column what is no multiple of a process; empty for nothing
};

TESSAL_API MatrixOfProcesses ProcessesOf(const Template& model);

}  // namespace v1
}  // namespace tessal
