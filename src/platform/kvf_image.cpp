#include "platform/kvf_image.h"

#include <algorithm>
#include <limits>

#include "platform/ascii.h"
#include "platform/kvf_text.h"
#include "platform/kvf_writer.h"

namespace tessal {

namespace {

std::string_view Trimmed(std::string_view text) {
  constexpr std::string_view kBlanks = " \t\r";
  const std::size_t first = text.find_first_not_of(kBlanks);
  if (first == std::string_view::npos) return {};
  return text.substr(first, text.find_last_not_of(kBlanks) - first + 1);
}

std::string_view CommentText(const KvfImage& image, const KvfComment& comment) {
  return image.Source().substr(comment.start, comment.size);
}

/// Whether a comment is a line of the header that every written file has.
bool IsOfHeader(std::string_view comment) {
  constexpr std::string_view kTypePrefix = "type = ";
  constexpr std::string_view kSlashes = "// ";
  if (comment.starts_with(kTypePrefix)) {
    const std::string_view type = comment.substr(kTypePrefix.size());
    return std::all_of(type.begin(), type.end(), IsAsciiDigit);
  }
  std::string_view header = kKvfHeader;
  while (header.starts_with(kSlashes)) {
    const std::size_t end = header.find('\n');
    if (header.substr(kSlashes.size(), end - kSlashes.size()) == comment) return true;
    header.remove_prefix(end + 1);
  }
  return false;
}

const KvfSpan* SpanOf(const KvfImage& image, std::uint32_t section) {
  const auto hit = std::find_if(image.targets.begin(), image.targets.end(),
                                [section](const KvfSpan& span) { return span.section == section; });
  return hit == image.targets.end() ? nullptr : &*hit;
}

std::string_view WithoutBlankLines(std::string_view text) {
  while (true) {
    const std::size_t end = text.find('\n');
    if (end == std::string_view::npos || !Trimmed(text.substr(0, end)).empty()) break;
    text.remove_prefix(end + 1);
  }
  const std::size_t last = text.find_last_not_of(" \t\r\n");
  return text.substr(0, last == std::string_view::npos ? 0 : last + 1);
}

}  // namespace

KvfImage::KvfImage(std::string bytes) {
  const std::size_t size = std::min(bytes.find('\0'), bytes.size());
  bytesCut = bytes.size() - size;
  bytes.resize(size);
  if (bytes.starts_with(kByteOrderMark)) bytes.erase(0, kByteOrderMark.size());
  source = std::make_shared<const std::string>(std::move(bytes));
}

std::string_view KvfImage::TextAt(std::uint32_t place) const {
  const KvfCell& cell = row[place];
  std::size_t size = cell.Size();
  if (size == KvfCell::kLongSize) {
    size = std::lower_bound(longTexts.begin(), longTexts.end(), std::pair(place, std::size_t{0}))->second;
  }
  return {source->data() + cell.Start(), size};
}

int KvfImage::LineAt(std::uint32_t place) const {
  const std::size_t start = row[place].Start();
  // A section knows its line. A keyword's is counted from the nearest place with a known one.
  if (row[place].ItemType() == KvfCell::Type::Section) return static_cast<int>(row[place + 1].Other());
  const auto after =
      std::upper_bound(lines.begin(), lines.end(), std::pair(start, std::numeric_limits<int>::max()));
  const auto [from, line] = after == lines.begin() ? std::pair<std::size_t, int>(0, 1) : *std::prev(after);
  const std::string_view between = Source().substr(from, start - from);
  return line + static_cast<int>(std::count(between.begin(), between.end(), '\n'));
}

std::uint32_t KvfImage::FindName(std::uint32_t section, KvfCell::Type type, std::string_view name,
                                 int number) const {
  // An element asks its section once for each of its keywords: most names differ in size.
  const auto size = static_cast<std::uint32_t>(std::min<std::size_t>(name.size(), KvfCell::kLongSize));
  const std::uint32_t end = EndOfSection(section);
  for (std::uint32_t entry = FirstEntry(section); entry < end; entry = NextEntry(entry)) {
    const KvfCell& cell = row[entry];
    if (cell.Size() != size || cell.ItemType() != type) continue;
    if (EqualIgnoringCase(TextAt(entry), name) && --number == 0) return entry;
  }
  return 0;
}

std::string KvfTextBeside(const KvfImage& image, std::uint32_t section) {
  if (image.targets.empty()) return {};
  const std::string_view source = image.Source();
  const std::size_t first = image.targets.front().start;
  const KvfSpan* span = SpanOf(image, section);
  if (span == nullptr) return KvfLineEnds(std::string(WithoutBlankLines(source.substr(first))));
  const std::string_view before = WithoutBlankLines(source.substr(first, span->start - first));
  const std::string_view after = WithoutBlankLines(source.substr(span->end));
  std::string text(before);
  if (!before.empty() && !after.empty()) text += "\r\n\r\n";
  text += after;
  return KvfLineEnds(std::move(text));
}

void ForEachKvfRemark(const KvfImage& image, std::uint32_t section,
                      const std::function<void(const KvfRemark&)>& visit) {
  const std::size_t first = image.targets.empty() ? image.Source().size() : image.targets.front().start;
  const KvfSpan* span = SpanOf(image, section);
  for (const KvfComment& comment : image.comments) {
    const bool inHead = comment.start < first;
    const bool inSection = span != nullptr && comment.start >= span->start && comment.start < span->end;
    const std::string_view text = Trimmed(CommentText(image, comment));
    if (inSection || (inHead && !IsOfHeader(text))) visit({comment.line, text});
  }
}

}  // namespace tessal
