// What a whole process costs: a program is run in a fresh process, and the system says what it took.
#pragma once

#include <functional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace tessal::bench {

struct ProcessCost {
  double seconds;     ///< of the processor, for the program and for the system on its behalf
  double peakBytes;   ///< the most memory that was resident at once
  double pageFaults;  ///< with and without a read from a disk
};

struct ProcessPlace {
  std::string output = "/dev/null";  ///< the file for standard output
  std::string messages;              ///< that for standard error; empty for our own
  std::vector<std::pair<std::string, std::string>> environment;  ///< added to this process's own
};

/// Runs a program by its path with its arguments and waits for its end. Throws `std::runtime_error` when it
/// can not be run or does not end with exit code 0. The system counts the memory of the process that starts
/// another one to the peak of that one, so a program that calls this must be small itself.
ProcessCost RunProcess(const std::vector<std::string>& command, const ProcessPlace& place = {});

/// Does work that takes much memory in a process of its own, to keep this one small. Throws
/// `std::runtime_error` when it failed there.
void InOtherProcess(const std::function<void()>& work);

/// The `main` of a program: calls the work and returns 0, or says what exception it raised and returns 1.
int RunMain(std::string_view program, const std::function<void()>& work);

}  // namespace tessal::bench
