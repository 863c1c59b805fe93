// What shells offer while a call is typed: commands, options, the words that options take, and templates or
// files where the call has a place for them.
#pragma once

#include <string>

#include "manual/option_tree.h"

namespace tessal::manual {

std::string BashCompletion(const Command& program);
std::string ZshCompletion(const Command& program);
std::string FishCompletion(const Command& program);

}  // namespace tessal::manual
