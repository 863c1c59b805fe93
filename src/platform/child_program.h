// Another program that turns a text into a text: it is found on the search path, gets the text on its
// standard input, and gives its result on its standard output. No shell is in between, and no file is
// written.
#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace tessal {

struct ChildResult {
  bool started = false;  ///< false where there is no such program
  bool succeeded = false;
  std::string output;
  std::string failure;  ///< why it did not start or succeed, in words
};

/// Runs a program to its end. What it prints on standard error goes to that of this process.
ChildResult RunChildProgram(const std::string& program, const std::vector<std::string>& arguments,
                            std::string_view input);

}  // namespace tessal
