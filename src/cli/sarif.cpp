#include "cli/sarif.h"

#include <algorithm>
#include <array>
#include <nlohmann/json.hpp>
#include <string_view>

#include "cli/explanation.h"

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

void AddResults(Json& results, const TemplateMessages& file) {
  for (const TemplateMessage& message : file.errors) {
    const std::string symbol = message.symbol.empty() ? "generic" : message.symbol;
    results.push_back(
        ResultOf(message.code, message.level, file.path, message.line, symbol + ": " + message.text));
  }
  for (const UndefinedName& undefined : file.undefined) {
    const Finding finding("undefined-symbol", {undefined.symbol});
    for (const UndefinedName::User& user : undefined.usedBy) {
      results.push_back(ResultOf(finding.message->code, static_cast<std::uint32_t>(finding.message->level),
                                 file.path, user.line, user.symbol + ": " + finding.text));
    }
  }
}

}  // namespace

std::string SarifText(const std::vector<TemplateMessages>& files) {
  Json rules = Json::array();
  for (const MessageRow& row : AllMessages()) rules.push_back(RuleOf(row));
  Json results = Json::array();
  for (const TemplateMessages& file : files) AddResults(results, file);
  const Json driver = {{"name", "tessal"}, {"version", TESSAL_VERSION}, {"rules", rules}};
  const Json run = {{"tool", {{"driver", driver}}}, {"results", results}};
  const Json log = {{"$schema", "https://json.schemastore.org/sarif-2.1.0.json"},
                    {"version", "2.1.0"},
                    {"runs", Json::array({run})}};
  return log.dump(2);
}

}  // namespace tessal::cli
