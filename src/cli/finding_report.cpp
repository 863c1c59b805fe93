#include "cli/finding_report.h"

#include <nlohmann/json.hpp>
#include <optional>
#include <unordered_map>

#include "cli/file_lines.h"
#include "cli/report_formats.h"
#include "cli/sarif.h"
#include "core/template_core.h"

namespace tessal::cli {

namespace {

using Json = nlohmann::ordered_json;

constexpr auto kNotice = static_cast<std::uint32_t>(ErrorLevel::Notice);

/// Finds the places of findings, and reads the lines of the file only when one asks for them.
class Places final {
 public:
  explicit Places(const TemplateCore& placed) : core(placed) {}

  FilePlace Of(const AnalysisFinding& finding) {
    const std::string_view part = PartOf(finding);
    if (!part.empty()) {
      if (!lines) lines.emplace(core.SourceText());
      const FilePlace place = lines->PlaceOf(part);
      if (place.line > 0) return place;
    }
    return {finding.line, 0, 0};
  }

 private:
  /// The part of the field's text that the finding is about.
  std::string_view PartOf(const AnalysisFinding& finding) {
    if (finding.field.empty()) return {};
    const CEL_Element* element = ElementOf(finding.element);
    const PropertyPlace place = element == nullptr ? nullptr : element->PlaceWithLabel(finding.field);
    if (place == nullptr) return {};
    const CEL_Property& property = element->*place;
    if (property.Type() != ValueType::Expression) return property.Text();
    const std::string_view text = StripExpressionQuotes(property.Text());
    if (finding.place.length == 0 || finding.place.start > text.size()) return text;
    return text.substr(finding.place.start, finding.place.length);
  }

  const CEL_Element* ElementOf(Uid uid) {
    if (elements.empty()) {
      for (const SymbolRecord& record : core.SymbolTable()) elements.emplace(record.uid, record.element);
    }
    const auto hit = elements.find(uid);
    return hit == elements.end() ? nullptr : hit->second;
  }

  const TemplateCore& core;
  std::optional<FileLines> lines;
  std::unordered_map<Uid, const CEL_Element*> elements;
};

void PrintText(const FileReport& file) {
  for (const ReportedFinding& finding : file.findings) {
    PrintLine(OnOneLine(file.path) + ": " + Coloured(LevelWord(finding.level), finding.level) + ": " +
              OnOneLine(Named(finding)));
  }
}

Json ToJson(const FileReport& file) {
  Json errors = Json::array();
  for (const ReportedFinding& finding : file.findings) {
    errors.push_back({{"level", finding.level},
                      {"word", LevelWord(finding.level)},
                      {"code", finding.code},
                      {"symbol", JsonText(finding.symbol)},
                      {"uid", NumberOf(finding.uid)},
                      {"kind", NumberOf(finding.kind)},
                      {"text", JsonText(finding.text)},
                      {"line", finding.place.line},
                      {"column", finding.place.column}});
  }
  return {{"path", JsonText(file.path)}, {"loaded", file.loaded}, {"errors", errors}};
}

void PrintJson(std::span<const FileReport> files) {
  Json list = Json::array();
  for (const FileReport& file : files) list.push_back(ToJson(file));
  PrintLine(Json{{"files", list}}.dump());
}

}  // namespace

FileReport ReportOf(TemplateMessages messages) {
  FileReport report{std::move(messages.path), messages.loaded, {}};
  for (TemplateMessage& message : messages.errors) {
    report.findings.push_back({.code = message.code,
                               .level = message.level,
                               .symbol = std::move(message.symbol),
                               .text = std::move(message.text),
                               .uid = message.uid,
                               .kind = message.kind,
                               .place = {message.line, 0, 0}});
  }
  for (const UndefinedName& undefined : messages.undefined) {
    const Finding finding("undefined-symbol", {undefined.symbol});
    for (const UndefinedName::User& user : undefined.usedBy) {
      report.findings.push_back({.code = finding.message->code,
                                 .level = static_cast<std::uint32_t>(finding.message->level),
                                 .symbol = user.symbol,
                                 .text = finding.text,
                                 .place = {user.line, 0, 0}});
    }
  }
  for (AccountEntry& entry : messages.account) {
    report.findings.push_back({.code = entry.code,
                               .level = kNotice,
                               .symbol = std::move(entry.symbol),
                               .text = std::move(entry.text),
                               .place = {entry.line, 0, 0},
                               .isFault = false});
  }
  return report;
}

FileReport ReportOf(std::string path, const TemplateCore& core, std::span<const AnalysisFinding> findings) {
  FileReport report{std::move(path), true, {}};
  Places places(core);
  report.findings.reserve(findings.size());
  for (const AnalysisFinding& finding : findings) {
    report.findings.push_back({.code = finding.message->code,
                               .level = static_cast<std::uint32_t>(finding.message->level),
                               .symbol = finding.symbol,
                               .text = finding.text,
                               .uid = finding.element,
                               .kind = finding.kind,
                               .place = places.Of(finding)});
  }
  return report;
}

std::string SymbolOf(const ReportedFinding& finding) {
  return finding.symbol.empty() ? "generic" : finding.symbol;
}

std::string Named(const ReportedFinding& finding) {
  return SymbolOf(finding) + ": " + finding.text;
}

void PrintReport(Format format, std::span<const FileReport> files, std::span<const MessageRow> rules) {
  switch (format) {
    case Format::Json:
      return PrintJson(files);
    case Format::Sarif:
      return PrintSarif(files, rules);
    case Format::Github:
      return PrintWorkflowCommands(files);
    case Format::Gitlab:
      return PrintCodeQuality(files);
    case Format::Junit:
      return PrintJunit(files);
    case Format::Gcc:
      return PrintCompilerLines(files);
    default:
      for (const FileReport& file : files) PrintText(file);
  }
}

}  // namespace tessal::cli
