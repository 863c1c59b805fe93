// Writes the manual pages, the completions and the syntax definitions into a folder. A program of the build,
// which is not installed.
#include <cstdio>
#include <exception>
#include <filesystem>
#include <fstream>
#include <functional>
#include <iterator>
#include <string>

#include "manual/completions.h"
#include "manual/option_tree.h"
#include "manual/pages.h"
#include "manual/syntax.h"

namespace tessal::manual {

namespace {

struct Product {
  std::string_view file;
  std::function<std::string()> make;
};

std::string ReadFile(const std::string& path) {
  std::ifstream stream(path, std::ios::binary);
  if (!stream) throw std::runtime_error("can not read " + path);
  return {std::istreambuf_iterator<char>(stream), {}};
}

void WriteFile(const std::filesystem::path& path, const std::string& text) {
  std::filesystem::create_directories(path.parent_path());
  std::ofstream stream(path, std::ios::binary);
  stream << text << std::flush;
  if (!stream) throw std::runtime_error("can not write " + path.string());
}

void WriteAll(const std::filesystem::path& folder, const Edition& edition, const std::string& keysFile) {
  const Product products[] = {
      {"tessal.1", [&] { return ToolPage(edition); }},
      {"tessal-editor.1", [&] { return EditorPage(edition, ReadFile(keysFile)); }},
      {"tessal-template.5", [&] { return TemplatePage(edition); }},
      {"tessal-expressions.7", [&] { return ExpressionsPage(edition); }},
      {"bash/tessal", [] { return BashCompletion(ToolTree()); }},
      {"bash/tessal-editor", [] { return BashCompletion(EditorTree()); }},
      {"zsh/_tessal", [] { return ZshCompletion(ToolTree()); }},
      {"zsh/_tessal-editor", [] { return ZshCompletion(EditorTree()); }},
      {"fish/tessal.fish", [] { return FishCompletion(ToolTree()); }},
      {"fish/tessal-editor.fish", [] { return FishCompletion(EditorTree()); }},
      {"kate/tessal.xml", KateSyntax},
      {"vim/syntax/tessal.vim", VimSyntax},
      {"vim/ftdetect/tessal.vim", VimDetection},
      {"textmate/tessal.tmLanguage.json", TextMateSyntax},
  };
  for (const Product& product : products) WriteFile(folder / product.file, product.make());
}

}  // namespace

}  // namespace tessal::manual

int main(int count, char** arguments) {
  constexpr int kArguments = 5;
  if (count != kArguments) {
    std::fprintf(stderr, "usage: tessal_manual FOLDER VERSION DATE KEYS_FILE\n");
    return 2;
  }
  try {
    tessal::manual::WriteAll(arguments[1], {arguments[2], arguments[3]}, arguments[4]);
    return 0;
  } catch (const std::exception& failure) {
    std::fprintf(stderr, "tessal_manual: %s\n", failure.what());
    return 2;
  }
}
