// What all analyses that judge a template find in it: units, mass balance and lint.
#pragma once

#include <vector>

#include "analysis/analysis_finding.h"

namespace tessal {

class TemplateCore;

/// The findings of each analysis after those of the one before. Pools are those of the template, and
/// substances in units count for nothing.
std::vector<AnalysisFinding> AllFindings(const TemplateCore& core);

}  // namespace tessal
