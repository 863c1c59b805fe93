// The manual pages of the project, each made from the tables that the programs themselves use.
#pragma once

#include <string>
#include <string_view>

namespace tessal::manual {

/// What the heading of every page names.
struct Edition {
  std::string_view version;
  std::string_view date;
};

/// tessal(1), with all commands.
std::string ToolPage(const Edition& edition);
/// tessal-editor(1). The keys are lines of a command and its keys, with a tab between them.
std::string EditorPage(const Edition& edition, std::string_view keys);
/// tessal-template(5), the sections and keywords of the format.
std::string TemplatePage(const Edition& edition);
/// tessal-expressions(7), the language of expressions.
std::string ExpressionsPage(const Edition& edition);

}  // namespace tessal::manual
