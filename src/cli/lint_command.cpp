// Lists what lint finds in templates, but for what a baseline holds.
#include <algorithm>

#include "analysis/lint.h"
#include "cli/commands.h"
#include "cli/file_progress.h"
#include "cli/finding_report.h"
#include "cli/lint_baseline.h"
#include "cli/template_files.h"
#include "cli/template_paths.h"
#include "core/template_core.h"
#include "expr/function_reference.h"

namespace tessal::cli {

namespace {

/// Whether all codes are those of rules; a line on standard error about the first that is not.
bool AreRulesOrComplain(const std::vector<std::string>& codes) {
  const std::span<const std::string_view> rules = LintRules();
  for (const std::string& code : codes) {
    if (std::find(rules.begin(), rules.end(), code) != rules.end()) continue;
    const std::vector<std::string_view> near = NearestNames(code, rules);
    Complain("lint has no rule '" + code + "'" +
             (near.empty() ? "" : "; the nearest is '" + std::string(near.front()) + "'"));
    return false;
  }
  return true;
}

std::vector<std::string_view> RulesOf(const LintCall& call) {
  const auto has = [](const std::vector<std::string>& codes, std::string_view code) {
    return std::find(codes.begin(), codes.end(), code) != codes.end();
  };
  std::vector<std::string_view> rules;
  for (const std::string_view code : LintRules()) {
    if ((call.select.empty() || has(call.select, code)) && !has(call.ignore, code)) rules.push_back(code);
  }
  return rules;
}

FileReport LintFile(const std::string& file, const LintSelection& selection) {
  TemplateCore& core = TheTemplate();
  if (!LoadOrComplain(core, file)) return {file, false, {}};
  return ReportOf(file, core, Lint(core, selection));
}

/// All findings as a new baseline, in the place of a report.
ExitCode WriteBaseline(const std::vector<FileReport>& reports, const std::string& path) {
  LintBaseline baseline;
  for (const FileReport& report : reports) {
    if (!report.loaded) return kCallFault;
    for (const ReportedFinding& finding : report.findings) baseline.Add(finding);
  }
  return baseline.Write(path) ? kFine : kCallFault;
}

}  // namespace

ExitCode RunLint(const LintCall& call) {
  if (!AreRulesOrComplain(call.select) || !AreRulesOrComplain(call.ignore)) return kCallFault;
  const std::optional<std::vector<std::string>> files = FilesOf(call.paths);
  if (!files) return kCallFault;
  const EndsWithoutMemory end;
  std::optional<LintBaseline> baseline;
  if (!call.baseline.empty() && !(baseline = LintBaseline::Read(call.baseline))) return kCallFault;
  std::vector<FileReport> reports;
  FileProgress progress(call.isQuiet ? 0 : files->size());
  for (const std::string& file : *files) {
    progress.Next();
    reports.push_back(LintFile(file, {call.select, call.ignore}));
  }
  progress.Hide();
  if (!call.newBaseline.empty()) return WriteBaseline(reports, call.newBaseline);
  ExitCode exitCode = kFine;
  MessageCount count;
  for (FileReport& report : reports) {
    if (baseline) baseline->Filter(report);
    count.AddFile(report.findings.size());
    if (!report.findings.empty() && !call.exitZero) exitCode = Worse(exitCode, kContentFault);
    if (!report.loaded) exitCode = Worse(exitCode, kCallFault);
  }
  if (!call.isQuiet) PrintReport(call.format, reports, {"lint", AnalysisMessages()});
  if (baseline) {
    for (const std::string& entry : baseline->StaleEntries(RulesOf(call))) {
      Complain(OnOneLine("the baseline has " + entry + ", which is found no more"));
    }
  }
  if (!call.isQuiet) ShowCount(count);
  return exitCode;
}

}  // namespace tessal::cli
