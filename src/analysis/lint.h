// Lint: what is well formed in a template and still most likely a slip, or hard to maintain.
#pragma once

#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "analysis/analysis_finding.h"

namespace tessal {

class TemplateCore;

/// The codes of the rules, in the order of their table.
std::span<const std::string_view> LintRules();

/// Which rules run.
struct LintSelection {
  std::vector<std::string> select;  ///< codes; all when empty
  std::vector<std::string> ignore;
};

/// The findings, by the order of the elements and then of the rules.
std::vector<AnalysisFinding> Lint(const TemplateCore& core, const LintSelection& selection = {});

}  // namespace tessal
