// The options of the editor's command line, as its help, its man page and its completions have them. No part
// of Qt: they are read before there is a screen.
#pragma once

#include <array>
#include <string>
#include <string_view>

namespace tessal {

struct EditorOption {
  std::string_view name;
  std::string_view letter;  ///< empty without a short form
  std::string_view value;   ///< empty for a flag
  std::string_view meaning;
};

inline constexpr std::string_view kEditorSummary = "Edits templates of aquatic process models.";
inline constexpr std::string_view kEditorCall = "tessal-editor [OPTIONS] [FILE...]";
inline constexpr EditorOption kEditorFiles{"FILE", "", "", "templates to open"};

inline constexpr std::string_view kHelpOption = "help";
inline constexpr std::string_view kVersionOption = "version";
inline constexpr std::string_view kModuleOption = "module";

inline constexpr std::array<EditorOption, 3> kEditorOptions = {{
    {kHelpOption, "h", "", "prints this help"},
    {kVersionOption, "v", "", "prints the version and the build"},
    {kModuleOption, "", "FILE", "loads the editor's module from this file"},
}};

/// What the toolkit takes before the editor sees it; one hyphen will do.
inline constexpr std::array<EditorOption, 8> kToolkitOptions = {{
    {"platform", "", "NAME", "shows windows by this plug-in: xcb, wayland, offscreen"},
    {"platformtheme", "", "NAME", "takes colours, fonts and dialogs of this desktop"},
    {"style", "", "NAME", "draws widgets in this style"},
    {"stylesheet", "", "FILE", "changes the looks by a style sheet"},
    {"qwindowgeometry", "", "GEOMETRY", "size and place of the window, as in 1200x800+20+20"},
    {"display", "", "NAME", "opens the window on this X display"},
    {"session", "", "ID", "goes on with a session of the desktop"},
    {"reverse", "", "", "lays windows out from right to left"},
}};

/// The text of `--help`.
std::string EditorHelp();

}  // namespace tessal
