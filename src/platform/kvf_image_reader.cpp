// Reading key-file text into an image, in one pass over its bytes. It is milder than the grammar of the item
// tree: no line feed is needed at either end, and comments may be anywhere a line may. Whether the text keeps
// to the stricter grammar too is noted on the way.
#include <algorithm>
#include <array>
#include <cstring>
#include <limits>

#include "platform/ascii.h"
#include "platform/kvf_image.h"

namespace tessal {

namespace {

constexpr std::size_t kLongestNear = 40;

/// What a byte may be part of. The zero byte after the text is part of nothing, and so ends every run.
enum ByteClass : std::uint8_t { kNothing = 0, kBlank = 1, kDigit = 2, kWord = 4 };

constexpr std::array<std::uint8_t, 256> kByteClasses = [] {
  std::array<std::uint8_t, 256> classes{};
  for (std::size_t byte = 0; byte < 128; ++byte) {
    const char character = static_cast<char>(byte);
    if (character == ' ' || character == '\t' || character == '\r') classes[byte] = kBlank;
    if (IsWordCharacter(character)) classes[byte] = kWord;
    if (IsAsciiDigit(character)) classes[byte] |= kDigit;
  }
  return classes;
}();

bool Is(char character, ByteClass byteClass) {
  return (kByteClasses[static_cast<unsigned char>(character)] & byteClass) != 0;
}

/// Words that the grammar of the item tree takes for no name.
bool IsReserved(std::string_view word) {
  return EqualIgnoringCase(word, "EndSect") || EqualIgnoringCase(word, "true") ||
         EqualIgnoringCase(word, "false");
}

/// What the grammar of the item tree wants and the reader does not: a head of comment lines side by side and
/// a blank line before the first section, no comment between top-level sections, a line feed after every
/// line, and no name that is a reserved word. Its parser's stack is limited. False may be said of a text that
/// keeps to it, where that is close.
class StrictForm final {
 public:
  void AtComment(int line, bool isTopLevel) {
    block = line == lastComment + 1 ? block + 1 : 1;
    // The comments of the head begin the text.
    if (isTopLevel && (sections > 0 || blankLines > 0)) keeps = false;
    if (block > kLongestBlock) keeps = false;
    lastComment = line;
  }
  /// A line feed with no item in its line at the top level. That of a comment of the head belongs to it.
  void AtTopLevelLineEnd(int line) {
    if (sections == 0 && line != lastComment) ++blankLines;
  }
  void AtSection(std::string_view name, std::size_t depth) {
    if (IsReserved(name) || depth > kDeepest) keeps = false;
    if (depth > 1) return;
    if (sections == 0 && blankLines == 0) keeps = false;
    if (++sections > kMostSections) keeps = false;
  }
  void AtKeyword(std::string_view name) {
    if (IsReserved(name)) keeps = false;
  }
  void AtLineWithoutEnd() { keeps = false; }
  bool Keeps(std::size_t size) const { return keeps && sections > 0 && size < kLargestText; }

 private:
  static constexpr int kLongestBlock = 1000;
  static constexpr int kMostSections = 1000;
  static constexpr std::size_t kDeepest = 500;
  /// Its scanner counts in 32 bits, with two bytes for a line end.
  static constexpr std::size_t kLargestText = std::numeric_limits<std::int32_t>::max() / 4;

  bool keeps = true;
  int sections = 0;
  int blankLines = 0;
  int lastComment = 0;
  int block = 0;
};

/// Reads one text, item by item. Sections nest in a list of its own, not in calls.
class ImageReader final {
 public:
  explicit ImageReader(KvfImage& fileImage)
      : image(fileImage),
        row(fileImage.row),
        begin(fileImage.Source().data()),
        end(begin + fileImage.Source().size()),
        place(begin),
        lineStart(begin) {}

  bool Run() {
    // Templates have an item in nine bytes. What is not used is not touched.
    constexpr std::size_t kBytesAnItem = 8;
    row.reserve(image.Source().size() / kBytesAnItem + KvfImage::kSectionCells);
    OpenSection(begin, 0, 0);
    while (SkipToItem()) {
      const bool good = *place == '[' ? ReadHead() : ReadLine();
      if (!good) return false;
    }
    if (open.size() > 1) return false;
    EndSection();
    image.isStrict = strictForm.Keeps(image.Source().size());
    return true;
  }

  KvfSyntaxError Where() const {
    KvfSyntaxError error;
    error.line = line;
    // A line ends in a carriage return and a line feed, also where the file has no return.
    const bool isBareFeed = *place == '\n' && (place == begin || place[-1] != '\r');
    error.position = static_cast<int>(place - lineStart) + (isBareFeed ? 2 : 1);
    std::string_view near(place, std::min(kLongestNear, static_cast<std::size_t>(end - place)));
    near = near.substr(0, near.find_first_of("\r\n"));
    error.text = near;
    return error;
  }

 private:
  std::size_t Offset(const char* at) const { return static_cast<std::size_t>(at - begin); }
  std::size_t Depth() const { return open.size() - 1; }

  void CountLine() {
    ++line;
    lineStart = place + 1;
  }

  void SkipBlanks() {
    while (Is(*place, kBlank)) ++place;
  }

  bool AtComment() const { return place[0] == '/' && place[1] == '/'; }

  void SkipComment() {
    place += 2;
    const auto* feed =
        static_cast<const char*>(std::memchr(place, '\n', static_cast<std::size_t>(end - place)));
    const char* const stop = feed == nullptr ? end : feed;
    image.comments.push_back(
        {line, static_cast<std::uint32_t>(Offset(place)), static_cast<std::uint32_t>(stop - place)});
    place = stop;
    if (place == end) strictForm.AtLineWithoutEnd();
  }

  /// Goes to the next item; false at the end of the text.
  bool SkipToItem() {
    while (true) {
      SkipBlanks();
      if (*place == '\n') {
        if (Depth() == 0) strictForm.AtTopLevelLineEnd(line);
        CountLine();
        ++place;
      } else if (AtComment()) {
        strictForm.AtComment(line, Depth() == 0);
        SkipComment();
      } else {
        return place != end;
      }
    }
  }

  /// After an item its line may hold only blanks and a comment. The line feed is read with what follows.
  bool EndLine() {
    SkipBlanks();
    if (AtComment()) SkipComment();
    if (*place == '\n') return true;
    strictForm.AtLineWithoutEnd();
    return place == end;
  }

  std::string_view TakeWord() {
    const char* const start = place;
    if (!Is(*place, kDigit)) {
      while (Is(*place, kWord)) ++place;
    }
    return {start, static_cast<std::size_t>(place - start)};
  }

  void Append(KvfCell::Type type, std::uint32_t detail, std::string_view text) {
    if (text.size() >= KvfCell::kLongSize) image.longTexts.emplace_back(Place(), text.size());
    row.emplace_back(type, detail, Offset(text.data()), text.size());
  }
  std::uint32_t Place() const { return static_cast<std::uint32_t>(row.size()); }

  void OpenSection(const char* name, std::size_t nameSize, int headLine) {
    open.push_back(Place());
    Append(KvfCell::Type::Section, 0, {name, nameSize});
    row.emplace_back(0, static_cast<std::size_t>(headLine));
    row.emplace_back(0, 0);
  }

  void EndSection() {
    const std::uint32_t section = open.back();
    row[section + 2] = KvfCell(row.size(), 0);
    open.pop_back();
  }

  /// Keeps a line's number where the last one kept is some way before it.
  void NoteLine() {
    constexpr std::size_t kFar = 4096;
    const std::size_t start = Offset(lineStart);
    const std::size_t last = image.lines.empty() ? 0 : image.lines.back().first;
    if (start >= last + kFar) image.lines.emplace_back(start, line);
  }

  bool ReadHead() {
    const int headLine = line;
    const std::size_t start = Offset(lineStart);
    ++place;
    SkipBlanks();
    const std::string_view name = TakeWord();
    SkipBlanks();
    if (name.empty() || *place != ']') return false;
    ++place;
    const std::uint32_t parent = open.back();
    row[parent + 1] = KvfCell(row[parent + 1].One() + 1, row[parent + 1].Other());
    OpenSection(name.data(), name.size(), headLine);
    strictForm.AtSection(name, Depth());
    if (Depth() == 1) image.targets.push_back({open.back(), start, start});
    return EndLine();
  }

  /// A keyword, or the end of a section. A keyword may have the name of any word, also of the end.
  bool ReadLine() {
    const char* const start = place;
    const std::string_view word = TakeWord();
    SkipBlanks();
    if (word.empty()) return false;
    if (*place == '=' && Depth() > 0) {
      ++place;
      NoteLine();
      strictForm.AtKeyword(word);
      return ReadValues(word) && EndLine();
    }
    if (!EqualIgnoringCase(word, "EndSect") || Depth() == 0) {
      place = start;
      return false;
    }
    const std::size_t comments = image.comments.size();
    const std::string_view closed = image.TextAt(open.back());
    EndSection();
    if (!EndLine()) return false;
    // Every writer of such files names the section there.
    if (image.comments.size() > comments) {
      const KvfComment& comment = image.comments.back();
      std::string_view name(begin + comment.start, comment.size);
      while (!name.empty() && Is(name.front(), kBlank)) name.remove_prefix(1);
      while (!name.empty() && Is(name.back(), kBlank)) name.remove_suffix(1);
      if (name == closed) image.comments.pop_back();
    }
    if (Depth() == 0) image.targets.back().end = std::min(Offset(place) + 1, Offset(end));
    return true;
  }

  /// Reads the values of a keyword, whose cell says how many there are as far as it can.
  bool ReadValues(std::string_view name) {
    const std::uint32_t keyword = Place();
    Append(KvfCell::Type::Keyword, 0, name);
    std::uint32_t count = 0;
    do {
      if (count > 0) ++place;
      SkipBlanks();
      if (count + 1 == KvfCell::kManyParameters) {
        row.insert(row.begin() + keyword + 1, KvfCell(0, 0));
        for (auto& [cell, size] : image.longTexts) cell += cell > keyword ? 1 : 0;
      }
      if (!ReadValue()) return false;
      ++count;
      SkipBlanks();
    } while (*place == ',');
    row[keyword].SetDetail(std::min(count, KvfCell::kManyParameters));
    if (count >= KvfCell::kManyParameters) row[keyword + 1] = KvfCell(count, 0);
    return true;
  }

  bool ReadValue() {
    const char first = *place;
    if (first == '\'' || first == '|') return ReadText(first);
    if (Is(first, kDigit) || first == '+' || first == '-') return ReadNumber();
    const char* const start = place;
    const std::string_view word = TakeWord();
    if (!EqualIgnoringCase(word, "true") && !EqualIgnoringCase(word, "false")) {
      place = start;
      return false;
    }
    AppendValue(KvfValueType::Boolean, word);
    return true;
  }

  void AppendValue(KvfValueType type, std::string_view text) {
    Append(KvfCell::Type::Parameter, static_cast<std::uint32_t>(type), text);
  }

  bool ReadText(char quote) {
    const char* const start = place + 1;
    const auto* stop =
        static_cast<const char*>(std::memchr(start, quote, static_cast<std::size_t>(end - start)));
    if (stop == nullptr) return false;
    const char* from = start;
    while (const void* const feed = std::memchr(from, '\n', static_cast<std::size_t>(stop - from))) {
      place = static_cast<const char*>(feed);
      CountLine();
      from = place + 1;
    }
    place = stop + 1;
    AppendValue(quote == '|' ? KvfValueType::Path : KvfValueType::Quoted,
                {start, static_cast<std::size_t>(stop - start)});
    return true;
  }

  static const char* SkipDigits(const char* from) {
    while (Is(*from, kDigit)) ++from;
    return from;
  }

  bool ReadNumber() {
    const char* const start = place;
    const char* const digits = start + (Is(*start, kDigit) ? 0 : 1);
    const char* stop = SkipDigits(digits);
    if (stop == digits) return false;
    KvfValueType type = KvfValueType::Integer;
    if (*stop == '.') {
      type = KvfValueType::Real;
      stop = SkipDigits(stop + 1);
    }
    if (*stop == 'e' || *stop == 'E') {
      const char* exponent = stop + 1;
      if (*exponent == '+' || *exponent == '-') ++exponent;
      const char* const exponentEnd = SkipDigits(exponent);
      if (exponentEnd > exponent) {
        type = KvfValueType::Real;
        stop = exponentEnd;
      }
    }
    place = stop;
    AppendValue(type, {start, static_cast<std::size_t>(stop - start)});
    return true;
  }

  KvfImage& image;
  std::vector<KvfCell>& row;
  StrictForm strictForm;
  std::vector<std::uint32_t> open;  ///< the places of the sections that are open, the root's first
  const char* const begin;
  const char* const end;  ///< a zero byte is there
  const char* place;
  const char* lineStart;
  int line = 1;
};

}  // namespace

bool ReadKvfImage(KvfImage& image, KvfSyntaxError& error) {
  ImageReader reader(image);
  if (reader.Run()) return true;
  error = reader.Where();
  return false;
}

}  // namespace tessal
