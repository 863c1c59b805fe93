// Mass balance: whether the processes of a template keep the amount of each pool, but for those at its
// boundary. This is the continuity check of activated-sludge models for any template: Gujer, W. and Larsen,
// T. A. (1995), Water Science and Technology 31(2), 257-266; Hauduc, H. et al. (2010), Water Science and
// Technology 61(4), 825-839.
#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <vector>

#include "analysis/analysis_finding.h"
#include "core/pools.h"
#include "platform/uid.h"

namespace tessal {

class TemplateCore;

enum class PoolVerdict : std::uint8_t { Closed, Open, Unknown };

/// A process whose gains and losses of a pool do not cancel.
struct PoolLeak {
  Uid uid = Uid::None;
  std::string process;  ///< its symbol; empty for what is of no process
  std::string net;      ///< what one unit of the process adds to the pool, as an expression
  double value;         ///< the same at the default values
};

struct PoolBalance {
  std::string name;
  PoolVerdict verdict = PoolVerdict::Unknown;
  std::vector<PoolLeak> leaks;  ///< of an open pool, in the order of the template
  std::string reason;           ///< why it could not be judged
};

/// Judges each pool by algebra and, where that does not decide, by values at random points, which are the
/// same in each call.
std::vector<PoolBalance> CheckMassBalance(const TemplateCore& core, std::span<const Pool> pools);

/// The open pools as findings, each about the element of its first leak.
std::vector<AnalysisFinding> BalanceFindings(const TemplateCore& core, std::span<const PoolBalance> balances);

}  // namespace tessal
