#include "core/error_registry.h"

#include <utility>

namespace tessal {

void ErrorRegistry::Report(std::string_view symbol, Uid uid, const Finding& finding) {
  Append({static_cast<std::uint32_t>(finding.message->level), std::string(symbol), uid, finding.text, 0,
          finding.message->code, finding.name});
}

void ErrorRegistry::ReportInFile(std::string_view symbol, int line, const Finding& finding) {
  Append({static_cast<std::uint32_t>(finding.message->level), std::string(symbol), kNoElement, finding.text,
          line, finding.message->code, finding.name});
}

void ErrorRegistry::ReportCheck(std::string_view symbol, Uid uid, const Finding& finding) {
  Report(symbol, uid, finding);
  ++expressionWarningCount;
}

void ErrorRegistry::AddError(std::uint32_t level, std::string_view symbol, Uid uid, std::string_view text) {
  Append({level, std::string(symbol), uid, std::string(text), 0, kOtherCode});
}

void ErrorRegistry::AddError(ErrorLevel level, std::string_view symbol, Uid uid, std::string_view text) {
  AddError(static_cast<std::uint32_t>(level), symbol, uid, text);
}

void ErrorRegistry::Append(ErrorRecord record) {
  if (record.level >= 1 && record.level <= kLevels) ++counts[record.level - 1];
  records.push_back(std::move(record));
}

void ErrorRegistry::ReportElementError(std::string_view symbol, Uid uid, std::string_view text) {
  AddError(ErrorLevel::Warning, symbol, uid, text);
  ++expressionWarningCount;
}

void ErrorRegistry::ClearErrors() {
  records.clear();
  counts.fill(0);
}

std::size_t ErrorRegistry::GetErrorCount(std::uint32_t level) const {
  return level >= 1 && level <= kLevels ? counts[level - 1] : records.size();
}

bool ErrorRegistry::GetError(std::size_t index, std::uint32_t& level, std::string& symbol, Uid& uid,
                             std::string& text) const {
  if (index >= records.size()) return false;
  const ErrorRecord& record = records[index];
  level = record.level;
  symbol = record.symbol;
  uid = record.uid;
  text = record.text;
  return true;
}

bool ErrorRegistry::FormatError(std::size_t index, std::string& text) const {
  if (index >= records.size()) {
    text = "invalid error number!";
    return false;
  }
  const ErrorRecord& record = records[index];
  // The word is glued to the text: people search their logs for this form.
  text = std::string(LevelWord(record.level)) + record.text;
  if (IsElement(record.uid)) {
    text += " symbol \"" + record.symbol + "\" ( UID=" + std::to_string(NumberOf(record.uid)) + ")";
  }
  return true;
}

std::string ErrorRegistry::JoinErrors() const {
  std::string joined;
  std::string line;
  for (std::size_t index = 0; index < records.size(); ++index) {
    FormatError(index, line);
    joined += line;
    joined += '\n';
  }
  return joined;
}

void ErrorRegistry::GetErrorForList(std::size_t index, std::string& symbol, Uid& uid,
                                    std::string& text) const {
  if (index >= records.size()) {
    symbol.clear();
    uid = kNoElement;
    text = "no errors";
    return;
  }
  const ErrorRecord& record = records[index];
  symbol = record.symbol;
  uid = IsElement(record.uid) ? record.uid : kNoElement;
  text = std::string(LevelWord(record.level)) + ": " + record.text;
}

void ErrorRegistry::Reset() {
  ClearErrors();
  expressionWarningCount = 0;
}

ErrorRegistry& Errors() {
  static ErrorRegistry registry;
  return registry;
}

}  // namespace tessal
