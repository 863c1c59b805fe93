#include "platform/kvf_writer.h"

#include <utility>

namespace tessal {

namespace {

/// A part is large enough to be written to a file by itself.
constexpr std::size_t kPartSize = 1U << 17U;
constexpr std::size_t kBlanksPerLevel = 3;
constexpr char kLineEnd[] = "\r\n";

}  // namespace

KvfWriter::KvfWriter(TextSink textSink, std::string_view lastComment)
    : sink(std::move(textSink)), part(kPartSize) {
  const std::size_t lastLine = kKvfHeader.rfind('\n', kKvfHeader.size() - 2) + 1;
  PutLines(kKvfHeader.substr(0, lastLine));
  if (!lastComment.empty()) {
    Put("// ");
    Put(lastComment);
    Put(kLineEnd);
  }
  PutLines(kKvfHeader.substr(lastLine));
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
  Put(value);
  Put(quote);
}

void KvfWriter::AddLines(std::string_view value, char quote) {
  BeginValue();
  Put(quote);
  PutLines(value);
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

void KvfWriter::PutLarge(std::string_view piece) {
  while (!piece.empty()) {
    if (used == part.size()) Flush();
    const std::size_t taken = piece.copy(part.data() + used, part.size() - used);
    used += taken;
    piece.remove_prefix(taken);
  }
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
  // Few sections lie deeper.
  constexpr char kBlanks[] = "                    ";
  std::size_t left = kBlanksPerLevel * openSections.size();
  for (; left >= sizeof(kBlanks); left -= sizeof(kBlanks) - 1) Put(kBlanks);
  std::memcpy(Room(sizeof(kBlanks)), kBlanks, sizeof(kBlanks));
  used += left;
}

void KvfWriter::EndKeyword() {
  if (HasOpenKeyword()) Put(kLineEnd);
  keyword = Keyword::None;
}

void KvfWriter::BeginValue() {
  if (keyword == Keyword::HasValues) Put(", ");
  keyword = Keyword::HasValues;
}

void KvfWriter::PutLines(std::string_view value) {
  while (true) {
    const std::size_t next = value.find_first_of(kLineEnd);
    Put(value.substr(0, next));
    if (next == std::string_view::npos) return;
    if (value[next] == '\n') Put(kLineEnd);
    value.remove_prefix(next + 1);
  }
}

}  // namespace tessal
