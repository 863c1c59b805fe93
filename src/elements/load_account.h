// The account of a load: what in the file was not taken over as it is there. It belongs to the template
// that was loaded, beside the messages of the process. A value that was passed over stays in it, so that it
// can still be taken over.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "core/messages.h"
#include "elements/element_field.h"
#include "platform/uid.h"

namespace tessal {

/// A value of the file that the load passed over, and the element and field that it belongs to.
struct PassedOverValue {
  Uid element;
  ElementField field;
};

/// What the account quotes of the file is cut after that many bytes.
inline constexpr std::size_t kLongestShown = 200;

/// What an entry means for the file when the template is saved.
enum class AccountKind {
  Absent,   ///< the file lacks something; a save loses nothing
  Unread,   ///< a value was not read; a save writes another in its place
  Changed,  ///< something was read as something else, or cut
  Dropped,  ///< something that nobody reads; a save leaves it out
};

struct AccountEntry {
  AccountKind kind;
  std::string_view code;  ///< of its row in the table of messages
  std::string symbol;     ///< what it is about: an element's symbol, or else a section's name
  std::string text;
  int line;  ///< of the file, from 1; 0 for none
  /// What can be taken over; none where that is for the modeller to do.
  std::optional<PassedOverValue> value;
  bool ofVisibility = false;  ///< taken over with all that was passed over of the visibility groups
};

class LoadAccount final {
 public:
  void Note(AccountKind kind, std::string_view symbol, int line, const Finding& finding);
  void NotePassedOver(std::string_view symbol, int line, const Finding& finding, PassedOverValue value);
  void NoteOfVisibility(std::string_view symbol, int line, const Finding& finding);
  void Clear() { entries.clear(); }
  /// Adds the entries of another load, with nothing to take over: their elements are not those of this
  /// template.
  void AddEntriesOf(const LoadAccount& other);

  const std::vector<AccountEntry>& Entries() const { return entries; }
  /// Entries in the order of the file, those without a line first.
  void SortByLine();

  /// Whether a save would lose or change something that is in the file.
  bool Loses() const;
  std::size_t Count(AccountKind kind) const;
  /// Whether there is anything to take over.
  bool HasPassedOver() const;
  /// Hands out what can be taken over, and forgets it.
  std::vector<AccountEntry> TakePassedOver();

 private:
  std::vector<AccountEntry> entries;
};

}  // namespace tessal
