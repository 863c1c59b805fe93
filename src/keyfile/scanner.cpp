#include "keyfile/scanner.h"

#include <array>
#include <cstddef>
#include <cstring>

#include "platform/ascii.h"

namespace tessal {

namespace {

/// What a byte begins.
enum class ByteClass : std::uint8_t {
  Other,
  End,
  Blank,
  LineFeed,
  Letter,
  Digit,
  Sign,
  Slash,
  Quote,
  Bar,
  LeftSquare,
  RightSquare,
  Comma,
  Equals
};

constexpr ByteClass ClassOf(char character) {
  if (IsAsciiDigit(character)) return ByteClass::Digit;
  if (IsWordCharacter(character)) return ByteClass::Letter;
  switch (character) {
    case '\0':
      return ByteClass::End;
    case ' ':
    case '\t':
    case '\r':
      return ByteClass::Blank;
    case '\n':
      return ByteClass::LineFeed;
    case '+':
    case '-':
      return ByteClass::Sign;
    case '/':
      return ByteClass::Slash;
    case '\'':
      return ByteClass::Quote;
    case '|':
      return ByteClass::Bar;
    case '[':
      return ByteClass::LeftSquare;
    case ']':
      return ByteClass::RightSquare;
    case ',':
      return ByteClass::Comma;
    case '=':
      return ByteClass::Equals;
    default:
      return ByteClass::Other;
  }
}

constexpr std::array<ByteClass, 256> kByteClasses = [] {
  std::array<ByteClass, 256> classes{};
  for (std::size_t byte = 0; byte < classes.size(); ++byte) classes[byte] = ClassOf(static_cast<char>(byte));
  return classes;
}();

ByteClass ClassAt(const char* place) {
  return kByteClasses[static_cast<unsigned char>(*place)];
}

/// The bytes that continue a name or keyword.
constexpr std::array<bool, 256> kWordBytes = [] {
  std::array<bool, 256> continues{};
  for (std::size_t byte = 0; byte < continues.size(); ++byte)
    continues[byte] = IsWordCharacter(static_cast<char>(byte));
  return continues;
}();

bool ContinuesWord(const char* place) {
  return kWordBytes[static_cast<unsigned char>(*place)];
}

bool IsDigit(const char* place) {
  return ClassAt(place) == ByteClass::Digit;
}

const char* AfterDigits(const char* place) {
  while (IsDigit(place)) ++place;
  return place;
}

/// The first place of a character in a piece of the text; the end of the piece when it is not there.
const char* Find(const char* from, const char* to, char character) {
  const void* const hit = std::memchr(from, character, static_cast<std::size_t>(to - from));
  return hit == nullptr ? to : static_cast<const char*>(hit);
}

}  // namespace

KeyFileToken KeyFileScan::Next() {
  switch (inside) {
    case KeyFileToken::Comment:
      return CommentText();
    case KeyFileToken::String:
      return QuotedText('\'');
    case KeyFileToken::Path:
      return QuotedText('|');
    default:
      break;
  }
  while (ClassAt(here) == ByteClass::Blank) ++here;
  switch (ClassAt(here)) {
    case ByteClass::Letter:
      return Word();
    case ByteClass::LineFeed:
      ++lines;
      ++here;
      lineStart = here;
      bareFeeds = 0;
      return KeyFileToken::NewLine;
    case ByteClass::Equals:
      return Single(KeyFileToken::Assign);
    case ByteClass::Quote:
      return Start(KeyFileToken::StringStart, KeyFileToken::String);
    case ByteClass::Bar:
      return Start(KeyFileToken::PathStart, KeyFileToken::Path);
    case ByteClass::Digit:
      return Number();
    case ByteClass::Sign:
      return IsDigit(here + 1) ? Number() : Single(KeyFileToken::Other);
    case ByteClass::Slash:
      if (here[1] != '/') return Single(KeyFileToken::Other);
      ++here;
      return Start(KeyFileToken::CommentStart, KeyFileToken::Comment);
    case ByteClass::LeftSquare:
      return Single(KeyFileToken::LeftSquare);
    case ByteClass::RightSquare:
      return Single(KeyFileToken::RightSquare);
    case ByteClass::Comma:
      return Single(KeyFileToken::Comma);
    case ByteClass::End:
      return KeyFileToken::End;
    default:
      return Single(KeyFileToken::Other);
  }
}

KeyFileToken KeyFileScan::Word() {
  piece = here;
  while (ContinuesWord(here)) ++here;
  pieceEnd = here;
  const std::string_view word = Piece().View();
  const auto isWord = [word](std::string_view reserved) { return EqualIgnoringCase(word, reserved); };
  switch (word.size()) {
    case 4:
      return isWord("true") ? KeyFileToken::Boolean : KeyFileToken::Identifier;
    case 5:
      return isWord("false") ? KeyFileToken::Boolean : KeyFileToken::Identifier;
    case 7:
      return isWord("EndSect") ? KeyFileToken::SectionEnd : KeyFileToken::Identifier;
    default:
      return KeyFileToken::Identifier;
  }
}

KeyFileToken KeyFileScan::Number() {
  KeyFileToken token = KeyFileToken::Integer;
  piece = here;
  here = AfterDigits(here + 1);
  if (*here == '.') {
    token = KeyFileToken::Real;
    here = AfterDigits(here + 1);
  }
  if (*here == 'e' || *here == 'E') {
    const char* const digits = here + (here[1] == '+' || here[1] == '-' ? 2 : 1);
    // An E without digits is a word after the number.
    if (IsDigit(digits)) {
      token = KeyFileToken::Real;
      here = AfterDigits(digits);
    }
  }
  pieceEnd = here;
  return token;
}

KeyFileToken KeyFileScan::CommentText() {
  piece = here;
  here = Find(here, end, '\n');
  if (here == end) return KeyFileToken::End;
  inside = KeyFileToken::End;
  pieceEnd = here;
  if (IsBare(here)) ++bareFeeds;
  return KeyFileToken::Comment;
}

void KeyFileScan::CountLinesTo(const char* place) {
  for (here = Find(here, place, '\n'); here != place; here = Find(here + 1, place, '\n')) {
    ++lines;
    if (IsBare(here)) ++bareFeeds;
  }
}

KeyFileToken KeyFileScan::QuotedText(char quote) {
  const KeyFileToken token = inside;
  piece = here;
  pieceEnd = Find(here, end, quote);
  CountLinesTo(pieceEnd);
  if (here == end) return KeyFileToken::End;
  inside = KeyFileToken::End;
  ++here;
  return token;
}

}  // namespace tessal
