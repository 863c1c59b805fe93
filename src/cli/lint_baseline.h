// Findings of lint that a team lives with: a file of codes and symbols, so that only new ones are listed.
#pragma once

#include <optional>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "cli/finding_report.h"

namespace tessal::cli {

class LintBaseline final {
 public:
  /// Reads a file. None, with the reason on standard error, when it can not be read or is no baseline.
  static std::optional<LintBaseline> Read(const std::string& path);

  void Add(const ReportedFinding& finding);
  /// Takes out the findings that are in the baseline.
  void Filter(FileReport& report);
  /// The entries of the given rules that no finding had, one text each.
  std::vector<std::string> StaleEntries(std::span<const std::string_view> codes) const;
  /// Writes the file, in the place of an earlier baseline or as a new one. False, with the reason on standard
  /// error, when that fails or something else has the name.
  bool Write(const std::string& path) const;

 private:
  using Entry = std::pair<std::string, std::string>;  ///< code and symbol, in UTF-8

  std::set<Entry> entries;
  std::set<Entry> met;
};

}  // namespace tessal::cli
