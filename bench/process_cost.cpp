#include "process_cost.h"

#include <fcntl.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>
#include <cstdlib>
#include <exception>
#include <iostream>
#include <stdexcept>
#include <system_error>

namespace tessal::bench {

namespace {

/// What a shell reports for a program that it can not run.
constexpr int kNotRun = 127;

/// Lets what is written to a descriptor go to a file.
void SendTo(const std::string& path, int descriptor) {
  const int file = open(path.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0644);
  if (file < 0 || dup2(file, descriptor) < 0) _exit(kNotRun);
  close(file);
}

[[noreturn]] void BecomeProgram(const std::vector<std::string>& command, const ProcessPlace& place) {
  SendTo(place.output, STDOUT_FILENO);
  if (!place.messages.empty()) SendTo(place.messages, STDERR_FILENO);
  for (const auto& [name, value] : place.environment) setenv(name.c_str(), value.c_str(), 1);
  std::vector<char*> arguments;
  for (const std::string& word : command) arguments.push_back(const_cast<char*>(word.c_str()));
  arguments.push_back(nullptr);
  execv(arguments.front(), arguments.data());
  _exit(kNotRun);
}

double Seconds(const timeval& time) {
  constexpr double kMicrosecond = 1e-6;
  return static_cast<double>(time.tv_sec) + static_cast<double>(time.tv_usec) * kMicrosecond;
}

pid_t Fork() {
  std::cout.flush();
  const pid_t child = fork();
  if (child < 0) throw std::system_error(errno, std::generic_category(), "no new process");
  return child;
}

/// Waits for a child that is to end with exit code 0.
rusage UsageOf(pid_t child, const std::string& name) {
  int status = 0;
  rusage usage = {};
  while (wait4(child, &status, 0, &usage) < 0) {
    if (errno != EINTR) throw std::system_error(errno, std::generic_category(), "lost " + name);
  }
  if (WIFSIGNALED(status)) {
    throw std::runtime_error(name + " was ended by signal " + std::to_string(WTERMSIG(status)));
  }
  if (const int code = WEXITSTATUS(status); code == kNotRun) {
    throw std::runtime_error(name + " can not be run");
  } else if (code != 0) {
    throw std::runtime_error(name + " failed with exit code " + std::to_string(code));
  }
  return usage;
}

}  // namespace

ProcessCost RunProcess(const std::vector<std::string>& command, const ProcessPlace& place) {
  const pid_t child = Fork();
  if (child == 0) BecomeProgram(command, place);
  std::string name;
  for (const std::string& word : command) name += (name.empty() ? "" : " ") + word;
  const rusage usage = UsageOf(child, name);
  constexpr double kKilobyte = 1024;
  return {.seconds = Seconds(usage.ru_utime) + Seconds(usage.ru_stime),
          .peakBytes = static_cast<double>(usage.ru_maxrss) * kKilobyte,
          .pageFaults = static_cast<double>(usage.ru_minflt + usage.ru_majflt)};
}

void InOtherProcess(const std::function<void()>& work) {
  const pid_t child = Fork();
  if (child == 0) _exit(RunMain("in another process", work));
  UsageOf(child, "work in another process");
}

int RunMain(std::string_view program, const std::function<void()>& work) {
  try {
    work();
    return 0;
  } catch (const std::exception& failure) {
    std::cerr << program << ": " << failure.what() << '\n';
    return 1;
  }
}

}  // namespace tessal::bench
