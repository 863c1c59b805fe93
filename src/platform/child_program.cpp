#include "platform/child_program.h"

#include <fcntl.h>
#include <poll.h>
#include <spawn.h>
#include <sys/socket.h>
#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <csignal>
#include <cstring>

#include "platform/descriptor.h"

namespace tessal {

namespace {

/// Two connected ends that no other child inherits.
struct Channel {
  Descriptor ours;
  Descriptor theirs;

  /// A child that reads no more must not end this process with a signal, which a pipe would.
  bool OpenForWriting() {
    return Take([](int* ends) { return socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0, ends); });
  }
  bool OpenForReading() {
    return Take([](int* ends) { return pipe2(ends, O_CLOEXEC); });
  }

 private:
  template <class Maker>
  bool Take(Maker make) {
    std::array<int, 2> ends{};
    if (make(ends.data()) != 0) return false;
    ours = Descriptor(ends[0]);
    theirs = Descriptor(ends[1]);
    return true;
  }
};

/// What the child starts with: the two pipes, and signals as a program expects them.
class SpawnSettings final {
 public:
  SpawnSettings(int input, int output) {
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_adddup2(&actions, input, STDIN_FILENO);
    posix_spawn_file_actions_adddup2(&actions, output, STDOUT_FILENO);
    posix_spawnattr_init(&attributes);
    sigset_t reset;
    sigemptyset(&reset);
    sigaddset(&reset, SIGPIPE);
    posix_spawnattr_setsigdefault(&attributes, &reset);
    posix_spawnattr_setflags(&attributes, POSIX_SPAWN_SETSIGDEF);
  }
  SpawnSettings(const SpawnSettings&) = delete;
  SpawnSettings& operator=(const SpawnSettings&) = delete;
  ~SpawnSettings() {
    posix_spawnattr_destroy(&attributes);
    posix_spawn_file_actions_destroy(&actions);
  }

  int Start(pid_t& child, std::vector<std::string> words) const {
    std::vector<char*> pointers;
    pointers.reserve(words.size() + 1);
    for (std::string& word : words) pointers.push_back(word.data());
    pointers.push_back(nullptr);
    return posix_spawnp(&child, pointers.front(), &actions, &attributes, pointers.data(), environ);
  }

 private:
  posix_spawn_file_actions_t actions{};
  posix_spawnattr_t attributes{};
};

/// Writes and reads by turns, so that neither side waits for the other for ever. Ends when the child closes
/// its output; a child that reads no more gets no more.
void Exchange(Descriptor& toChild, Descriptor& fromChild, std::string_view input, std::string& output) {
  std::array<char, 1U << 16U> buffer{};
  while (true) {
    if (input.empty() && toChild.IsOpen()) toChild.Close();
    std::array<pollfd, 2> ends = {pollfd{fromChild.Number(), POLLIN, 0},
                                  pollfd{toChild.IsOpen() ? toChild.Number() : -1, POLLOUT, 0}};
    if (poll(ends.data(), ends.size(), -1) < 0) {
      if (errno == EINTR) continue;
      return;
    }
    if (ends[1].revents != 0) {
      const ssize_t written = send(toChild.Number(), input.data(), input.size(), MSG_DONTWAIT | MSG_NOSIGNAL);
      if (written > 0) input.remove_prefix(static_cast<std::size_t>(written));
      if (written < 0 && errno != EAGAIN && errno != EINTR) input = {};
    }
    if (ends[0].revents == 0) continue;
    const ssize_t count = read(fromChild.Number(), buffer.data(), buffer.size());
    if (count == 0 || (count < 0 && errno != EINTR)) return;
    if (count > 0) output.append(buffer.data(), static_cast<std::size_t>(count));
  }
}

}  // namespace

ChildResult RunChildProgram(const std::string& program, const std::vector<std::string>& arguments,
                            std::string_view input) {
  ChildResult result;
  Channel toChild;
  Channel fromChild;
  if (!toChild.OpenForWriting() || !fromChild.OpenForReading()) {
    result.failure = std::strerror(errno);
    return result;
  }
  std::vector<std::string> words = {program};
  words.insert(words.end(), arguments.begin(), arguments.end());
  pid_t child = 0;
  const int failure =
      SpawnSettings(toChild.theirs.Number(), fromChild.theirs.Number()).Start(child, std::move(words));
  if (failure != 0) {
    result.failure = std::strerror(failure);
    return result;
  }
  result.started = true;
  toChild.theirs.Close();
  fromChild.theirs.Close();
  Exchange(toChild.ours, fromChild.ours, input, result.output);
  if (toChild.ours.IsOpen()) toChild.ours.Close();
  int status = 0;
  while (waitpid(child, &status, 0) < 0 && errno == EINTR) continue;
  result.succeeded = WIFEXITED(status) && WEXITSTATUS(status) == 0;
  if (!result.succeeded) {
    result.failure = WIFEXITED(status) ? "it ended with " + std::to_string(WEXITSTATUS(status))
                                       : "signal " + std::to_string(WTERMSIG(status)) + " ended it";
  }
  return result;
}

}  // namespace tessal
