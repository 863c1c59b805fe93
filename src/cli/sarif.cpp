#include "cli/sarif.h"

#include <algorithm>
#include <array>
#include <nlohmann/json.hpp>
#include <string_view>

namespace tessal::cli {

namespace {

using Json = nlohmann::ordered_json;

/// A rule for each kind of message, by the word that people see.
struct Rule {
  std::uint32_t messageLevel;
  const char* id;
  const char* description;
  const char* level;
};

constexpr std::uint32_t kUndefinedLevel = 0;

constexpr std::array<Rule, 5> kRules = {{
    {kUndefinedLevel, "undefined-symbol", "An expression uses a name that nothing defines.", "warning"},
    {1, "notice", "Something to know.", "note"},
    {2, "warning", "A check of an element or of a rule found something wrong.", "warning"},
    {3, "critical", "The order of declarations, a missing key, or a use across particle classes.", "error"},
    {4, "fatal", "The file could not be loaded.", "error"},
}};

const Rule& RuleOf(std::uint32_t messageLevel) {
  const auto hit = std::find_if(kRules.begin(), kRules.end(), [messageLevel](const Rule& rule) {
    return rule.messageLevel == messageLevel;
  });
  return hit == kRules.end() ? kRules[2] : *hit;
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

Json ResultOf(const Rule& rule, const std::string& path, int line, const std::string& text) {
  const Json location = {
      {"physicalLocation",
       {{"artifactLocation", {{"uri", UriOf(path)}}}, {"region", {{"startLine", std::max(line, 1)}}}}}};
  return {{"ruleId", rule.id},
          {"level", rule.level},
          {"message", {{"text", JsonText(text)}}},
          {"locations", Json::array({location})}};
}

}  // namespace

std::string SarifText(const std::vector<TemplateMessages>& files) {
  Json rules = Json::array();
  for (const Rule& rule : kRules) {
    rules.push_back({{"id", rule.id}, {"shortDescription", {{"text", rule.description}}}});
  }
  Json results = Json::array();
  for (const TemplateMessages& file : files) {
    for (const TemplateMessage& message : file.errors) {
      const std::string symbol = message.symbol.empty() ? "generic" : message.symbol;
      results.push_back(
          ResultOf(RuleOf(message.level), file.path, message.line, symbol + ": " + message.text));
    }
    for (const UndefinedName& undefined : file.undefined) {
      for (const UndefinedName::User& user : undefined.usedBy) {
        results.push_back(ResultOf(RuleOf(kUndefinedLevel), file.path, user.line,
                                   user.symbol + ": Undefined symbol " + undefined.symbol));
      }
    }
  }
  const Json driver = {{"name", "tessal"}, {"version", TESSAL_VERSION}, {"rules", rules}};
  const Json run = {{"tool", {{"driver", driver}}}, {"results", results}};
  const Json log = {{"$schema", "https://json.schemastore.org/sarif-2.1.0.json"},
                    {"version", "2.1.0"},
                    {"runs", Json::array({run})}};
  return log.dump(2);
}

}  // namespace tessal::cli
