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
  std::fprintf(stderr, "tessal: %.*s\n", static_cast<int>(text.size()), text.data());
}

std::string ReadStandardInput() {
  std::string text;
  std::array<char, 1U << 14U> buffer{};
  ssize_t count = 0;
  while ((count = read(STDIN_FILENO, buffer.data(), buffer.size())) != 0) {
    if (count < 0 && errno != EINTR) {
      throw std::system_error(errno, std::generic_category(), "can not read standard input");
    }
    if (count > 0) text.append(buffer.data(), static_cast<std::size_t>(count));
  }
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
    constexpr unsigned char kFirstPrintable = 0x20;
    constexpr unsigned char kDelete = 0x7F;
    if (byte < kFirstPrintable || byte == kDelete) character = ' ';
  }
  return line;
}

std::string_view WithoutLineFeed(std::string_view text) {
  if (text.ends_with('\n')) text.remove_suffix(1);
  return text;
}

}  // namespace tessal::cli
