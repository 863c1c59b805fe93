#include "manual/completions.h"

#include <algorithm>
#include <set>
#include <string_view>

namespace tessal::manual {

namespace {

/// Where the name of the program's function goes.
constexpr std::string_view kMark = "%%";

/// Reads the tables that come before it. A shell function as people write it, but for the names.
constexpr std::string_view kBashEngine = R"sh(
# Offers the words that begin as the present one does.
%%_words() { mapfile -t COMPREPLY < <(compgen -W "$1" -- "$word"); }

# Offers files; with a pattern only those that match it, and folders.
%%_files() {
  compopt -o filenames 2>/dev/null
  if [ -z "${1:-}" ]; then
    mapfile -t COMPREPLY < <(compgen -f -- "$word")
  else
    mapfile -t COMPREPLY < <(compgen -f -X "!$1" -- "$word"; compgen -d -- "$word")
  fi
}

%%_offer() {
  case $1 in
    templates) %%_files '*.tessal' ;;
    files) %%_files ;;
    words:*) %%_words "${1#words:}" ;;
  esac
}

%%() {
  local word=${COMP_WORDS[COMP_CWORD]} last=$((COMP_CWORD - 1)) path=${COMP_WORDS[0]##*/} place=1
  local commands='' options='' arguments='' valued='' offer='' count=0
  COMPREPLY=()
  # Readline takes the sign of --option=value for a word of its own.
  [ "$word" = = ] && word='' last=$COMP_CWORD
  [ "${COMP_WORDS[last]}" = = ] && last=$((last - 1))
  %%_describe "$path"
  while [ -n "$commands" ] && [ $place -lt "$COMP_CWORD" ]; do
    [[ ${COMP_WORDS[place]} != -* ]] && path="$path ${COMP_WORDS[place]}" && %%_describe "$path"
    place=$((place + 1))
  done
  if [[ " $valued " == *" ${COMP_WORDS[last]} "* ]]; then
    %%_value "$path ${COMP_WORDS[last]}"
    %%_offer "$offer"
    return
  fi
  if [[ $word == -* ]]; then
    %%_words "$options"
    return
  fi
  if [ -n "$commands" ]; then
    %%_words "$commands"
    return
  fi
  for ((; place < COMP_CWORD; ++place)); do
    [[ ${COMP_WORDS[place]} == -?* || ${COMP_WORDS[place]} == = ]] && continue
    [ "${COMP_WORDS[place - 1]}" = = ] && continue
    [[ " $valued " == *" ${COMP_WORDS[place - 1]} "* ]] || count=$((count + 1))
  done
  local list=($arguments)
  [ $count -ge ${#list[@]} ] && [[ $arguments == *+ ]] && count=$((${#list[@]} - 1))
  %%_offer "${list[count]%+}"
}
)sh";

constexpr std::string_view kFishEngine = R"sh(
# The words of the call that are no options, nor values of options.
function %%_words
    set -l before
    for word in (commandline -opc)
        if contains -- "$before" $%%_valued
            set before
            continue
        end
        set before $word
        string match -q -- '-?*' $word; or echo $word
    end
end

# Whether the call has come to this command, and, with a number, to that argument of it.
function %%_at
    set -l depth (count (string split ' ' -- $argv[1]))
    set -l words (%%_words)
    test "$words[1..$depth]" = "$argv[1]"; or return 1
    set -q argv[2]; or return 0
    set -l place (math (count $words) - $depth + 1)
    test $place -eq $argv[2]; or begin
        set -q argv[3]; and test $place -gt $argv[2]
    end
end
)sh";

std::string Replaced(std::string_view text, std::string_view mark, std::string_view by) {
  std::string made;
  while (!text.empty()) {
    const std::size_t place = text.find(mark);
    made += text.substr(0, place);
    if (place == std::string_view::npos) break;
    made += by;
    text.remove_prefix(place + mark.size());
  }
  return made;
}

/// "tessal-editor" as the name of a function.
std::string FunctionName(const Command& program) {
  return "_" + Replaced(program.name, "-", "_");
}

std::string Joined(const std::vector<std::string>& words) {
  std::string joined;
  for (const std::string& word : words) joined += (joined.empty() ? "" : " ") + word;
  return joined;
}

std::string Quoted(std::string_view text) {
  return "'" + Replaced(text, "'", "'\\''") + "'";
}

std::string_view WordOf(Offer offer) {
  switch (offer) {
    case Offer::Templates:
      return "templates";
    case Offer::Files:
      return "files";
    default:
      return "nothing";
  }
}

/// The options of all commands that take a value: none is a flag in one and takes a value in another.
std::vector<std::string> ValuedOptions(const Command& program) {
  std::set<std::string> valued;
  ForEachCommand(program, [&valued](const Command& command) {
    for (const CallPart& option : command.options) {
      if (!option.value.empty()) valued.insert(option.names.begin(), option.names.end());
    }
  });
  return {valued.begin(), valued.end()};
}

std::vector<std::string> NamesOf(const std::vector<Command>& commands) {
  std::vector<std::string> names;
  names.reserve(commands.size());
  for (const Command& command : commands) names.push_back(command.name);
  return names;
}

std::string BashRow(const Command& command) {
  std::vector<std::string> options;
  for (const CallPart& option : command.options) {
    options.insert(options.end(), option.names.begin(), option.names.end());
  }
  std::vector<std::string> arguments;
  for (const CallPart& argument : command.arguments) {
    arguments.push_back(std::string(WordOf(argument.offer)) + (argument.isRepeated ? "+" : ""));
  }
  return "    " + Quoted(command.path) + ") commands=" + Quoted(Joined(NamesOf(command.commands))) +
         " options=" + Quoted(Joined(options)) + " arguments=" + Quoted(Joined(arguments)) + " ;;\n";
}

std::string BashValueRow(const Command& command, const CallPart& option) {
  const std::string offer =
      option.offer == Offer::Words ? "words:" + Joined(option.words) : std::string(WordOf(option.offer));
  std::string patterns;
  for (const std::string& name : option.names) {
    patterns += (patterns.empty() ? "" : " | ") + Quoted(command.path + " " + name);
  }
  return "    " + patterns + ") offer=" + Quoted(offer) + " ;;\n";
}

/// A description within the description of an argument of zsh.
std::string ZshText(std::string_view text) {
  return Replaced(Replaced(Replaced(text, "[", "("), "]", ")"), ":", " -");
}

std::string ZshAction(const CallPart& part) {
  switch (part.offer) {
    case Offer::Templates:
      return "_files -g \"*.tessal\"";
    case Offer::Files:
      return "_files";
    case Offer::Words:
      return "(" + Joined(part.words) + ")";
    default:
      return " ";
  }
}

std::string ZshSpecifications(const Command& command) {
  std::string text;
  for (const CallPart& option : command.options) {
    const std::string others = option.names.size() > 1 ? "(" + Joined(option.names) + ")" : "";
    for (const std::string& name : option.names) {
      const bool isLong = name.starts_with("--");
      std::string row = (others.empty() && !option.value.empty() ? "*" : others) + name;
      if (!option.value.empty()) row += isLong ? "=" : "+";
      row += "[" + ZshText(option.meaning) + "]";
      if (!option.value.empty()) row += ":" + ZshText(option.value) + ":" + ZshAction(option);
      text += " \\\n        " + Quoted(row);
    }
  }
  for (const CallPart& argument : command.arguments) {
    const std::string place = argument.isRepeated ? "*:" : argument.isRequired ? ":" : "::";
    text += " \\\n        " + Quoted(place + ZshText(argument.names.front()) + ":" + ZshAction(argument));
  }
  return text;
}

void AddZshFunction(std::string& text, const std::string& name, const Command& command) {
  text += "\n" + name + "() {\n";
  if (command.commands.empty()) {
    text += "  _arguments -s" + ZshSpecifications(command) + "\n}\n";
    return;
  }
  text += "  local line state\n  local -a commands=(\n";
  for (const Command& each : command.commands) {
    text += "    " + Quoted(each.name + ":" + ZshText(each.meaning)) + "\n";
  }
  text += "  )\n  _arguments -C -s" + ZshSpecifications(command) +
          " \\\n        '1:command:->command' '*::argument:->argument'\n"
          "  case $state in\n    command) _describe command commands ;;\n    argument)\n"
          "      case $line[1] in\n";
  for (const Command& each : command.commands) {
    text += "        " + each.name + ") " + name + "_" + each.name + " ;;\n";
  }
  text += "      esac\n      ;;\n  esac\n}\n";
  for (const Command& each : command.commands) AddZshFunction(text, name + "_" + each.name, each);
}

std::string FishOption(const CallPart& option) {
  std::string text;
  for (const std::string& name : option.names) {
    const bool isLong = name.starts_with("--");
    text += std::string(isLong ? " -l " : " -s ") + name.substr(isLong ? 2 : 1);
  }
  if (option.offer == Offer::Words) text += " -x -a " + Quoted(Joined(option.words));
  if (option.offer == Offer::Files) text += " -r -F";
  if (option.offer == Offer::Nothing && !option.value.empty()) text += " -x";
  return text + " -d " + Quoted(option.meaning);
}

void AddFishCommand(std::string& text, const std::string& program, const std::string& function,
                    const Command& command) {
  const std::string start = "complete -c " + program + " -n ";
  const auto at = [&](std::size_t place, bool isRepeated) {
    return Quoted(function + "_at \"" + command.path + "\" " + std::to_string(place) +
                  (isRepeated ? " more" : ""));
  };
  for (const Command& each : command.commands) {
    text += start;
    text += at(1, false) + " -a " + each.name + " -d " + Quoted(each.meaning) + "\n";
  }
  for (const CallPart& option : command.options) {
    text += start;
    text += Quoted(function + "_at \"" + command.path + "\"") + FishOption(option) + "\n";
  }
  for (std::size_t place = 0; place < command.arguments.size(); ++place) {
    const CallPart& argument = command.arguments[place];
    if (argument.offer == Offer::Templates) {
      text += start + at(place + 1, argument.isRepeated) + " -k -a '(__fish_complete_suffix .tessal)'\n";
    } else if (argument.offer == Offer::Files) {
      text += start + at(place + 1, argument.isRepeated) + " -F\n";
    }
  }
}

}  // namespace

std::string BashCompletion(const Command& program) {
  const std::string function = FunctionName(program);
  std::string text = "# Completion of " + program.name + " for bash.\n\n";
  text += function + "_describe() {\n  valued=" + Quoted(Joined(ValuedOptions(program))) +
          "\n  commands='' options='' arguments=''\n  case $1 in\n";
  ForEachCommand(program, [&text](const Command& command) { text += BashRow(command); });
  text += "  esac\n}\n\n" + function + "_value() {\n  offer=''\n  case $1 in\n";
  ForEachCommand(program, [&text](const Command& command) {
    for (const CallPart& option : command.options) {
      if (!option.value.empty()) text += BashValueRow(command, option);
    }
  });
  text += "  esac\n}\n";
  text += Replaced(kBashEngine, kMark, function);
  return text + "\ncomplete -F " + function + " " + program.name + "\n";
}

std::string ZshCompletion(const Command& program) {
  const std::string function = FunctionName(program);
  std::string text = "#compdef " + program.name + "\n# Completion of " + program.name + " for zsh.\n";
  AddZshFunction(text, function, program);
  return text + "\n" + function + " \"$@\"\n";
}

std::string FishCompletion(const Command& program) {
  const std::string function = "_" + FunctionName(program);
  std::string text = "# Completion of " + program.name + " for fish.\n\nset -g " + function + "_valued " +
                     Joined(ValuedOptions(program)) + "\n" + Replaced(kFishEngine, kMark, function) +
                     "\ncomplete -c " + program.name + " -f\n";
  ForEachCommand(program,
                 [&](const Command& command) { AddFishCommand(text, program.name, function, command); });
  return text;
}

}  // namespace tessal::manual
