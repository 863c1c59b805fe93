#include "cli/sarif.h"

#include <algorithm>
#include <array>
#include <nlohmann/json.hpp>
#include <string_view>

#include "cli/explanation.h"
#include "cli/output.h"

namespace tessal::cli {

namespace {

using Json = nlohmann::ordered_json;

/// The levels of the format, by those of messages.
constexpr std::array<const char*, 5> kLevels = {"warning", "note", "warning", "error", "error"};

const char* LevelOf(std::uint32_t messageLevel) {
  return messageLevel < kLevels.size() ? kLevels[messageLevel] : "warning";
}

Json RuleOf(const MessageRow& row) {
  const std::string meaning(row.meaning);
  return {{"id", row.code},
          {"shortDescription", {{"text", meaning}}},
          {"fullDescription", {{"text", meaning + " " + std::string(row.remedy)}}},
          {"help", {{"text", HelpText(row)}, {"markdown", HelpMarkdown(row)}}},
          {"defaultConfiguration", {{"level", LevelOf(static_cast<std::uint32_t>(row.level))}}}};
}

/// A path as a reference of RFC 3986: everything but unreserved characters and the separator is encoded.
std::string UriOf(const std::string& path) {
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

Json ResultOf(std::string_view code, std::uint32_t level, const std::string& path, int line,
              const std::string& text) {
  const Json location = {
      {"physicalLocation",
       {{"artifactLocation", {{"uri", UriOf(path)}}}, {"region", {{"startLine", std::max(line, 1)}}}}}};
  return {{"ruleId", code},
          {"level", LevelOf(level)},
          {"message", {{"text", JsonText(text)}}},
          {"locations", Json::array({location})}};
}

/// What a text begins with: the symbol that it is about.
std::string Named(const std::string& symbol) {
  return (symbol.empty() ? "generic" : symbol) + ": ";
}

constexpr int kIndent = 2;

/// Prints the results one after the other as the elements of a list whose brackets are there.
class ResultPrinter final {
 public:
  void PrintResults(const TemplateMessages& file) {
    for (const TemplateMessage& message : file.errors) {
      PrintResult(ResultOf(message.code, message.level, file.path, message.line,
                           Named(message.symbol) + message.text));
    }
    for (const UndefinedName& undefined : file.undefined) {
      const Finding finding("undefined-symbol", {undefined.symbol});
      for (const UndefinedName::User& user : undefined.usedBy) {
        PrintResult(ResultOf(finding.message->code, static_cast<std::uint32_t>(finding.message->level),
                             file.path, user.line, Named(user.symbol) + finding.text));
      }
    }
    for (const AccountEntry& entry : file.account) {
      PrintResult(ResultOf(entry.code, static_cast<std::uint32_t>(ErrorLevel::Notice), file.path, entry.line,
                           Named(entry.symbol) + entry.text));
    }
  }

  /// Ends the list's last line.
  void End() const {
    if (!isFirst) Print(std::string("\n") + kOuterMargin);
  }

 private:
  static constexpr const char* kOuterMargin = "      ";
  static constexpr const char* kMargin = "\n        ";

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

  bool isFirst = true;
};

}  // namespace

void PrintSarif(const std::vector<TemplateMessages>& files) {
  Json rules = Json::array();
  for (const MessageRow& row : AllMessages()) rules.push_back(RuleOf(row));
  const Json driver = {{"name", "tessal"}, {"version", TESSAL_VERSION}, {"rules", rules}};
  const Json run = {{"tool", {{"driver", driver}}}, {"results", Json::array()}};
  const Json log = {{"$schema", "https://json.schemastore.org/sarif-2.1.0.json"},
                    {"version", "2.1.0"},
                    {"runs", Json::array({run})}};
  const std::string text = log.dump(kIndent);
  constexpr std::string_view kNoResults = "\"results\": []";
  const std::size_t place = text.rfind(kNoResults) + kNoResults.size() - 1;
  Print(std::string_view(text).substr(0, place));
  ResultPrinter printer;
  for (const TemplateMessages& file : files) printer.PrintResults(file);
  printer.End();
  PrintLine(std::string_view(text).substr(place));
}

}  // namespace tessal::cli
