#include "core/messages.h"

#include <algorithm>
#include <array>
#include <cassert>

namespace tessal {

namespace {

constexpr std::array<std::string_view, 5> kLevelWords = {"", "Notice", "Warning", "Critical", "-FATAL-"};

/// The text with each place, `%` and a digit from 1 on, replaced by its value. Values are not looked at
/// again: a `%1` in one of them stays.
std::string Filled(std::string_view text, std::span<const std::string_view> values) {
  std::string filled;
  std::size_t place = 0;
  for (std::size_t mark = text.find('%'); mark != std::string_view::npos; mark = text.find('%', place)) {
    const auto number = static_cast<std::size_t>(text[mark + 1] - '1');
    assert(number < values.size());
    filled += text.substr(place, mark - place);
    filled += values[number];
    place = mark + 2;
  }
  filled += text.substr(place);
  return filled;
}

}  // namespace

Finding::Finding(Message row, std::initializer_list<std::string_view> values)
    : message(row), text(Filled(row->text, values)) {
  if (const std::size_t number = row->about.value; number > 0) {
    assert(number <= values.size());
    name = values.begin()[number - 1];
  }
}

const MessageRow* FindMessage(std::string_view code) {
  for (const auto rows : {AllMessages(), AnalysisMessages()}) {
    const auto hit =
        std::find_if(rows.begin(), rows.end(), [code](const MessageRow& row) { return row.code == code; });
    if (hit != rows.end()) return &*hit;
  }
  return nullptr;
}

std::string_view LevelWord(std::uint32_t level) {
  return level < kLevelWords.size() ? kLevelWords[level] : kLevelWords[0];
}

}  // namespace tessal
