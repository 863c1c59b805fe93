// Reading key-file text into an image. It is milder than the grammar of the item tree: no line feed is needed
// at either end, and comments may be anywhere a line may.
#include "platform/kvf_image.h"

#include <algorithm>
#include <memory>

#include "platform/ascii.h"
#include "platform/kvf_writer.h"

namespace tessal {

namespace {

constexpr std::size_t kLongestNear = 40;

std::string_view Trimmed(std::string_view text) {
  constexpr std::string_view kBlanks = " \t\r";
  const std::size_t first = text.find_first_not_of(kBlanks);
  if (first == std::string_view::npos) return {};
  return text.substr(first, text.find_last_not_of(kBlanks) - first + 1);
}

std::string_view CommentText(const KvfImage& image, const KvfComment& comment) {
  return std::string_view(image.source).substr(comment.start, comment.size);
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

const KvfSpan* SpanOf(const KvfImage& image, const KvfItem* section) {
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

/// Reads one text, item by item. Sections nest in a list of its own, not in calls.
class ImageReader final {
 public:
  explicit ImageReader(KvfImage& fileImage) : text(fileImage.source), image(fileImage), pool(&image.arena) {}

  bool Run() {
    open.push_back({&image.root, nullptr});
    while (SkipToItem()) {
      const bool good = text[place] == '[' ? ReadHead() : ReadLine();
      if (!good) return false;
    }
    return open.size() == 1;
  }

  KvfSyntaxError Where() const {
    KvfSyntaxError error;
    const std::size_t at = std::min(place, text.size());
    error.line = line;
    error.position = static_cast<int>(at - lineStart) + 1;
    std::string_view near = text.substr(at, kLongestNear);
    near = near.substr(0, near.find_first_of("\r\n"));
    error.text = near;
    return error;
  }

 private:
  bool AtEnd() const { return place >= text.size(); }
  char Peek() const { return AtEnd() ? '\0' : text[place]; }

  void CountLine() {
    ++line;
    lineStart = place + 1;
  }

  void SkipBlanks() {
    while (!AtEnd() && (text[place] == ' ' || text[place] == '\t' || text[place] == '\r')) ++place;
  }

  void SkipComment() {
    constexpr std::size_t kSlashes = 2;
    const std::size_t start = place + kSlashes;
    place = std::min(text.find('\n', place), text.size());
    image.comments.push_back(
        {line, static_cast<std::uint32_t>(start), static_cast<std::uint32_t>(place - start)});
  }

  bool AtComment() const { return text.substr(place).starts_with("//"); }

  /// Goes to the next item; false at the end of the text.
  bool SkipToItem() {
    while (true) {
      SkipBlanks();
      if (AtEnd()) return false;
      if (text[place] == '\n') {
        CountLine();
        ++place;
      } else if (AtComment()) {
        SkipComment();
      } else {
        return true;
      }
    }
  }

  /// After an item its line may hold only blanks and a comment.
  bool EndLine() {
    SkipBlanks();
    if (AtComment()) SkipComment();
    return AtEnd() || text[place] == '\n';
  }

  std::string_view TakeWord() {
    const std::size_t start = place;
    if (!AtEnd() && !IsAsciiDigit(text[place])) {
      while (!AtEnd() && IsWordCharacter(text[place])) ++place;
    }
    return text.substr(start, place - start);
  }

  /// Puts an item after those that the open section has.
  void Append(KvfEntry& entry) {
    OpenSection& parent = open.back();
    if (parent.last == nullptr) {
      parent.section->first = &entry;
    } else {
      parent.last->next = &entry;
    }
    parent.last = &entry;
  }

  bool ReadHead() {
    const int headLine = line;
    const std::size_t start = lineStart;
    ++place;
    SkipBlanks();
    const std::string_view name = TakeWord();
    SkipBlanks();
    if (name.empty() || Peek() != ']') return false;
    ++place;
    const bool isTarget = open.size() == 1;
    KvfSection& section = *pool.new_object<KvfSection>(name, headLine);
    Append(section);
    ++open.back().section->count;
    open.push_back({&section, nullptr});
    if (isTarget) image.targets.push_back({&section, start, start});
    return EndLine();
  }

  /// A keyword, or the end of a section. A keyword may have the name of any word, also of the end.
  bool ReadLine() {
    const int itemLine = line;
    const std::size_t start = place;
    const std::string_view word = TakeWord();
    SkipBlanks();
    if (word.empty()) return false;
    if (Peek() == '=' && open.size() > 1) {
      ++place;
      KvfKeyword& keyword = *pool.new_object<KvfKeyword>(word, itemLine);
      Append(keyword);
      return ReadValues(keyword) && EndLine();
    }
    if (!EqualIgnoringCase(word, "EndSect") || open.size() == 1) {
      place = start;
      return false;
    }
    const std::size_t comments = image.comments.size();
    const std::string_view closed = open.back().section->Text();
    open.pop_back();
    if (!EndLine()) return false;
    // Every writer of such files names the section there.
    if (image.comments.size() > comments && Trimmed(CommentText(image, image.comments.back())) == closed) {
      image.comments.pop_back();
    }
    // The line feed is read with the next item.
    if (open.size() == 1) image.targets.back().end = std::min(place + 1, text.size());
    return true;
  }

  /// A value as the text has it, a quoted one without its quotes.
  struct RawValue {
    KvfItem::Value type = KvfItem::Value::Integer;
    std::string_view text;
  };

  /// The parameters of a keyword lie side by side. Where there are many they are counted first, so that a
  /// line of any length takes no more than it needs.
  bool ReadValues(KvfKeyword& keyword) {
    const Position start = Here();
    RawValue value;
    std::uint32_t count = 0;
    do {
      if (count > 0) ++place;
      SkipBlanks();
      if (!ReadValue(value)) return false;
      ++count;
      SkipBlanks();
    } while (Peek() == ',');
    KvfItem* const parameters = pool.allocate_object<KvfItem>(count);
    keyword.parameters = parameters;
    keyword.count = count;
    if (count == 1) {
      Put(value, parameters);
      return true;
    }
    GoTo(start);
    for (std::uint32_t number = 0; number < count; ++number) {
      if (number > 0) ++place;
      SkipBlanks();
      ReadValue(value);
      Put(value, parameters + number);
      SkipBlanks();
    }
    return true;
  }

  /// Makes a parameter. A text that goes over a line's end is copied, as carriage returns are no part of it.
  void Put(const RawValue& value, KvfItem* parameter) {
    std::string_view content = value.text;
    if (content.find('\r') != std::string_view::npos) {
      char* const copy = pool.allocate_object<char>(content.size());
      const char* const end = std::remove_copy(content.begin(), content.end(), copy, '\r');
      content = {copy, static_cast<std::size_t>(end - copy)};
    }
    std::construct_at(parameter, KvfItem::Type::Parameter, content)->value = value.type;
  }

  bool ReadValue(RawValue& value) {
    const char first = Peek();
    if (first == '\'' || first == '|') return ReadText(value, first);
    if (IsAsciiDigit(first) || first == '+' || first == '-') return ReadNumber(value);
    const std::size_t start = place;
    const std::string_view word = TakeWord();
    if (!EqualIgnoringCase(word, "true") && !EqualIgnoringCase(word, "false")) {
      place = start;
      return false;
    }
    value = {KvfItem::Value::Boolean, word};
    return true;
  }

  bool ReadText(RawValue& value, char quote) {
    const std::size_t start = place + 1;
    const std::size_t end = text.find(quote, start);
    if (end == std::string_view::npos) return false;
    const std::string_view content = text.substr(start, end - start);
    for (std::size_t feed = content.find('\n'); feed != std::string_view::npos;
         feed = content.find('\n', feed + 1)) {
      place = start + feed;
      CountLine();
    }
    place = end + 1;
    value = {quote == '|' ? KvfItem::Value::Path : KvfItem::Value::Quoted, content};
    return true;
  }

  std::size_t SkipDigits(std::size_t from) const {
    while (from < text.size() && IsAsciiDigit(text[from])) ++from;
    return from;
  }

  bool ReadNumber(RawValue& raw) {
    const std::size_t start = place;
    const std::size_t digits = start + (IsAsciiDigit(text[start]) ? 0 : 1);
    std::size_t end = SkipDigits(digits);
    if (end == digits) return false;
    KvfItem::Value value = KvfItem::Value::Integer;
    if (end < text.size() && text[end] == '.') {
      value = KvfItem::Value::Real;
      end = SkipDigits(end + 1);
    }
    if (end < text.size() && (text[end] == 'e' || text[end] == 'E')) {
      std::size_t exponent = end + 1;
      if (exponent < text.size() && (text[exponent] == '+' || text[exponent] == '-')) ++exponent;
      const std::size_t exponentEnd = SkipDigits(exponent);
      if (exponentEnd > exponent) {
        value = KvfItem::Value::Real;
        end = exponentEnd;
      }
    }
    place = end;
    raw = {value, text.substr(start, end - start)};
    return true;
  }

  struct OpenSection {
    KvfSection* section;
    KvfEntry* last;  ///< of its items so far
  };

  struct Position {
    std::size_t place;
    std::size_t lineStart;
    int line;
  };

  Position Here() const { return {place, lineStart, line}; }
  void GoTo(const Position& position) {
    place = position.place;
    lineStart = position.lineStart;
    line = position.line;
  }

  std::string_view text;
  KvfImage& image;
  std::pmr::polymorphic_allocator<> pool;
  std::vector<OpenSection> open;
  std::size_t place = 0;
  std::size_t lineStart = 0;
  int line = 1;
};

}  // namespace

bool ReadKvfImage(KvfImage& image, KvfSyntaxError& error) {
  ImageReader reader(image);
  if (reader.Run()) return true;
  error = reader.Where();
  return false;
}

std::string KvfTextBeside(const KvfImage& image, const KvfItem* section) {
  if (image.targets.empty()) return {};
  const std::string_view source = image.source;
  const std::size_t first = image.targets.front().start;
  const KvfSpan* span = SpanOf(image, section);
  if (span == nullptr) return std::string(WithoutBlankLines(source.substr(first)));
  const std::string_view before = WithoutBlankLines(source.substr(first, span->start - first));
  const std::string_view after = WithoutBlankLines(source.substr(span->end));
  std::string text(before);
  if (!before.empty() && !after.empty()) text += "\r\n\r\n";
  text += after;
  return text;
}

void ForEachKvfRemark(const KvfImage& image, const KvfItem* section,
                      const std::function<void(const KvfRemark&)>& visit) {
  const std::size_t first = image.targets.empty() ? image.source.size() : image.targets.front().start;
  const KvfSpan* span = SpanOf(image, section);
  for (const KvfComment& comment : image.comments) {
    const bool inHead = comment.start < first;
    const bool inSection = span != nullptr && comment.start >= span->start && comment.start < span->end;
    const std::string_view text = Trimmed(CommentText(image, comment));
    if (inSection || (inHead && !IsOfHeader(text))) visit({comment.line, text});
  }
}

}  // namespace tessal
