// What is wrong with a template file, collected for printing.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "elements/element_kind.h"
#include "elements/load_account.h"
#include "platform/uid.h"

namespace tessal::cli {

struct TemplateMessage {
  std::uint32_t level;
  std::string_view code;
  std::string word;
  std::string symbol;
  Uid uid;
  ElementKind kind;  ///< the element's
  int line;          ///< of the element's sub-section or of the place in the file, from 1; 0 for none
  std::string text;
};

struct UndefinedName {
  struct User {
    std::string symbol;
    int line;  ///< of its sub-section, from 1; 0 for none
  };

  std::string symbol;
  std::vector<User> usedBy;
};

struct TemplateMessages {
  std::string path;
  bool loaded = false;
  std::vector<TemplateMessage> errors;
  std::vector<UndefinedName> undefined;
  std::vector<AccountEntry> account;

  /// Whether the template has no message; what is in the account alone is no fault of it.
  bool IsClean() const { return errors.empty() && undefined.empty(); }
};

/// Loads a file as the editor does, and lists its messages from a level up. One that repeats another to the
/// letter is left out.
TemplateMessages CollectMessages(const std::string& file, int lowestLevel);

/// Bytes as JSON can hold them.
std::string JsonText(const std::string& bytes);

}  // namespace tessal::cli
