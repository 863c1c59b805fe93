#include "library/messages_of.h"

#include <new>
#include <string_view>

#include "analysis/analysis_finding.h"
#include "core/error_registry.h"
#include "elements/load_account.h"

namespace tessal {

namespace {

std::string WithoutLineEnd(std::string_view text) {
  while (!text.empty() && (text.back() == '\n' || text.back() == '\r')) text.remove_suffix(1);
  return std::string(text);
}

}  // namespace

std::vector<TemplateMessage> RegistryMessages() {
  static constexpr Message kOutOfMemory("out-of-memory");
  std::vector<TemplateMessage> messages;
  for (const ErrorRecord& record : Errors().Records()) {
    if (record.code == kOutOfMemory->code) throw std::bad_alloc();
    messages.push_back({static_cast<int>(record.level), std::string(record.code), record.symbol,
                        WithoutLineEnd(record.text), record.line});
  }
  return messages;
}

std::vector<TemplateMessage> LossesOf(const LoadAccount& account) {
  std::vector<TemplateMessage> messages;
  for (const AccountEntry& entry : account.Entries()) {
    if (entry.kind == AccountKind::Absent) continue;
    messages.push_back({static_cast<int>(ErrorLevel::Notice), std::string(entry.code), entry.symbol,
                        entry.text, entry.line});
  }
  return messages;
}

std::vector<TemplateMessage> MessagesOf(std::span<const AnalysisFinding> findings) {
  std::vector<TemplateMessage> messages;
  for (const AnalysisFinding& finding : findings) {
    messages.push_back({static_cast<int>(finding.message->level), std::string(finding.message->code),
                        finding.symbol, finding.text, finding.line});
  }
  return messages;
}

std::string JoinedTexts(const std::vector<TemplateMessage>& messages) {
  std::string text;
  for (const TemplateMessage& message : messages) {
    if (!text.empty()) text += '\n';
    text += message.text;
  }
  return text;
}

}  // namespace tessal
