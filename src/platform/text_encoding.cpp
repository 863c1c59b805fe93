#include "platform/text_encoding.h"

#include <algorithm>
#include <array>
#include <cstdint>

namespace tessal {

namespace {

/// Windows-1252 from 0x80 to 0x9F; elsewhere it is Latin-1. The five bytes without a character of their own
/// represent the control characters of the same number.
constexpr std::array<char16_t, 32> kHighControls = {
    0x20AC, 0x0081, 0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021, 0x02C6, 0x2030, 0x0160,
    0x2039, 0x0152, 0x008D, 0x017D, 0x008F, 0x0090, 0x2018, 0x2019, 0x201C, 0x201D, 0x2022,
    0x2013, 0x2014, 0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0x009D, 0x017E, 0x0178};
constexpr std::uint32_t kFirstHighControl = 0x80;

constexpr std::uint32_t kLeadTwo = 0xC0;
constexpr std::uint32_t kLeadThree = 0xE0;
constexpr std::uint32_t kLeadFour = 0xF0;
constexpr std::uint32_t kContinuation = 0x80;
constexpr std::uint32_t kPayload = 0x3F;
constexpr unsigned kPayloadBits = 6;

std::uint32_t ByteAt(std::string_view bytes, std::size_t place) {
  return static_cast<unsigned char>(bytes[place]);
}

/// How many bytes a sequence has, by its first one; 0 for a byte that starts none.
std::size_t SequenceLength(std::uint32_t lead) {
  if (lead < kContinuation) return 1;
  if (lead >= 0xC2 && lead < kLeadThree) return 2;
  if (lead >= kLeadThree && lead < kLeadFour) return 3;
  return lead >= kLeadFour && lead <= 0xF4 ? 4 : 0;
}

/// Takes one character off the text; nothing when it does not start with a valid sequence.
std::optional<std::uint32_t> TakeCharacter(std::string_view& bytes) {
  constexpr std::array<std::uint32_t, 5> kLeadPayload = {0, 0x7F, 0x1F, 0x0F, 0x07};
  constexpr std::array<std::uint32_t, 5> kSmallest = {0, 0, 0x80, 0x800, 0x10000};
  const std::size_t length = SequenceLength(ByteAt(bytes, 0));
  if (length == 0 || length > bytes.size()) return std::nullopt;
  std::uint32_t character = ByteAt(bytes, 0) & kLeadPayload[length];
  for (std::size_t place = 1; place < length; ++place) {
    const std::uint32_t byte = ByteAt(bytes, place);
    if ((byte & kLeadTwo) != kContinuation) return std::nullopt;
    character = character << kPayloadBits | (byte & kPayload);
  }
  const bool isSurrogate = character >= 0xD800 && character <= 0xDFFF;
  if (character < kSmallest[length] || character > 0x10FFFF || isSurrogate) return std::nullopt;
  bytes.remove_prefix(length);
  return character;
}

/// Characters of Windows-1252 need at most three bytes.
void AppendUtf8(std::uint32_t character, std::string& text) {
  constexpr std::uint32_t kTwoBytes = 0x80;
  constexpr std::uint32_t kThreeBytes = 0x800;
  const auto append = [&text](std::uint32_t byte) { text += static_cast<char>(byte); };
  if (character < kTwoBytes) {
    append(character);
  } else if (character < kThreeBytes) {
    append(kLeadTwo | character >> kPayloadBits);
    append(kContinuation | (character & kPayload));
  } else {
    append(kLeadThree | character >> (2 * kPayloadBits));
    append(kContinuation | (character >> kPayloadBits & kPayload));
    append(kContinuation | (character & kPayload));
  }
}

std::uint32_t FromWindows1252(std::uint32_t byte) {
  const std::uint32_t place = byte - kFirstHighControl;
  return byte >= kFirstHighControl && place < kHighControls.size() ? kHighControls[place] : byte;
}

}  // namespace

bool IsUtf8(std::string_view bytes) {
  while (!bytes.empty()) {
    if (!TakeCharacter(bytes)) return false;
  }
  return true;
}

TextEncoding EncodingOf(std::string_view bytes) {
  return IsUtf8(bytes) ? TextEncoding::Utf8 : TextEncoding::Windows1252;
}

std::string ToUtf8(std::string_view bytes) {
  if (IsUtf8(bytes)) return std::string(bytes);
  std::string text;
  for (const char byte : bytes) AppendUtf8(FromWindows1252(static_cast<unsigned char>(byte)), text);
  return text;
}

std::optional<std::string> Utf8ToWindows1252(std::string_view text) {
  constexpr std::uint32_t kLastLatin1 = 0xFF;
  std::string bytes;
  while (!text.empty()) {
    const std::optional<std::uint32_t> character = TakeCharacter(text);
    if (!character) return std::nullopt;
    const auto hit = std::find(kHighControls.begin(), kHighControls.end(), *character);
    if (hit != kHighControls.end()) {
      bytes += static_cast<char>(kFirstHighControl + static_cast<std::uint32_t>(hit - kHighControls.begin()));
    } else if (*character <= kLastLatin1) {
      bytes += static_cast<char>(*character);
    } else {
      return std::nullopt;
    }
  }
  return bytes;
}

std::string EncodedText(std::string text, TextEncoding encoding) {
  if (encoding == TextEncoding::Utf8) return text;
  // A character that the encoding lacks, or bytes that would show as others.
  std::optional<std::string> bytes = Utf8ToWindows1252(text);
  return bytes && ToUtf8(*bytes) == text ? *std::move(bytes) : text;
}

}  // namespace tessal
