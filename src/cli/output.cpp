#include "cli/output.h"

#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <system_error>
#include <utility>

#include "platform/text_encoding.h"

namespace tessal::cli {

namespace {

constexpr std::size_t kEnough = 1U << 16U;

struct Pending {
  std::string text;
  bool failed = false;
};

Pending& PendingOutput() {
  static Pending pending;
  return pending;
}

void WriteOut(Pending& pending) {
  std::string_view rest = pending.text;
  while (!rest.empty() && !pending.failed) {
    const ssize_t written = write(STDOUT_FILENO, rest.data(), rest.size());
    if (written >= 0) {
      rest.remove_prefix(static_cast<std::size_t>(written));
    } else if (errno == EPIPE) {
      // The reader has seen enough.
      std::_Exit(kFine);
    } else if (errno != EINTR) {
      pending.failed = true;
      Complain(std::string("can not write the result: ") + std::strerror(errno));
    }
  }
  pending.text.clear();
}

/// Reads what is there of standard input; false at its end.
bool ReadMore(std::string& text) {
  std::array<char, 1U << 14U> buffer{};
  ssize_t count = 0;
  while ((count = read(STDIN_FILENO, buffer.data(), buffer.size())) < 0) {
    if (errno != EINTR)
      throw std::system_error(errno, std::generic_category(), "can not read standard input");
  }
  text.append(buffer.data(), static_cast<std::size_t>(count));
  return count > 0;
}

constexpr unsigned char kFirstPrintable = 0x20;
constexpr unsigned char kDelete = 0x7F;
constexpr unsigned char kHighControls = 0x80;
constexpr unsigned char kFirstHighPrintable = 0xA0;

unsigned char ByteAt(std::string_view text, std::size_t place) {
  return place < text.size() ? static_cast<unsigned char>(text[place]) : 0;
}

/// How many bytes there make a control character; 0 for none. A byte that continues a character of UTF-8 is
/// none.
std::size_t ControlAt(std::string_view text, std::size_t place) {
  constexpr unsigned char kUtf8Lead = 0xC2;
  const unsigned char byte = ByteAt(text, place);
  const auto isHigh = [](unsigned char each) { return each >= kHighControls && each < kFirstHighPrintable; };
  if (byte < kFirstPrintable || byte == kDelete || isHigh(byte)) return 1;
  return byte == kUtf8Lead && isHigh(ByteAt(text, place + 1)) ? 2 : 0;
}

/// How many bytes the character there has: one where the bytes are not UTF-8.
std::size_t LengthAt(std::string_view text, std::size_t place) {
  for (std::size_t length = 2; length <= 4; ++length) {
    const std::string_view sequence = text.substr(place, length);
    if (ByteAt(text, place) >= 0xC2 && sequence.size() == length && IsUtf8(sequence)) return length;
  }
  return 1;
}

/// Blanks in the place of control characters but the kept ones.
std::string Cleaned(std::string_view text, std::string_view kept) {
  std::string clean;
  clean.reserve(text.size());
  for (std::size_t place = 0; place < text.size();) {
    const std::size_t control = ControlAt(text, place);
    const std::size_t length = control > 0 ? control : LengthAt(text, place);
    if (control > 0 && kept.find(text[place]) == std::string_view::npos) {
      clean += ' ';
    } else {
      clean += text.substr(place, length);
    }
    place += length;
  }
  return clean;
}

}  // namespace

ExitCode Worse(ExitCode left, ExitCode right) {
  return std::max(left, right);
}

void Print(std::string_view text) {
  Pending& pending = PendingOutput();
  pending.text += text;
  if (pending.text.size() >= kEnough) WriteOut(pending);
}

void PrintLine(std::string_view text) {
  Print(text);
  Print("\n");
}

bool FlushOutput() {
  Pending& pending = PendingOutput();
  WriteOut(pending);
  return !pending.failed;
}

void Complain(std::string_view text) {
  const std::string shown = isatty(STDERR_FILENO) != 0 ? Cleaned(text, "\n\t") : std::string(text);
  std::fprintf(stderr, "tessal: %s\n", shown.c_str());
}

void ComplainOfMemory() {
  constexpr std::string_view kLine = "tessal: not enough memory\n";
  // Standard error is as it is; nobody is left who could be told of another failure.
  [[maybe_unused]] const ssize_t written = write(STDERR_FILENO, kLine.data(), kLine.size());
}

EndsWithoutMemory::EndsWithoutMemory()
    : former(std::set_new_handler([] {
        ComplainOfMemory();
        std::_Exit(kCallFault);
      })) {}

std::optional<std::string> InputLines::Next() {
  std::size_t searched = start;
  std::size_t end = 0;
  while ((end = buffered.find('\n', searched)) == std::string::npos && !ended) {
    // Only what no line has taken is kept.
    buffered.erase(0, start);
    start = 0;
    searched = buffered.size();
    ended = !ReadMore(buffered);
  }
  if (end == std::string::npos && start == buffered.size()) return std::nullopt;
  std::string line = buffered.substr(start, end - start);
  start = std::min(end, buffered.size() - 1) + 1;
  return line;
}

std::string ReadStandardInput() {
  std::string text;
  while (ReadMore(text)) continue;
  return text;
}

bool WantsColour() {
  const char* forbidden = std::getenv("NO_COLOR");
  return isatty(STDOUT_FILENO) != 0 && (forbidden == nullptr || *forbidden == '\0');
}

std::string Coloured(std::string_view word, unsigned level) {
  if (!WantsColour()) return std::string(word);
  constexpr std::array<std::string_view, 5> kColours = {"36", "34", "33", "31", "1;31"};
  const std::string_view colour = kColours[level < kColours.size() ? level : 0];
  return "\x1b[" + std::string(colour) + "m" + std::string(word) + "\x1b[0m";
}

std::string OnOneLine(std::string_view text) {
  std::string line(text);
  for (char& character : line) {
    const auto byte = static_cast<unsigned char>(character);
    if (byte < kFirstPrintable || byte == kDelete) character = ' ';
  }
  return ForTerminal(std::move(line));
}

std::string ForTerminal(std::string text) {
  return isatty(STDOUT_FILENO) != 0 ? Cleaned(text, "\r\n\t") : std::move(text);
}

std::string_view WithoutLineFeed(std::string_view text) {
  if (text.ends_with('\n')) text.remove_suffix(1);
  return text;
}

}  // namespace tessal::cli
