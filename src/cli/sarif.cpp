#include "cli/sarif.h"

#include <algorithm>
#include <array>
#include <map>
#include <nlohmann/json.hpp>
#include <string_view>

#include "cli/explanation.h"
#include "cli/output.h"
#include "cli/report_formats.h"

namespace tessal::cli {

namespace {

using Json = nlohmann::ordered_json;

/// The levels of the format, by those of messages.
constexpr std::array<const char*, 5> kLevels = {"warning", "note", "warning", "error", "error"};

const char* LevelOf(std::uint32_t messageLevel) {
  return messageLevel < kLevels.size() ? kLevels[messageLevel] : "warning";
}

/// The code as a name: "syntax-error" is SyntaxError.
std::string NameOf(std::string_view code) {
  std::string name;
  bool isStart = true;
  for (const char character : code) {
    if (character != '-') name += isStart ? static_cast<char>(character - 'a' + 'A') : character;
    isStart = character == '-';
  }
  return name;
}

/// What code hosts sort and filter by.
Json RulePropertiesOf(const MessageRow& row, std::string_view command) {
  constexpr std::array<const char*, 5> kSeverities = {"warning", "recommendation", "warning", "error",
                                                      "error"};
  return {{"tags", Json::array({command, "template"})},
          {"precision", "very-high"},
          {"problem.severity", kSeverities[static_cast<std::size_t>(row.level)]}};
}

Json RuleOf(const MessageRow& row, std::string_view command) {
  const std::string meaning(row.meaning);
  return {{"id", row.code},
          {"name", NameOf(row.code)},
          {"shortDescription", {{"text", meaning}}},
          {"fullDescription", {{"text", meaning + " " + std::string(row.remedy)}}},
          {"help", {{"text", HelpText(row)}, {"markdown", HelpMarkdown(row)}}},
          {"defaultConfiguration", {{"level", LevelOf(static_cast<std::uint32_t>(row.level))}}},
          {"properties", RulePropertiesOf(row, command)}};
}

/// A path as a reference of RFC 3986: everything but unreserved characters and the separator is encoded.
std::string UriOf(std::string_view path) {
  constexpr std::string_view kPlain = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789-._~/";
  constexpr std::string_view kHex = "0123456789ABCDEF";
  constexpr unsigned kDigitBits = 4;
  constexpr unsigned kDigitMask = 15;
  std::string uri = path.starts_with('/') ? "file://" : "";
  for (const char character : path) {
    if (kPlain.find(character) != std::string_view::npos) {
      uri += character;
      continue;
    }
    const auto byte = static_cast<unsigned char>(character);
    uri += '%';
    uri += kHex[byte >> kDigitBits];
    uri += kHex[byte & kDigitMask];
  }
  return uri;
}

constexpr const char* kSourceRoot = "%SRCROOT%";

/// A relative path counts from the folder that the tool ran in, which a report is read in the root of.
Json ArtifactOf(const std::string& path) {
  std::string_view shortened = path;
  while (shortened.starts_with("./")) shortened.remove_prefix(2);
  Json artifact = {{"uri", UriOf(shortened)}};
  if (!path.starts_with('/')) artifact["uriBaseId"] = kSourceRoot;
  return artifact;
}

Json RegionOf(const FilePlace& place) {
  Json region = {{"startLine", std::max(place.line, 1)}};
  if (place.column > 0) region["startColumn"] = place.column;
  if (place.endColumn > 0) region["endColumn"] = place.endColumn;
  return region;
}

Json ResultOf(const ReportedFinding& finding, const std::string& path, const std::string& fingerprint,
              int rule) {
  const Json location = {
      {"physicalLocation", {{"artifactLocation", ArtifactOf(path)}, {"region", RegionOf(finding.place)}}}};
  // The number is -1 for a code without a rule, as the format has it.
  return {{"ruleId", finding.code},
          {"ruleIndex", rule},
          {"level", LevelOf(finding.level)},
          {"message", {{"text", JsonText(Named(finding))}}},
          {"locations", Json::array({location})},
          {"partialFingerprints", {{"primaryLocationLineHash", fingerprint}}}};
}

constexpr int kIndent = 2;

/// Prints the results one after the other as the elements of a list whose brackets are there.
class ResultPrinter final {
 public:
  explicit ResultPrinter(std::span<const MessageRow> rules) {
    for (const MessageRow& row : rules) ruleNumbers.emplace(row.code, static_cast<int>(ruleNumbers.size()));
  }

  void PrintResults(const FileReport& file) {
    std::map<std::string, std::size_t> met;
    for (const ReportedFinding& finding : file.findings) {
      // Lines move when a file is edited; a finding is the same as long as its code and its symbol are.
      const std::string identity = FingerprintOf(std::string(finding.code) + '\0' + finding.symbol);
      PrintResult(ResultOf(finding, file.path, identity + ":" + std::to_string(++met[identity]),
                           RuleOfCode(finding.code)));
    }
  }

  /// Ends the list's last line.
  void End() const {
    if (!isFirst) Print(std::string("\n") + kOuterMargin);
  }

 private:
  static constexpr const char* kOuterMargin = "      ";
  static constexpr const char* kMargin = "\n        ";

  int RuleOfCode(std::string_view code) const {
    const auto hit = ruleNumbers.find(code);
    return hit == ruleNumbers.end() ? -1 : hit->second;
  }

  void PrintResult(const Json& result) {
    if (!isFirst) Print(",");
    isFirst = false;
    Print(kMargin);
    // A text in JSON has no line feeds: each is one between the lines of the result.
    const std::string text = result.dump(kIndent);
    std::size_t start = 0;
    for (std::size_t end = 0; (end = text.find('\n', start)) != std::string::npos; start = end + 1) {
      Print(std::string_view(text).substr(start, end - start));
      Print(kMargin);
    }
    Print(std::string_view(text).substr(start));
  }

  std::map<std::string_view, int> ruleNumbers;
  bool isFirst = true;
};

}  // namespace

void PrintSarif(std::span<const FileReport> files, const ReportSource& source) {
  Json listed = Json::array();
  for (const MessageRow& row : source.rules) listed.push_back(RuleOf(row, source.command));
  const Json driver = {{"name", "tessal"},
                       {"version", TESSAL_VERSION},
                       {"semanticVersion", TESSAL_VERSION},
                       {"rules", listed}};
  const bool allLoaded =
      std::all_of(files.begin(), files.end(), [](const FileReport& file) { return file.loaded; });
  const Json root = {{"description", {{"text", "The folder that tessal was called in."}}}};
  const Json run = {{"tool", {{"driver", driver}}},
                    {"invocations", Json::array({{{"executionSuccessful", allLoaded}}})},
                    {"automationDetails", {{"id", "tessal/" + std::string(source.command) + "/"}}},
                    {"originalUriBaseIds", {{kSourceRoot, root}}},
                    {"columnKind", "unicodeCodePoints"},
                    {"results", Json::array()}};
  const Json log = {{"$schema", "https://json.schemastore.org/sarif-2.1.0.json"},
                    {"version", "2.1.0"},
                    {"runs", Json::array({run})}};
  const std::string text = log.dump(kIndent);
  constexpr std::string_view kNoResults = "\"results\": []";
  const std::size_t place = text.rfind(kNoResults) + kNoResults.size() - 1;
  Print(std::string_view(text).substr(0, place));
  ResultPrinter printer(source.rules);
  for (const FileReport& file : files) printer.PrintResults(file);
  printer.End();
  PrintLine(std::string_view(text).substr(place));
}

}  // namespace tessal::cli
