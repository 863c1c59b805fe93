#include "core/explanation.h"

namespace tessal {

std::string_view LevelWordOf(const MessageRow& row) {
  return row.level == ErrorLevel::Undefined ? kUndefinedWord
                                            : LevelWord(static_cast<std::uint32_t>(row.level));
}

std::string_view MessageText(const MessageRow& row) {
  return row.text.ends_with('\n') ? row.text.substr(0, row.text.size() - 1) : row.text;
}

std::string HelpText(const MessageRow& row) {
  return "Example: " + std::string(row.example) + "\nRemedy: " + std::string(row.remedy);
}

std::string ExplanationText(const MessageRow& row) {
  return std::string(row.code) + ": " + std::string(LevelWordOf(row)) + ": " + std::string(MessageText(row)) +
         "\nMeaning: " + std::string(row.meaning) + '\n' + HelpText(row);
}

}  // namespace tessal
