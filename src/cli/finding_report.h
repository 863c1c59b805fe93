// Findings as reports show them, whether a check or an analysis made them: one list for each file, and one
// printer for each format.
#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "analysis/analysis_finding.h"
#include "cli/commands.h"
#include "cli/file_place.h"
#include "cli/template_messages.h"
#include "core/error_registry.h"
#include "core/messages.h"

namespace tessal {
class TemplateCore;
}

namespace tessal::cli {

struct ReportedFinding {
  std::string_view code;
  std::uint32_t level = 0;
  std::string symbol;  ///< empty for what is about no element
  std::string text;
  Uid uid = kNoElement;
  ElementKind kind = ElementKind::None;
  FilePlace place;
  bool isFault = true;  ///< whether it makes a call fail
};

struct FileReport {
  std::string path;
  bool loaded = true;
  std::vector<ReportedFinding> findings;
};

/// What a check found, where it was placed (see message_places.h).
FileReport ReportOf(TemplateMessages messages);

/// What an analysis found in a template that was loaded from that path. A finding about a part of an
/// expression that is as the file has it is placed there, any other at the element's section.
FileReport ReportOf(std::string path, const TemplateCore& core, std::span<const AnalysisFinding> findings);

/// The symbol that a finding is about, or a word in its place.
std::string SymbolOf(const ReportedFinding& finding);
/// The text after the symbol.
std::string Named(const ReportedFinding& finding);

/// The command that findings are of, and the rows that their codes may be of: `AllMessages()` or
/// `AnalysisMessages()`.
struct ReportSource {
  std::string_view command;
  std::span<const MessageRow> rules;
};

/// Prints the findings of all files in a format of checks.
void PrintReport(Format format, std::span<const FileReport> files, const ReportSource& source);

}  // namespace tessal::cli
