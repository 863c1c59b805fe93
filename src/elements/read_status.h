// What goes through all reads of one load: whether numbers are read, and the account of what is passed over.
#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "elements/load_account.h"
#include "platform/kvf2004.h"

namespace tessal {

class CEL_Element;
class CEL_Property;

class ReadStatus final {
 public:
  explicit ReadStatus(LoadAccount& loadAccount) : ReadStatus(loadAccount, true) {}
  /// For what a load passes over, and so reports nothing about.
  static ReadStatus WithoutReports(LoadAccount& loadAccount) { return {loadAccount, false}; }
  ReadStatus(const ReadStatus&) = delete;
  ReadStatus& operator=(const ReadStatus&) = delete;

  /// The element whose section is read from here on, for the words of the account.
  void Begin(const CEL_Element& read, KvfNode itsSection);
  /// What an element without a symbol is called until its own is read: the default name of a new one.
  void BeginUnnamed(std::string_view prefix, std::size_t number) { unnamed = Unnamed{prefix, number}; }
  void SymbolWasRead() { unnamed.reset(); }
  /// What the account calls the element: its symbol, or without one its section.
  std::string Name() const;

  /// Numbers are read while the last text before them, and every number since, was there.
  bool ReadsNumbers() const { return !missing.has_value(); }
  void TextWasRead() { missing.reset(); }
  /// Notes a key without a value of its type, and reports it at level 3.
  void ReportMissing(KvfNode section, std::string_view key);

  /// Puts a keyword without a value that was read into the account: absent, of the wrong type, or passed
  /// over. The property is the one that it belongs to, or none for a number that a load only counts by.
  void NoteUnread(KvfNode section, std::string_view key, const CEL_Property* property);
  /// Notes the only keyword of an equation's section, which is not named as its state variable.
  void NoteMisnamed(KvfNode section, const CEL_Property& property);
  /// Notes a section that the parent should have and does not.
  void NoteAbsentSection(KvfNode parent, std::string_view name);
  /// Puts a value that was read as something else into the account.
  void NoteReplaced(KvfNode section, std::string_view key, std::string_view replacement);
  /// The same for one that lost a part.
  void NoteCut(KvfNode section, std::string_view key, std::string_view rest);
  /// Why numbers are passed over, seen from the element that is being read: "UNIT is missing".
  std::string Reason() const;
  LoadAccount& Account() { return account; }

 private:
  struct MissingKey {
    std::string key;
    std::string name;  ///< of its element
    const CEL_Element* element;
    bool isThere;  ///< with a value of another type
  };

  struct Unnamed {
    std::string_view prefix;
    std::size_t number;
  };

  ReadStatus(LoadAccount& loadAccount, bool withReports) : account(loadAccount), reports(withReports) {}
  void NoteChanged(Message message, KvfNode section, std::string_view key, std::string_view present);

  LoadAccount& account;
  bool reports;
  const CEL_Element* element = nullptr;
  KvfNode elementSection = nullptr;
  std::optional<MissingKey> missing;
  std::optional<Unnamed> unnamed;
};

}  // namespace tessal
