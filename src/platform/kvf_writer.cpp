#include "platform/kvf_writer.h"

#include <cstring>
#include <utility>

namespace tessal {

namespace {

/// A part is large enough to be written to a file by itself.
constexpr std::size_t kPartSize = 1U << 17U;
constexpr std::size_t kBlanksPerLevel = 3;
constexpr std::string_view kBlanks = "                              ";
constexpr std::string_view kLineEnd = "\r\n";

}  // namespace

KvfWriter::KvfWriter(TextSink textSink, std::string_view lastComment)
    : sink(std::move(textSink)), part(kPartSize) {
  const std::size_t lastLine = kKvfHeader.rfind('\n', kKvfHeader.size() - 2) + 1;
  PutText(kKvfHeader.substr(0, lastLine));
  if (!lastComment.empty()) {
    Put("// ");
    Put(lastComment);
    Put(kLineEnd);
  }
  PutText(kKvfHeader.substr(lastLine));
}

void KvfWriter::OpenSection(std::string_view name) {
  EndKeyword();
  BeginLine();
  Put('[');
  Put(name);
  Put(']');
  Put(kLineEnd);
  openSections.emplace_back(name);
}

void KvfWriter::CloseSection() {
  EndKeyword();
  const std::string name = std::move(openSections.back());
  openSections.pop_back();
  BeginLine();
  Put("EndSect  // ");
  Put(name);
  Put(kLineEnd);
  Put(kLineEnd);
}

void KvfWriter::AddKeyword(std::string_view name) {
  EndKeyword();
  BeginLine();
  Put(name);
  Put(" = ");
  keyword = Keyword::Fresh;
}

void KvfWriter::AddNumber(std::string_view number) {
  BeginValue();
  Put(number);
}

void KvfWriter::AddText(std::string_view value, char quote) {
  BeginValue();
  Put(quote);
  PutText(value);
  Put(quote);
}

void KvfWriter::Finish() {
  while (HasOpenSection()) CloseSection();
  Flush();
}

std::string KvfWriter::TakeText() {
  Finish();
  return std::move(kept);
}

void KvfWriter::Put(std::string_view piece) {
  if (piece.size() > part.size() - used) Flush();
  while (piece.size() > part.size()) {
    std::memcpy(part.data(), piece.data(), part.size());
    used = part.size();
    Flush();
    piece.remove_prefix(part.size());
  }
  std::memcpy(part.data() + used, piece.data(), piece.size());
  used += piece.size();
}

void KvfWriter::Flush() {
  const std::string_view full(part.data(), std::exchange(used, 0));
  if (sink) {
    sink(full);
  } else {
    kept += full;
  }
}

void KvfWriter::BeginLine() {
  for (std::size_t left = kBlanksPerLevel * openSections.size(); left > 0;) {
    const std::string_view blanks = kBlanks.substr(0, left);
    Put(blanks);
    left -= blanks.size();
  }
}

void KvfWriter::EndKeyword() {
  if (HasOpenKeyword()) Put(kLineEnd);
  keyword = Keyword::None;
}

void KvfWriter::BeginValue() {
  if (keyword == Keyword::HasValues) Put(", ");
  keyword = Keyword::HasValues;
}

void KvfWriter::PutText(std::string_view value) {
  const bool isOneLine =
      value.find('\n') == std::string_view::npos && value.find('\r') == std::string_view::npos;
  if (isOneLine) return Put(value);
  while (true) {
    const std::size_t next = value.find_first_of(kLineEnd);
    Put(value.substr(0, next));
    if (next == std::string_view::npos) return;
    if (value[next] == '\n') Put(kLineEnd);
    value.remove_prefix(next + 1);
  }
}

}  // namespace tessal
