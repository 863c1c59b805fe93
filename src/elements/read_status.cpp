#include "elements/read_status.h"

#include <charconv>
#include <cmath>
#include <limits>
#include <optional>
#include <utility>

#include "core/error_registry.h"
#include "elements/element.h"
#include "elements/free_name.h"
#include "elements/property_io.h"
#include "expr/scanner.h"

namespace tessal {

namespace {

std::string_view TypeWord(ValueType type) {
  switch (type) {
    case ValueType::Real:
      return "number";
    case ValueType::Integer:
      return "whole number";
    default:
      return "text";
  }
}

/// A keyword and its values as in the file, long ones cut.
std::string Shown(KvfNode keyword) {
  return kvfGetSource(keyword, kLongestShown);
}

std::optional<double> NumberIn(std::string_view text) {
  text = CleanText(text);
  double number = 0.0;
  const auto read = std::from_chars(text.data(), text.data() + text.size(), number);
  const bool isNumber = read.ec == std::errc() && read.ptr == text.data() + text.size();
  return isNumber && std::isfinite(number) ? std::optional(number) : std::nullopt;
}

/// The value of a keyword as a field of the property's type, also where the file holds it in another
/// notation; none where it is no such value.
std::optional<ElementField> FieldOf(KvfNode keyword, const CEL_Property& property, std::string_view label) {
  std::string text;
  const KvfNode parameter = kvfParamByNum(keyword, 1);
  if (parameter == nullptr || kvfGetString(parameter, text) != kKvfOk) return std::nullopt;
  ElementField field;
  field.name = label;
  if (property.Type() == ValueType::Real || property.Type() == ValueType::Integer) {
    const std::optional<double> number = NumberIn(text);
    if (!number) return std::nullopt;
    field.kind = FieldKind::Real;
    field.realValue = *number;
    if (property.Type() == ValueType::Real) return field;
    using Limits = std::numeric_limits<std::int32_t>;
    if (std::trunc(*number) != *number || *number < Limits::min() || *number > Limits::max()) {
      return std::nullopt;
    }
    field.kind = FieldKind::Integer;
    field.intValue = static_cast<std::int32_t>(*number);
    return field;
  }
  return std::nullopt;
}

bool HasValueOfType(KvfNode keyword, ValueType type) {
  const KvfNode parameter = kvfParamByNum(keyword, 1);
  double real = 0.0;
  std::int32_t integer = 0;
  if (parameter == nullptr) return false;
  return type == ValueType::Real ? kvfGetDouble(parameter, real) == kKvfOk
                                 : kvfGetInt(parameter, integer) == kKvfOk;
}

}  // namespace

void ReadStatus::Begin(const CEL_Element& read, KvfNode itsSection) {
  element = &read;
  elementSection = itsSection;
}

std::string ReadStatus::Name() const {
  if (unnamed) return NumberedName(unnamed->prefix, unnamed->number);
  const std::string symbol = element == nullptr ? std::string() : element->FullSymbol();
  return symbol.empty() ? kvfGetNameGlb(elementSection) : symbol;
}

void ReadStatus::ReportMissing(KvfNode section, std::string_view key) {
  const Finding finding("missing-key", {key, kvfGetNameGlb(section)});
  if (reports) {
    Errors().ReportInFile("", kvfGetLine(section), finding);
    NoteKeyError(finding.text);
  }
  missing = MissingKey{std::string(key), Name(), element, HasKeyword(section, key)};
}

std::string ReadStatus::Reason() const {
  if (!missing) return {};
  const std::string where = missing->element == element ? std::string() : " of " + missing->name;
  return missing->key + where + (missing->isThere ? " is of the wrong type" : " is missing");
}

void ReadStatus::NoteUnread(KvfNode section, std::string_view key, const CEL_Property* property) {
  const KvfNode keyword = kvfKeywordByNameNum(section, key, 1);
  const std::string name = section == elementSection ? Name() : kvfGetNameGlb(section);
  if (keyword == nullptr) {
    account.Note(AccountKind::Absent, name, kvfGetLine(section), {"key-absent", {key, name}});
    return;
  }
  // A count holds nothing that its list does not.
  if (property == nullptr) {
    kvfMarkRead(keyword);
    return;
  }
  const ValueType type = property->Type();
  const std::string shown = Shown(keyword);
  const Finding finding = HasValueOfType(keyword, type)
                              ? Finding("value-not-read", {shown, name, Reason()})
                              : Finding("value-of-wrong-type", {shown, name, TypeWord(type)});
  const std::optional<ElementField> field = FieldOf(keyword, *property, element->LabelOf(*property));
  if (field) {
    // The values after the first are none that can be taken over: they have an entry of their own.
    account.NotePassedOver(name, kvfGetLine(keyword), finding, {element->GetUid(), *field});
  } else {
    kvfMarkRead(keyword);
    account.Note(AccountKind::Unread, name, kvfGetLine(keyword), finding);
  }
}

void ReadStatus::NoteMisnamed(KvfNode section, const CEL_Property& property) {
  std::size_t count = 0;
  KvfUnread unread{};
  kvfForEachUnread(section, [&count, &unread](const KvfUnread& each) {
    unread = each;
    ++count;
  });
  if (count != 1 || unread.what != KvfUnread::What::Keyword) return;
  const KvfNode keyword = unread.node;
  std::string stored;
  if (kvfGetString(kvfParamByNum(keyword, 1), stored) != kKvfOk) return;
  ElementField field;
  field.kind = FieldKind::Expression;
  field.name = element->LabelOf(property);
  field.text = CleanText(StripExpressionQuotes(stored));
  const std::string name = Name();
  account.NotePassedOver(name, kvfGetLine(keyword), {"equation-misnamed", {Shown(keyword), name}},
                         {element->GetUid(), std::move(field)});
}

void ReadStatus::NoteAbsentSection(KvfNode parent, std::string_view name) {
  if (kvfHasSection(parent, name)) return;
  account.Note(AccountKind::Absent, kvfGetNameGlb(parent), kvfGetLine(parent), {"section-absent", {name}});
}

void ReadStatus::NoteChanged(Message message, KvfNode section, std::string_view key,
                             std::string_view present) {
  const KvfNode keyword = kvfKeywordByNameNum(section, key, 1);
  const std::string name = Name();
  account.Note(AccountKind::Changed, name, kvfGetLine(keyword), {message, {Shown(keyword), name, present}});
}

void ReadStatus::NoteReplaced(KvfNode section, std::string_view key, std::string_view replacement) {
  NoteChanged("value-replaced", section, key, replacement);
}

void ReadStatus::NoteCut(KvfNode section, std::string_view key, std::string_view rest) {
  NoteChanged("value-cut", section, key, rest);
}

}  // namespace tessal
