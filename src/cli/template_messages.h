// What is wrong with a template file, collected for printing.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "cli/file_place.h"
#include "elements/element_kind.h"
#include "elements/load_account.h"
#include "platform/uid.h"

namespace tessal {
class TemplateCore;
}

namespace tessal::cli {

struct TemplateMessage {
  std::uint32_t level;
  std::string_view code;
  std::string word;
  std::string symbol;
  Uid uid;
  ElementKind kind;  ///< the element's
  FilePlace place;   ///< the line alone before `FindPlaces` (message_places.h): that of the element's section
  std::string text;
  std::string name;  ///< in an expression that it is about; empty for none
};

struct UndefinedName {
  struct User {
    std::string symbol;
    Uid uid;
    FilePlace place;              ///< of the first use; the line alone before `FindPlaces`, as above
    std::vector<FilePlace> uses;  ///< in its expressions; none before `FindPlaces`
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
  std::vector<FilePlace> accountPlaces;  ///< of its entries; none before `FindPlaces`

  /// Whether the template has no message; what is in the account alone is no fault of it.
  bool IsClean() const { return errors.empty() && undefined.empty(); }
  /// How many messages are shown: one for each user of an undefined symbol.
  std::size_t Count() const;
};

/// Loads a file as the editor does, and lists its messages from a level up. One that repeats another to the
/// letter is left out.
TemplateMessages CollectMessages(const std::string& file, int lowestLevel);

/// The same for a template that was just loaded from a path: the registry has its messages.
TemplateMessages CollectMessages(const TemplateCore& core, const std::string& file, int lowestLevel);

/// Bytes as JSON can hold them.
std::string JsonText(const std::string& bytes);

}  // namespace tessal::cli
