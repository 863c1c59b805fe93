// What a load, a check or an analysis says about a template, as values.
#pragma once

#include <string>
#include <vector>

namespace tessal {
inline namespace v1 {

/// How an operation ended that may be refused, by the template or by the machine.
struct Outcome {
  bool isDone = true;
  std::string reason{};  ///< in words, where it was refused; nothing has changed then

  explicit operator bool() const { return isDone; }
};

/// One message. `tessal explain CODE` has its cause and remedy.
struct TemplateMessage {
  int severity = 0;      ///< 1 notice, 2 warning, 3 critical, 4 fatal
  std::string code{};    ///< stays the same from version to version
  std::string symbol{};  ///< of the element that it is about; empty for the template itself
  std::string text{};    ///< for people
  int line = 0;          ///< of the element's section in the file, from 1; 0 for none
};

/// A name that expressions use and nobody has defined.
struct UndefinedName {
  std::string name{};
  std::vector<std::string> usedBy{};  ///< symbols, each once
};

}  // namespace v1
}  // namespace tessal
