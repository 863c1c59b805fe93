#include <poll.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <cstring>
#include <string>

#include "cli/commands.h"
#include "cli/lsp/message_frames.h"
#include "cli/lsp/server.h"

namespace tessal::cli {

namespace {

/// Standard input as it comes.
class InputBytes final {
 public:
  /// Waits for bytes and adds them; false at the end.
  bool Read(FrameBuffer& frames) {
    ssize_t size = 0;
    do {
      size = read(STDIN_FILENO, bytes.data(), bytes.size());
    } while (size < 0 && errno == EINTR);
    if (size < 0) failure = std::strerror(errno);
    if (size > 0) frames.Add({bytes.data(), static_cast<std::size_t>(size)});
    return size > 0;
  }
  /// Whether more has come already.
  static bool HasMore() {
    pollfd input{STDIN_FILENO, POLLIN, 0};
    return poll(&input, 1, 0) > 0 && (input.revents & POLLIN) != 0;
  }
  const std::string& Failure() const { return failure; }

 private:
  static constexpr std::size_t kSize = 65536;
  std::array<char, kSize> bytes{};
  std::string failure;
};

}  // namespace

ExitCode RunLanguageServer() {
  // The JSON library loses a failed allocation.
  const EndsWithoutMemory end;
  LanguageServer server([](std::string_view body) { Print(Framed(body)); });
  FrameBuffer frames;
  InputBytes input;
  bool isOpen = true;
  while (isOpen && !server.HasExited() && frames.Failure().empty()) {
    // All that has come is in the queue before it is answered: a request may be cancelled there, and of many
    // changes only the last is published.
    do {
      isOpen = input.Read(frames);
      if (!isOpen) frames.End();
      while (const auto body = frames.Take()) server.Receive(*body);
    } while (isOpen && InputBytes::HasMore());
    server.Work();
    if (!FlushOutput()) return kCallFault;
  }
  const std::string& failure = frames.Failure().empty() ? input.Failure() : frames.Failure();
  if (!failure.empty()) {
    Complain(failure);
    return kCallFault;
  }
  return server.ExitCode() == 0 ? kFine : kContentFault;
}

}  // namespace tessal::cli
