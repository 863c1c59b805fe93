#include "cli/finding_report.h"

#include <nlohmann/json.hpp>
#include <optional>

#include "cli/element_index.h"
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
  explicit Places(const TemplateCore& placed) : core(placed), elements(placed) {}

  FilePlace Of(const AnalysisFinding& finding) {
    if (!lines) lines.emplace(core.SourceText());
    const std::string_view part = PartOf(finding);
    const FilePlace place = part.empty() ? FilePlace{} : lines->PlaceOf(part);
    return place.line > 0 ? place : lines->PlaceOfLine(finding.line);
  }

 private:
  /// The part of the field's text that the finding is about.
  std::string_view PartOf(const AnalysisFinding& finding) {
    if (finding.field.empty()) return {};
    const CEL_Element* element = elements.Find(finding.element);
    const PropertyPlace place = element == nullptr ? nullptr : element->PlaceWithLabel(finding.field);
    if (place == nullptr) return {};
    const CEL_Property& property = element->*place;
    if (property.Type() != ValueType::Expression) return property.Text();
    const std::string_view text = StripExpressionQuotes(property.Text());
    if (finding.place.length == 0 || finding.place.start > text.size()) return text;
    return text.substr(finding.place.start, finding.place.length);
  }

  const TemplateCore& core;
  std::optional<FileLines> lines;
  ElementIndex elements;
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
                               .place = message.place});
  }
  for (const UndefinedName& undefined : messages.undefined) {
    const Finding finding("undefined-symbol", {undefined.symbol});
    for (const UndefinedName::User& user : undefined.usedBy) {
      report.findings.push_back({.code = finding.message->code,
                                 .level = static_cast<std::uint32_t>(finding.message->level),
                                 .symbol = user.symbol,
                                 .text = finding.text,
                                 .place = user.place});
    }
  }
  for (std::size_t index = 0; index < messages.account.size(); ++index) {
    AccountEntry& entry = messages.account[index];
    const bool isPlaced = index < messages.accountPlaces.size();
    report.findings.push_back({.code = entry.code,
                               .level = kNotice,
                               .symbol = std::move(entry.symbol),
                               .text = std::move(entry.text),
                               .place = isPlaced ? messages.accountPlaces[index] : FilePlace{entry.line},
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

void PrintReport(Format format, std::span<const FileReport> files, const ReportSource& source) {
  switch (format) {
    case Format::Json:
      return PrintJson(files);
    case Format::Sarif:
      return PrintSarif(files, source);
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
