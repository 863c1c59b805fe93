#include "platform/kvf_text.h"

#include <algorithm>
#include <array>
#include <cstdint>

#include "platform/ascii.h"

namespace tessal {

namespace {

// A save asks these of every keyword and text that it writes.

enum Mark : std::uint8_t { kZero = 1, kApostrophe = 2, kBar = 4, kLineEnd = 8 };

constexpr std::array<std::uint8_t, 256> kMarks = [] {
  std::array<std::uint8_t, 256> marks{};
  marks['\0'] = kZero;
  marks['\''] = kApostrophe;
  marks['|'] = kBar;
  marks['\n'] = kLineEnd;
  marks['\r'] = kLineEnd;
  return marks;
}();

constexpr std::array<bool, 256> kWordBytes = [] {
  std::array<bool, 256> bytes{};
  for (std::size_t byte = 0; byte < 128; ++byte) bytes[byte] = IsWordCharacter(static_cast<char>(byte));
  return bytes;
}();

std::size_t CountBareLineFeeds(std::string_view text) {
  std::size_t count = 0;
  for (std::size_t feed = text.find('\n'); feed != std::string_view::npos; feed = text.find('\n', feed + 1)) {
    if (feed == 0 || text[feed - 1] != '\r') ++count;
  }
  return count;
}

}  // namespace

std::string KvfLineEnds(std::string text) {
  const std::size_t bare = CountBareLineFeeds(text);
  if (bare == 0) return text;
  std::string changed;
  changed.reserve(text.size() + bare);
  std::string_view rest = text;
  for (std::size_t feed = rest.find('\n'); feed != std::string_view::npos; feed = rest.find('\n')) {
    changed += rest.substr(0, feed);
    if (feed == 0 || rest[feed - 1] != '\r') changed += '\r';
    changed += '\n';
    rest.remove_prefix(feed + 1);
  }
  return changed += rest;
}

KvfTextMarks KvfMarksIn(std::string_view text) {
  unsigned marks = 0;
  for (const char each : text) marks |= kMarks[static_cast<unsigned char>(each)];
  return {(marks & kZero) != 0, (marks & kApostrophe) != 0, (marks & kBar) != 0, (marks & kLineEnd) != 0};
}

bool IsKvfName(std::string_view text) {
  if (text.empty() || IsAsciiDigit(text.front())) return false;
  return std::all_of(text.begin(), text.end(),
                     [](char each) { return kWordBytes[static_cast<unsigned char>(each)]; });
}

}  // namespace tessal
