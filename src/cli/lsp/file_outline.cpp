#include "cli/lsp/file_outline.h"

#include <algorithm>

#include "platform/ascii.h"

namespace tessal::cli {

namespace {

constexpr std::string_view kEndOfSection = "EndSect";

std::size_t EndOfWord(std::string_view text, std::size_t place) {
  while (place < text.size() && IsWordCharacter(text[place])) ++place;
  return place;
}

}  // namespace

FileOutline::FileOutline(std::string_view outlined) : text(outlined) {
  std::size_t place = 0;
  while (place < text.size()) {
    const char byte = text[place];
    if (text.substr(place, 2) == "//") {
      place = std::min(text.find('\n', place), text.size());
    } else if (byte == '[') {
      place = ReadHead(place);
    } else if (byte == '\'' || byte == '|') {
      place = std::min(text.find(byte, place + 1), text.size() - 1) + 1;
    } else if (IsWordCharacter(byte)) {
      place = ReadWord(place);
    } else {
      ++place;
    }
  }
  for (OutlineSection& section : sections) {
    if (section.end == 0) section.end = text.size();
  }
}

std::size_t FileOutline::ReadHead(std::size_t place) {
  const std::size_t end = text.find_first_of("]\n", place);
  if (end == std::string_view::npos || text[end] == '\n') return std::min(end, text.size() - 1) + 1;
  std::string_view name = text.substr(place + 1, end - place - 1);
  while (!name.empty() && name.front() == ' ') name.remove_prefix(1);
  while (!name.empty() && name.back() == ' ') name.remove_suffix(1);
  sections.push_back({name, place, 0, open});
  open = sections.size() - 1;
  return end + 1;
}

std::size_t FileOutline::ReadWord(std::size_t place) {
  const std::size_t end = EndOfWord(text, place);
  const std::string_view word = text.substr(place, end - place);
  if (EqualIgnoringCase(word, kEndOfSection)) {
    if (open) {
      sections[*open].end = end;
      open = sections[*open].parent;
    }
    return end;
  }
  const std::size_t sign = text.find_first_not_of(" \t", end);
  if (sign != std::string_view::npos && text[sign] == '=') keywords.push_back({word, open});
  return end;
}

std::optional<std::size_t> FileOutline::SectionAt(std::size_t place) const {
  const auto after = std::upper_bound(
      sections.begin(), sections.end(), place,
      [](std::size_t searched, const OutlineSection& section) { return searched < section.start; });
  if (after == sections.begin()) return std::nullopt;
  std::optional<std::size_t> found = static_cast<std::size_t>(after - sections.begin()) - 1;
  while (found && !sections[*found].IsIn(place)) found = sections[*found].parent;
  return found;
}

std::string_view FileOutline::WordAt(std::size_t place) const {
  const auto holds = [this, place](std::string_view word) {
    const auto start = static_cast<std::size_t>(word.data() - text.data());
    return place >= start && place <= start + word.size();
  };
  const std::string_view keyword = KeywordBefore(place);
  if (!keyword.empty() && holds(keyword)) return keyword;
  const std::optional<std::size_t> section = SectionAt(place);
  return section && holds(sections[*section].name) ? sections[*section].name : std::string_view();
}

std::string_view FileOutline::KeywordBefore(std::size_t place) const {
  const auto after = std::upper_bound(
      keywords.begin(), keywords.end(), place, [this](std::size_t searched, const OutlineKeyword& keyword) {
        return searched < static_cast<std::size_t>(keyword.word.data() - text.data());
      });
  return after == keywords.begin() ? std::string_view() : (after - 1)->word;
}

}  // namespace tessal::cli
