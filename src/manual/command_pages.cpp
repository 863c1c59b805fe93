// The pages of the two programs: what they are called with, and what goes with every call.
#include <algorithm>
#include <span>

#include "manual/option_tree.h"
#include "manual/pages.h"
#include "manual/roff.h"

namespace tessal::manual {

namespace {

constexpr std::string_view kUserCommands = "User Commands";

struct Fact {
  std::string_view term;
  std::string_view meaning;
};

constexpr Fact kExitCodes[] = {
    {"0", "All is well."},
    {"1", "The content is at fault: findings, differences, an expression that does not parse."},
    {"2", "The call or the machine is at fault: a wrong option, a file that cannot be read or written."},
};

constexpr Fact kToolEnvironment[] = {
    {"NO_COLOR", "When it is set, nothing is printed in colour. Colour goes to a terminal only in any case."},
};

constexpr Fact kToolFiles[] = {
    {"HTML_doc", "The folder beside a template that takes its HTML page where no other file is named."},
    {"TESSALpH.set",
     "Settings of the carbonate system, read from the present folder where it has this file."},
};

struct Example {
  std::string_view call;
  std::string_view meaning;
};

constexpr Example kExamples[] = {
    {"tessal check models/", "Checks all templates in a folder."},
    {"tessal check --format sarif model.tessal > findings.sarif",
     "Writes the messages in the form that code hosts show beside a change."},
    {"tessal rename model.tessal k1 kd", "Gives a symbol another name, with all its uses."},
    {"tessal balance model.tessal --pool 'N=NH4+NO3'", "Checks that no nitrogen appears or is lost."},
    {"tessal expr parse 'k*(C - Cs)'", "Shows how an expression is read."},
    {"tessal call CALC_PH 2000 2300 35 25 0 --set SET_K1K2_OPTION=10",
     "Computes a function with a setting of the carbonate system."},
};

std::string TermOf(const CallPart& part) {
  std::string term;
  for (const std::string& name : part.names) {
    if (!term.empty()) term += ", ";
    term += name.starts_with('-') ? Typed(name) : Placeholder(name);
  }
  if (!part.value.empty()) term += " " + Placeholder(part.value);
  return term;
}

/// "prints the tree" as a sentence.
std::string Sentence(std::string_view meaning) {
  std::string sentence(meaning);
  if (!sentence.empty() && sentence[0] >= 'a' && sentence[0] <= 'z') {
    sentence[0] = static_cast<char>(sentence[0] - 'a' + 'A');
  }
  if (!sentence.ends_with('.')) sentence += '.';
  return Prose(sentence);
}

/// What an option does, or which words it takes.
std::string TextOf(const CallPart& part) {
  const bool saysWordsAlone = part.offer == Offer::Words && part.meaning.starts_with(part.words.front());
  return saysWordsAlone ? "One of " + Prose(part.meaning) + "." : Sentence(part.meaning);
}

std::string CallOf(const Command& command) {
  std::string call = Typed(command.path);
  if (!command.options.empty()) call += " [" + Placeholder("OPTIONS") + "]";
  for (const CallPart& argument : command.arguments) {
    std::string name = Placeholder(argument.names.front());
    if (argument.isRepeated) name += "...";
    call += argument.isRequired ? " " + name : " [" + name + "]";
  }
  return call;
}

/// The help of each command is no news.
bool IsHelp(const CallPart& part) {
  return part.names.back() == "--help";
}

void AddParts(ManualPage& page, const std::vector<CallPart>& parts, bool withHelp) {
  for (const CallPart& part : parts) {
    if (withHelp || !IsHelp(part)) page.Item(TermOf(part), TextOf(part));
  }
}

void AddCommand(ManualPage& page, const Command& command) {
  if (!command.commands.empty()) {
    for (const Command& each : command.commands) AddCommand(page, each);
    return;
  }
  page.Item(CallOf(command), Sentence(command.meaning));
  if (command.arguments.empty() && std::all_of(command.options.begin(), command.options.end(), IsHelp))
    return;
  page.Indent();
  AddParts(page, command.arguments, false);
  AddParts(page, command.options, false);
  page.EndIndent();
}

void AddFacts(ManualPage& page, std::string_view title, std::span<const Fact> facts) {
  page.Section(title);
  for (const Fact& fact : facts) page.Item(Typed(fact.term), Prose(fact.meaning));
}

}  // namespace

std::string ToolPage(const Edition& edition) {
  const Command tool = ToolTree();
  ManualPage page(
      {"tessal", 1, "read, check, document and save templates of aquatic process models", kUserCommands},
      edition.version, edition.date);
  page.Section("Synopsis");
  page.Paragraph(Typed("tessal") + " " + Placeholder("COMMAND") + " [" + Placeholder("OPTIONS") + "] [" +
                 Placeholder("ARGUMENTS") + "]");
  page.Section("Description");
  page.Paragraph(
      Prose("A template describes a model of water quality or of an ecosystem as a text file that a "
            "simulation engine runs.") +
      " " + Typed("tessal") +
      Prose(" reads templates as the editor does, says what is wrong with them, looks at their "
            "units and balances, prints their tables and pages, and saves them.") +
      " " +
      Prose("Results go to standard output, and what is wrong with the call to standard error. "
            "Where a text is asked for, - is standard input, and -- ends the options. A value "
            "that reads as a number is never taken for an option."));
  page.Section("Options");
  AddParts(page, tool.options, true);
  page.Section("Commands");
  std::string group;
  for (const Command& command : tool.commands) {
    if (command.group != group) page.Subsection(group = command.group);
    AddCommand(page, command);
  }
  AddFacts(page, "Exit status", kExitCodes);
  AddFacts(page, "Environment", kToolEnvironment);
  AddFacts(page, "Files", kToolFiles);
  page.Section("Examples");
  for (const Example& example : kExamples) page.Item(Typed(example.call), Prose(example.meaning));
  page.Section("See also");
  page.Paragraph("\\fBtessal\\-editor\\fR(1), \\fBtessal\\-template\\fR(5), \\fBtessal\\-expressions\\fR(7)");
  return page.Text();
}

std::string EditorPage(const Edition& edition, std::string_view keys) {
  const Command editor = EditorTree();
  ManualPage page({"tessal-editor", 1, "edit templates of aquatic process models", kUserCommands},
                  edition.version, edition.date);
  page.Section("Synopsis");
  page.Paragraph(CallOf(editor));
  page.Section("Description");
  page.Paragraph(
      Prose("The editor shows each element of a template in a tree, its page beside it, and below "
            "what is wrong with the template, checked again after each edit. F1 opens the help "
            "of the page in front."));
  page.Section("Options");
  AddParts(page, editor.arguments, true);
  AddParts(page, editor.options, true);
  page.Section("Keys");
  while (!keys.empty()) {
    const std::string_view line = keys.substr(0, keys.find('\n'));
    keys.remove_prefix(std::min(keys.size(), line.size() + 1));
    const std::size_t tab = line.find('\t');
    if (tab != std::string_view::npos) page.Item(Typed(line.substr(tab + 1)), Prose(line.substr(0, tab)));
  }
  page.Section("Exit status");
  page.Item(Typed("0"), Prose("The window was closed."));
  page.Item(Typed("2"), Prose("A wrong option, or a module that can not be loaded."));
  page.Section("See also");
  page.Paragraph("\\fBtessal\\fR(1), \\fBtessal\\-template\\fR(5), \\fBtessal\\-expressions\\fR(7)");
  return page.Text();
}

}  // namespace tessal::manual
