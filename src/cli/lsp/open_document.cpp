#include "cli/lsp/open_document.h"

#include <algorithm>

namespace tessal::cli {

namespace {

std::size_t NumberFrom(const Json& number) {
  if (!number.is_number_unsigned())
    throw Json::type_error::create(302, "a line or character is no number from 0 on", &number);
  return number.get<std::size_t>();
}

void ApplyChange(std::string& text, const Json& change, ColumnUnit unit) {
  const std::string& inserted = change.at("text").get_ref<const std::string&>();
  if (!change.contains("range")) {
    text = inserted;
    return;
  }
  const TextPositions positions(text, unit, LineEnds::AllKinds);
  const std::size_t start = positions.OffsetOf(PositionFrom(change.at("range").at("start")));
  const std::size_t end = positions.OffsetOf(PositionFrom(change.at("range").at("end")));
  text.replace(std::min(start, end), std::max(start, end) - std::min(start, end), inserted);
}

}  // namespace

void ApplyChanges(std::string& text, const Json& changes, ColumnUnit unit) {
  if (!changes.is_array()) throw Json::type_error::create(302, "changes are no list", &changes);
  for (const Json& change : changes) ApplyChange(text, change, unit);
}

TextPosition PositionFrom(const Json& position) {
  return {NumberFrom(position.at("line")), NumberFrom(position.at("character"))};
}

Json ToJson(TextPosition position) {
  return {{"line", position.line}, {"character", position.column}};
}

}  // namespace tessal::cli
