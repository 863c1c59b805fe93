#include "cli/lint_baseline.h"

#include <algorithm>
#include <filesystem>
#include <nlohmann/json.hpp>

#include "cli/output.h"
#include "platform/file_replacement.h"

namespace tessal::cli {

namespace {

using Json = nlohmann::ordered_json;

constexpr const char* kList = "findings";
constexpr const char* kCode = "code";
constexpr const char* kSymbol = "symbol";

bool IsEntry(const Json& item) {
  return item.is_object() && item.contains(kCode) && item[kCode].is_string() && item.contains(kSymbol) &&
         item[kSymbol].is_string();
}

bool IsBaseline(const Json& json) {
  return json.is_object() && json.contains(kList) && json[kList].is_array() &&
         std::all_of(json[kList].begin(), json[kList].end(), IsEntry);
}

}  // namespace

std::optional<LintBaseline> LintBaseline::Read(const std::string& path) {
  std::string failure;
  const std::optional<std::string> text = ReadWholeFile(path, failure);
  if (!text) {
    Complain("can not read the baseline '" + path + "': " + failure);
    return std::nullopt;
  }
  const Json json = Json::parse(*text, nullptr, false);
  if (!IsBaseline(json)) {
    Complain("'" + path + "' is no baseline: it is no JSON with a list \"" + kList +
             "\" of codes and symbols");
    return std::nullopt;
  }
  LintBaseline baseline;
  for (const Json& item : json[kList]) {
    baseline.entries.emplace(item[kCode].get<std::string>(), item[kSymbol].get<std::string>());
  }
  return baseline;
}

void LintBaseline::Add(const ReportedFinding& finding) {
  entries.emplace(finding.code, JsonText(finding.symbol));
}

void LintBaseline::Filter(FileReport& report) {
  std::erase_if(report.findings, [this](const ReportedFinding& finding) {
    const auto entry = entries.find({std::string(finding.code), JsonText(finding.symbol)});
    if (entry == entries.end()) return false;
    met.insert(*entry);
    return true;
  });
}

std::vector<std::string> LintBaseline::StaleEntries(std::span<const std::string_view> codes) const {
  std::vector<std::string> stale;
  for (const Entry& entry : entries) {
    const bool hasRun = std::find(codes.begin(), codes.end(), entry.first) != codes.end();
    if (hasRun && !met.contains(entry)) stale.push_back(entry.first + " of " + entry.second);
  }
  return stale;
}

bool LintBaseline::Write(const std::string& path) const {
  std::error_code shownByTheWriting;
  if (std::filesystem::exists(path, shownByTheWriting) && !Read(path)) return false;
  Json list = Json::array();
  for (const auto& [code, symbol] : entries) list.push_back({{kCode, code}, {kSymbol, symbol}});
  constexpr int kIndent = 2;
  const std::string failure = WriteOutputFile(path, Json{{kList, list}}.dump(kIndent) + "\n");
  if (!failure.empty()) Complain("can not write the baseline '" + path + "': " + failure);
  return failure.empty();
}

}  // namespace tessal::cli
