#include "cli/lsp/message_frames.h"

#include <algorithm>
#include <charconv>
#include <system_error>

#include "cli/output.h"
#include "platform/ascii.h"

namespace tessal::cli {

namespace {

constexpr std::string_view kLineEnd = "\r\n";
constexpr std::string_view kHeaderEnd = "\r\n\r\n";
constexpr std::string_view kContentLength = "Content-Length";
constexpr std::size_t kLongestHeader = 4096;
constexpr std::size_t kMostShown = 60;

std::string_view WithoutBlanks(std::string_view text) {
  const std::size_t first = text.find_first_not_of(" \t");
  if (first == std::string_view::npos) return {};
  return text.substr(first, text.find_last_not_of(" \t") - first + 1);
}

std::string Shown(std::string_view text) {
  std::string shown = OnOneLine(text.substr(0, kMostShown));
  std::replace_if(
      shown.begin(), shown.end(), [](char byte) { return static_cast<signed char>(byte) < ' '; }, '?');
  return "'" + shown + "'";
}

}  // namespace

void FrameBuffer::Add(std::string_view bytes) {
  if (!failure.empty()) return;
  buffered.erase(0, start);
  scanned -= std::min(scanned, start);
  start = 0;
  buffered += bytes;
}

std::optional<std::string> FrameBuffer::Take() {
  if (!failure.empty() || (!size && !ReadHeader())) return std::nullopt;
  if (buffered.size() - start < *size) return std::nullopt;
  std::string body = buffered.substr(start, *size);
  start += *size;
  scanned = start;
  size.reset();
  return body;
}

void FrameBuffer::End() {
  if (!failure.empty() || (start == buffered.size() && !size)) return;
  Fail(size ? "the input ends in the body of a message" : "the input ends in the header of a message");
}

bool FrameBuffer::ReadHeader() {
  const std::size_t end = buffered.find(kHeaderEnd, scanned);
  if (end == std::string::npos || end - start > kLongestHeader) {
    scanned = std::max(start, buffered.size() - std::min(buffered.size(), kHeaderEnd.size()));
    if (std::min(end, buffered.size()) - start > kLongestHeader)
      return Fail("the header of a message does not end");
    return false;
  }
  std::string_view header = std::string_view(buffered).substr(start, end - start);
  while (!header.empty()) {
    const std::size_t lineEnd = std::min(header.find(kLineEnd), header.size());
    if (!ReadHeaderLine(header.substr(0, lineEnd))) return false;
    header.remove_prefix(std::min(header.size(), lineEnd + kLineEnd.size()));
  }
  if (!size) return Fail("a message has no Content-Length");
  start = scanned = end + kHeaderEnd.size();
  return true;
}

bool FrameBuffer::ReadHeaderLine(std::string_view line) {
  const std::size_t colon = line.find(':');
  if (colon == std::string_view::npos) return Fail("a header line without a colon: " + Shown(line));
  if (!EqualIgnoringCase(line.substr(0, colon), kContentLength)) return true;
  const std::string_view number = WithoutBlanks(line.substr(colon + 1));
  std::size_t length = 0;
  const auto read = std::from_chars(number.data(), number.data() + number.size(), length);
  const bool isWhole = read.ptr == number.data() + number.size();
  if (read.ec == std::errc::result_out_of_range || (read.ec == std::errc() && length > kLargestBody))
    return Fail("a Content-Length of " + Shown(number) + " is more than a message may have");
  if (read.ec != std::errc() || !isWhole) return Fail("a Content-Length is no number: " + Shown(number));
  if (size && *size != length) return Fail("a message has two lengths");
  size = length;
  return true;
}

bool FrameBuffer::Fail(std::string text) {
  failure = std::move(text);
  buffered.clear();
  start = scanned = 0;
  size.reset();
  return false;
}

std::string Framed(std::string_view body) {
  return std::string(kContentLength) + ": " + std::to_string(body.size()) + std::string(kHeaderEnd) +
         std::string(body);
}

}  // namespace tessal::cli
