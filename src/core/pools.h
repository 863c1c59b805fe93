// Pools of a template: quantities whose amount should change only at the boundary of the model, such as all
// nitrogen. They are for analyses alone. They lie in a further top-level section of the template's file,
// which every save keeps.
//
//     [TESSAL_POOLS]
//        [POOL_1]
//           NAME = 'nitrogen'
//           EXPRESSION = '"aNC*(AC1 + AC2) + DN + NH4 + NO3"'
//           BOUNDARY = 'deniW', 'setDN'
//           DESCRIPTION = ''
//        EndSect  // POOL_1
//     EndSect  // TESSAL_POOLS
#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace tessal {

class TemplateCore;

struct Pool {
  std::string name;
  std::string expression;             ///< over state variables, without quotes
  std::vector<std::string> boundary;  ///< symbols of the processes through which it comes and goes
  std::string description;

  bool operator==(const Pool&) const = default;
};

/// What reading pools gives. The pools that could be read come in their order, also when others could not.
struct PoolsRead {
  std::vector<Pool> pools;
  std::vector<std::string> faults;  ///< what could not be read, in words
  /// What the section holds beside pools, such as comments. While there is any, `SetPools` changes nothing.
  std::vector<std::string> notPools;
};

/// The pools that a template's file holds beside it.
PoolsRead PoolsOf(const TemplateCore& core);

/// The pools of a key-file text. The section may be the only one.
PoolsRead ReadPools(const std::string& text);

/// Puts pools in the place of those of the template, as one edit that can be taken back; what else lies
/// beside the template stays as it is. False, with the reason in words, when the format can not hold them.
bool SetPools(TemplateCore& core, const std::vector<Pool>& pools, std::string& failure);

}  // namespace tessal
