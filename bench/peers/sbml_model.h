// The generated model as SBML, Level 3 Version 1 Core.
#pragma once

#include <string>

namespace tessal::bench {

struct GeneratedModel;

/// State variables are species with rate rules, constants and forcings are parameters, auxiliaries and
/// processes are parameters with assignment rules; each has its description as its name.
std::string SbmlText(const GeneratedModel& model);

}  // namespace tessal::bench
