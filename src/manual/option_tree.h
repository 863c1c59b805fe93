// The commands of a program as its manual and its completions need them: what the option parser knows,
// without the parser.
#pragma once

#include <string>
#include <vector>

namespace CLI {
class App;
}

namespace tessal::manual {

/// What can be offered in the place of a value.
enum class Offer { Nothing, Templates, Files, Words };

/// An option, or an argument in a place of its own.
struct CallPart {
  std::vector<std::string> names;  ///< "--format"; of an argument "FILE"
  std::string value;               ///< the name of an option's value; empty for a flag or an argument
  std::string meaning;
  Offer offer = Offer::Nothing;
  std::vector<std::string> words;  ///< with `Offer::Words`
  bool isRequired = false;
  bool isRepeated = false;
};

struct Command {
  std::string name;
  std::string path;  ///< with the commands above, "tessal expr parse"
  std::string group;
  std::string meaning;
  std::vector<CallPart> arguments;
  std::vector<CallPart> options;
  std::vector<Command> commands;
};

/// The tool, with all its commands.
Command ToolTree();
/// The editor.
Command EditorTree();

/// Calls the visitor with the command and all below it, a command before those below it.
template <class Visitor>
void ForEachCommand(const Command& command, Visitor visit) {
  visit(command);
  for (const Command& each : command.commands) ForEachCommand(each, visit);
}

}  // namespace tessal::manual
