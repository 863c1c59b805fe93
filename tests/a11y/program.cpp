#include "a11y/program.h"

#include <fcntl.h>
#include <poll.h>
#include <signal.h>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <cstdlib>
#include <filesystem>
#include <sstream>
#include <system_error>
#include <thread>

namespace tessal::test {

namespace {

using Clock = std::chrono::steady_clock;

/// Between the fork and the program: nothing here may take memory.
[[noreturn]] void Become(std::vector<char*>& words, pid_t test) {
  setpgid(0, 0);
  prctl(PR_SET_PDEATHSIG, SIGKILL);
  if (getppid() != test) _exit(1);
  execvp(words.front(), words.data());
  constexpr int kNotFound = 127;
  _exit(kNotFound);
}

}  // namespace

Program::Program(std::vector<std::string> words) {
  std::array<int, 2> ends{};
  if (pipe(ends.data()) != 0) throw std::system_error(errno, std::generic_category(), "pipe");
  reports = ends[0];
  fcntl(reports, F_SETFD, FD_CLOEXEC);
  std::vector<char*> arguments;
  for (std::string& word : words) {
    if (const auto place = word.find("{report}"); place != std::string::npos)
      word.replace(place, std::string("{report}").size(), std::to_string(ends[1]));
    arguments.push_back(word.data());
  }
  arguments.push_back(nullptr);
  const pid_t test = getpid();
  process = fork();
  if (process == 0) Become(arguments, test);
  close(ends[1]);
  if (process < 0) throw std::system_error(errno, std::generic_category(), "fork");
  setpgid(process, process);
}

Program::~Program() {
  constexpr std::chrono::seconds kGrace(2);
  kill(-process, SIGTERM);
  for (const auto end = Clock::now() + kGrace; IsRunning() && Clock::now() < end;)
    std::this_thread::sleep_for(std::chrono::milliseconds(2));
  kill(-process, SIGKILL);
  waitpid(process, nullptr, 0);
  close(reports);
}

bool Program::IsRunning() const {
  // It stays to be waited for, so that its number belongs to nobody else.
  siginfo_t ended{};
  return waitid(P_PID, static_cast<id_t>(process), &ended, WEXITED | WNOHANG | WNOWAIT) == 0 &&
         ended.si_pid == 0;
}

std::string Program::FirstReport(std::chrono::milliseconds limit) const {
  const auto end = Clock::now() + limit;
  std::string line;
  for (char letter = 0; letter != '\n';) {
    const auto left = std::chrono::duration_cast<std::chrono::milliseconds>(end - Clock::now()).count();
    pollfd ready{reports, POLLIN, 0};
    if (left <= 0 || poll(&ready, 1, static_cast<int>(left)) <= 0 || read(reports, &letter, 1) != 1)
      return {};
    if (letter != '\n') line += letter;
  }
  return line;
}

bool CanRun(const std::string& program) {
  if (program.find('/') != std::string::npos) return access(program.c_str(), X_OK) == 0;
  const char* path = std::getenv("PATH");
  std::istringstream folders(path == nullptr ? "" : path);
  for (std::string folder; std::getline(folders, folder, ':');) {
    if (access((std::filesystem::path(folder) / program).c_str(), X_OK) == 0) return true;
  }
  return false;
}

}  // namespace tessal::test
