#include "app/editor_options.h"

#include <span>

namespace tessal {

namespace {

void AppendRow(std::string& text, std::string row, std::string_view meaning) {
  constexpr std::size_t kColumn = 30;
  row.resize(row.size() < kColumn ? kColumn : row.size() + 1, ' ');
  text += row + std::string(meaning) + '\n';
}

void AppendOptions(std::string& text, std::string_view title, std::span<const EditorOption> options) {
  text += "\n" + std::string(title) + ":\n";
  for (const EditorOption& option : options) {
    std::string row = "  ";
    if (!option.letter.empty()) row += "-" + std::string(option.letter) + ",";
    row += "--" + std::string(option.name);
    if (!option.value.empty()) row += " " + std::string(option.value);
    AppendRow(text, std::move(row), option.meaning);
  }
}

}  // namespace

std::string EditorHelp() {
  std::string text =
      std::string(kEditorSummary) + "\nUsage: " + std::string(kEditorCall) + "\n\nArguments:\n";
  AppendRow(text, "  " + std::string(kEditorFiles.name), kEditorFiles.meaning);
  AppendOptions(text, "Options", kEditorOptions);
  AppendOptions(text, "Options of the toolkit", kToolkitOptions);
  return text;
}

}  // namespace tessal
