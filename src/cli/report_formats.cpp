#include "cli/report_formats.h"

#include <algorithm>
#include <array>
#include <map>
#include <nlohmann/json.hpp>

#include "platform/text_encoding.h"
#include "platform/xml_text.h"

namespace tessal::cli {

namespace {

/// The words of a format, by the levels of messages; those of no level come first.
using LevelWords = std::array<std::string_view, 5>;
constexpr LevelWords kCommandWords = {"warning", "notice", "warning", "error", "error"};
constexpr LevelWords kQualityWords = {"minor", "info", "minor", "critical", "blocker"};
constexpr LevelWords kCompilerWords = {"warning", "note", "warning", "error", "error"};

std::string WordOf(const LevelWords& words, std::uint32_t level) {
  return std::string(words[level < words.size() ? level : 0]);
}

struct Escape {
  char character;
  std::string_view text;
};
constexpr std::array<Escape, 5> kCommandEscapes = {{
    {'%', "%25"},
    {'\r', "%0D"},
    {'\n', "%0A"},
    {':', "%3A"},
    {',', "%2C"},
}};
/// Those that a command's text needs; its properties need all.
constexpr std::size_t kEscapesOfText = 3;

std::string Escaped(std::string_view bytes, std::size_t escapes) {
  std::string escaped;
  for (const char character : ToUtf8(bytes)) {
    const auto* const end = kCommandEscapes.begin() + escapes;
    const auto* const hit = std::find_if(kCommandEscapes.begin(), end, [character](const Escape& escape) {
      return escape.character == character;
    });
    if (hit == end) {
      escaped += character;
    } else {
      escaped += hit->text;
    }
  }
  return escaped;
}

std::string PropertyText(std::string_view bytes) {
  return Escaped(bytes, kCommandEscapes.size());
}

std::string CommandOf(const FileReport& file, const ReportedFinding& finding) {
  const FilePlace& place = finding.place;
  std::string command = "::" + WordOf(kCommandWords, finding.level) + " file=" + PropertyText(file.path);
  if (place.line > 0) command += ",line=" + std::to_string(place.line);
  if (place.column > 0) command += ",col=" + std::to_string(place.column);
  if (place.endColumn > 0) command += ",endColumn=" + std::to_string(place.endColumn - 1);
  return command + ",title=" + PropertyText(finding.code) + "::" + Escaped(Named(finding), kEscapesOfText);
}

std::string CaseOf(const FileReport& file, const ReportedFinding& finding) {
  std::string where = file.path;
  if (finding.place.line > 0) where += ":" + std::to_string(finding.place.line);
  const std::string text = XmlText(Named(finding));
  std::string xml = "    <testcase classname=\"" + XmlText(file.path) + "\" name=\"" + XmlText(finding.code) +
                    ": " + XmlText(SymbolOf(finding)) + "\">";
  if (finding.isFault) {
    xml += "<failure type=\"" + XmlText(LevelWord(finding.level)) + "\" message=\"" + text + "\">" +
           XmlText(where) + ": " + text + "</failure>";
  } else {
    xml += "<system-out>" + text + "</system-out>";
  }
  return xml + "</testcase>";
}

std::string CountsOf(std::size_t cases, std::size_t failures) {
  return "tests=\"" + std::to_string(cases) + "\" failures=\"" + std::to_string(failures) + "\"";
}

struct CaseCounts {
  std::size_t cases = 0;
  std::size_t failures = 0;
};

/// A file that did not load fails even without a finding.
CaseCounts CountsOf(const FileReport& file) {
  const auto faults =
      static_cast<std::size_t>(std::count_if(file.findings.begin(), file.findings.end(),
                                             [](const ReportedFinding& finding) { return finding.isFault; }));
  if (file.findings.empty()) return {1, file.loaded ? 0U : 1U};
  return {file.findings.size(), faults};
}

}  // namespace

std::string FingerprintOf(std::string_view text) {
  constexpr std::uint64_t kBasis = 0xCBF29CE484222325U;
  constexpr std::uint64_t kPrime = 0x100000001B3U;
  constexpr unsigned kBits = 64;
  constexpr unsigned kDigitBits = 4;
  std::uint64_t number = kBasis;
  for (const char character : text) number = (number ^ static_cast<unsigned char>(character)) * kPrime;
  std::string digits;
  for (unsigned shift = kBits; shift > 0; shift -= kDigitBits) {
    digits += "0123456789abcdef"[(number >> (shift - kDigitBits)) & 0xFU];
  }
  return digits;
}

void PrintWorkflowCommands(std::span<const FileReport> files) {
  for (const FileReport& file : files) {
    for (const ReportedFinding& finding : file.findings) PrintLine(CommandOf(file, finding));
  }
}

void PrintCodeQuality(std::span<const FileReport> files) {
  std::map<std::string, std::size_t> met;
  bool isFirst = true;
  Print("[");
  for (const FileReport& file : files) {
    for (const ReportedFinding& finding : file.findings) {
      const std::string identity = FingerprintOf(file.path + '\0' + std::string(finding.code) + '\0' +
                                                 finding.symbol + '\0' + finding.text);
      const std::size_t again = met[identity]++;
      const nlohmann::ordered_json issue = {
          {"description", JsonText(Named(finding))},
          {"check_name", finding.code},
          {"fingerprint", again == 0 ? identity : FingerprintOf(identity + std::to_string(again))},
          {"severity", WordOf(kQualityWords, finding.level)},
          {"location",
           {{"path", JsonText(file.path)}, {"lines", {{"begin", std::max(finding.place.line, 1)}}}}}};
      Print(isFirst ? "\n  " : ",\n  ");
      Print(issue.dump());
      isFirst = false;
    }
  }
  PrintLine(isFirst ? "]" : "\n]");
}

void PrintJunit(std::span<const FileReport> files) {
  CaseCounts all;
  for (const FileReport& file : files) {
    const CaseCounts counts = CountsOf(file);
    all.cases += counts.cases;
    all.failures += counts.failures;
  }
  PrintLine("<?xml version=\"1.0\" encoding=\"UTF-8\"?>");
  PrintLine("<testsuites name=\"tessal\" " + CountsOf(all.cases, all.failures) + ">");
  for (const FileReport& file : files) {
    const CaseCounts counts = CountsOf(file);
    PrintLine("  <testsuite name=\"" + XmlText(file.path) + "\" " + CountsOf(counts.cases, counts.failures) +
              ">");
    for (const ReportedFinding& finding : file.findings) PrintLine(CaseOf(file, finding));
    if (file.findings.empty()) {
      PrintLine("    <testcase classname=\"" + XmlText(file.path) + "\" name=\"" + XmlText(file.path) +
                (file.loaded ? "\"/>" : "\"><failure message=\"could not be loaded\"/></testcase>"));
    }
    PrintLine("  </testsuite>");
  }
  PrintLine("</testsuites>");
}

void PrintCompilerLines(std::span<const FileReport> files) {
  for (const FileReport& file : files) {
    for (const ReportedFinding& finding : file.findings) {
      std::string line = OnOneLine(file.path) + ":";
      if (finding.place.line > 0) line += std::to_string(finding.place.line) + ":";
      if (finding.place.column > 0) line += std::to_string(finding.place.column) + ":";
      PrintLine(line + " " + WordOf(kCompilerWords, finding.level) + ": " + OnOneLine(Named(finding)) + " [" +
                std::string(finding.code) + "]");
    }
  }
}

}  // namespace tessal::cli
