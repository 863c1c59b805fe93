// Reading and writing the images of the key-file library. Reading is milder than the grammar of the item
// tree: no line feed is needed at either end, and comments may be anywhere a line may.
#include <algorithm>
#include <utility>

#include "platform/ascii.h"
#include "platform/kvf_item.h"
#include "platform/kvf_text.h"

namespace tessal {

namespace {

constexpr std::string_view kHeader =
    "// Tessal template\n"
    "// Key-file text: sections, keywords, parameters\n"
    "// Written by the template editor\n"
    "\n";
constexpr std::size_t kBlanksPerLevel = 3;
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
  std::string_view header = kHeader;
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
  explicit ImageReader(KvfImage& fileImage) : text(fileImage.source), image(fileImage) {}

  bool Run() {
    open.push_back(&image.Root());
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
    image.comments.push_back({line, start, place - start});
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
    open.push_back(&image.AddSection(*open.back(), name, headLine));
    if (isTarget) image.targets.push_back({open.back(), start, start});
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
      return ReadValues(image.AddKeyword(*open.back(), word, itemLine)) && EndLine();
    }
    if (!EqualIgnoringCase(word, "EndSect") || open.size() == 1) {
      place = start;
      return false;
    }
    const std::size_t comments = image.comments.size();
    const std::string_view closed = open.back()->text;
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

  bool ReadValues(KvfItem& keyword) {
    while (true) {
      SkipBlanks();
      if (!ReadValue(keyword)) return false;
      SkipBlanks();
      if (Peek() != ',') return true;
      ++place;
    }
  }

  bool ReadValue(KvfItem& keyword) {
    const char first = Peek();
    if (first == '\'' || first == '|') return ReadText(keyword, first);
    if (IsAsciiDigit(first) || first == '+' || first == '-') return ReadNumber(keyword);
    const std::size_t start = place;
    const std::string_view word = TakeWord();
    if (!EqualIgnoringCase(word, "true") && !EqualIgnoringCase(word, "false")) {
      place = start;
      return false;
    }
    image.AddParameter(keyword, KvfItem::Value::Boolean, std::string(word));
    return true;
  }

  bool ReadText(KvfItem& keyword, char quote) {
    const std::size_t start = place++;
    const int startLine = line;
    const std::size_t startOfLine = lineStart;
    std::string content;
    while (!AtEnd() && text[place] != quote) {
      const std::size_t end =
          std::min(text.find_first_of(quote == '|' ? "|\r\n" : "'\r\n", place), text.size());
      content += text.substr(place, end - place);
      place = end;
      if (AtEnd() || text[place] == quote) break;
      if (text[place] == '\n') {
        content += '\n';
        CountLine();
      }
      ++place;
    }
    if (AtEnd()) {
      place = start;
      line = startLine;
      lineStart = startOfLine;
      return false;
    }
    ++place;
    image.AddParameter(keyword, quote == '|' ? KvfItem::Value::Path : KvfItem::Value::Quoted,
                       std::move(content));
    return true;
  }

  std::size_t SkipDigits(std::size_t from) const {
    while (from < text.size() && IsAsciiDigit(text[from])) ++from;
    return from;
  }

  bool ReadNumber(KvfItem& keyword) {
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
    image.AddParameter(keyword, value, std::string(text.substr(start, end - start)));
    return true;
  }

  std::string_view text;
  KvfImage& image;
  std::vector<KvfItem*> open;
  std::size_t place = 0;
  std::size_t lineStart = 0;
  int line = 1;
};

std::string ParameterText(const KvfItem& parameter) {
  switch (parameter.value) {
    case KvfItem::Value::Quoted:
      return '\'' + parameter.text + '\'';
    case KvfItem::Value::Path:
      return '|' + parameter.text + '|';
    default:
      return parameter.text;
  }
}

}  // namespace

void AppendKvfKeyword(const KvfItem& keyword, std::string& text) {
  text += keyword.text;
  text += " = ";
  for (std::size_t place = 0; place < keyword.keywords.size(); ++place) {
    if (place > 0) text += ", ";
    text += ParameterText(*keyword.keywords[place]);
  }
}

KvfItem& KvfImage::AddSection(KvfItem& parent, std::string_view name, int line) {
  KvfItem& section = items.emplace_back();
  section.type = KvfItem::Type::Section;
  section.text = name;
  section.line = line;
  parent.sections.push_back(&section);
  parent.order.push_back(&section);
  return section;
}

KvfItem& KvfImage::AddKeyword(KvfItem& section, std::string_view name, int line) {
  KvfItem& keyword = items.emplace_back();
  keyword.type = KvfItem::Type::Keyword;
  keyword.text = name;
  keyword.line = line;
  section.keywords.push_back(&keyword);
  section.order.push_back(&keyword);
  return keyword;
}

void KvfImage::AddParameter(KvfItem& keyword, KvfItem::Value value, std::string text) {
  KvfItem& parameter = items.emplace_back();
  parameter.type = KvfItem::Type::Parameter;
  parameter.value = value;
  parameter.text = std::move(text);
  keyword.keywords.push_back(&parameter);
}

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

std::vector<KvfRemark> KvfRemarksOf(const KvfImage& image, const KvfItem* section) {
  const std::size_t first = image.targets.empty() ? image.source.size() : image.targets.front().start;
  const KvfSpan* span = SpanOf(image, section);
  std::vector<KvfRemark> remarks;
  for (const KvfComment& comment : image.comments) {
    const bool inHead = comment.start < first;
    const bool inSection = span != nullptr && comment.start >= span->start && comment.start < span->end;
    const std::string_view text = Trimmed(CommentText(image, comment));
    if (inSection || (inHead && !IsOfHeader(text))) remarks.push_back({comment.line, std::string(text)});
  }
  return remarks;
}

std::string WriteKvfImage(KvfImage& image) {
  std::string text(kHeader);
  struct Step {
    const KvfItem* section;
    std::size_t written;
  };
  std::vector<Step> path{{&image.Root(), 0}};
  while (!path.empty()) {
    const KvfItem& section = *path.back().section;
    const std::size_t depth = path.size() - 1;
    if (path.back().written < section.order.size()) {
      const KvfItem& item = *section.order[path.back().written++];
      const std::string indent(kBlanksPerLevel * depth, ' ');
      if (item.type == KvfItem::Type::Keyword) {
        text += indent;
        AppendKvfKeyword(item, text);
        text += '\n';
      } else {
        text += indent + '[' + item.text + "]\n";
        path.push_back({&item, 0});
      }
      continue;
    }
    if (depth > 0) {
      text += std::string(kBlanksPerLevel * (depth - 1), ' ') + "EndSect  // " + section.text + "\n\n";
    }
    path.pop_back();
  }
  return KvfWritableText(text);
}

}  // namespace tessal
