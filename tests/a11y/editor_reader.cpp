#include "a11y/editor_reader.h"

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <stdexcept>

namespace tessal::test {

namespace {

constexpr int kMostWindows = 20;
constexpr int kMostRows = 60;

/// The environment of the editor, and its command line.
std::vector<std::string> CommandLine(const PrivateDesktop& desktop,
                                     const std::vector<std::string>& examples) {
  setenv("QT_QPA_PLATFORM", "xcb", 1);
  setenv("QT_LINUX_ACCESSIBILITY_ALWAYS_ON", "1", 1);
  // It ends by a signal, with all that it holds.
  setenv("ASAN_OPTIONS", "detect_leaks=0", 1);
  std::vector<std::string> words = {TESSAL_EDITOR, "--module", TESSAL_MODULE};
  for (const std::string& example : examples) {
    words.push_back(desktop.Home().File(example + ".tessal"));
    std::filesystem::copy_file(TESSAL_SOURCE_DIR "/examples/" + example + ".tessal", words.back());
  }
  return words;
}

/// The rows of a tree; the heading that Qt counts among its children is none, even where it is hidden.
std::vector<Accessible> RowsOf(const Accessible& tree) {
  std::vector<Accessible> rows = tree.Children(kMostRows);
  std::erase_if(rows, [](const Accessible& row) { return row.Role() != ATSPI_ROLE_TABLE_CELL; });
  return rows;
}

}  // namespace

bool IsTabStop(const Control& control) {
  switch (control.role) {
    case ATSPI_ROLE_PAGE_TAB:
    case ATSPI_ROLE_TABLE_CELL:
    case ATSPI_ROLE_TREE_ITEM:
    case ATSPI_ROLE_LIST_ITEM:
      return false;
    default:
      return control.isShowing && control.isFocusable && control.isSensitive &&
             !(control.role == ATSPI_ROLE_FILLER && control.passesFocusOn);
  }
}

EditorReader::EditorReader(const std::vector<std::string>& examples)
    : editor(CommandLine(desktop, examples)), application(desktop.Find(editor)) {
  const std::string last = examples.back() + ".tessal";
  if (!application || !Wait(ATSPI_ROLE_PAGE_TAB, last))
    throw std::runtime_error("the editor does not show its documents on the accessibility bus");
  WaitForTitle(last);
}

Accessible EditorReader::TopWindow() const {
  Accessible top;
  for (const Accessible& window : application.Children(kMostWindows)) {
    if (window.Is(ATSPI_STATE_SHOWING)) top = window;
  }
  return top;
}

Accessible EditorReader::Wait(AtspiRole role, const std::string& name) const {
  Accessible found;
  WaitUntil([&] { return bool(found = FindControl(TopWindow(), role, name)); });
  return found;
}

bool EditorReader::WaitForTitle(const std::string& title) const {
  return WaitUntil([&] { return TopWindow() && TopWindow().Name().starts_with(title); }) && WaitUntil([&] {
           keyboard.FocusTopWindow();
           return TopWindow().Is(ATSPI_STATE_ACTIVE);
         });
}

bool EditorReader::Press(AtspiRole role, const std::string& name) const {
  return Wait(role, name).Press();
}

bool EditorReader::ShowDocument(const std::string& example) const {
  return Press(ATSPI_ROLE_PAGE_TAB, example + ".tessal") && WaitForTitle(example + ".tessal");
}

bool EditorReader::ShowTab(const std::string& name) const {
  const Accessible tab = Wait(ATSPI_ROLE_PAGE_TAB, name);
  return tab && tab.Press() && WaitUntil([&] { return tab.Is(ATSPI_STATE_FOCUSED); });
}

bool EditorReader::OpenWindow(const std::string& title, unsigned long key,
                              std::initializer_list<unsigned long> held) const {
  keyboard.Type(key, held);
  return WaitForTitle(title);
}

bool EditorReader::CloseWindow() const {
  const Accessible closed = TopWindow();
  keyboard.Type(XK_Escape);
  return WaitUntil([&] { return !(TopWindow() == closed); }) && WaitForTitle("");
}

bool EditorReader::GoToSymbol(const std::string& symbol) const {
  if (!OpenWindow("Go to Symbol", XK_k, {XK_Control_L})) return false;
  const Accessible window = TopWindow();
  if (!Wait(ATSPI_ROLE_TEXT, "Letters of the symbol").SetText(symbol)) return false;
  keyboard.Type(XK_Return);
  return WaitUntil([&] { return !(TopWindow() == window); }) && WaitForTitle("") && WaitUntil([&] {
           const Accessible field = Wait(ATSPI_ROLE_TEXT, "Symbol");
           return field && field.Text() == symbol;
         });
}

Accessible EditorReader::Tree() const {
  return Wait(ATSPI_ROLE_TREE, "Elements of the template");
}

bool EditorReader::GoToNode(const std::vector<std::string>& path) const {
  // From the filter over the tree into the tree.
  const Accessible tree = Tree();
  keyboard.Type(XK_f, {XK_Control_L});
  const Accessible filter = Wait(ATSPI_ROLE_TEXT, "Filter by symbol, description or unit");
  if (!WaitUntil([&] { return filter.Is(ATSPI_STATE_FOCUSED); })) return false;
  keyboard.Type(XK_Tab);
  if (!WaitUntil([&] { return tree.Is(ATSPI_STATE_FOCUSED); })) return false;
  keyboard.Type(XK_Home);
  std::size_t row = 0;
  for (const std::string& name : path) {
    keyboard.Type(XK_KP_Add);
    Accessible node;
    const std::size_t above = row;
    WaitUntil([&] {
      const std::vector<Accessible> rows = RowsOf(tree);
      for (row = above; row < rows.size(); ++row) {
        if (rows[row].Name() == name) {
          node = rows[row];
          return true;
        }
      }
      return false;
    });
    if (!node) return false;
    for (std::size_t step = above; step < row; ++step) keyboard.Type(XK_Down);
    if (!WaitUntil([&] { return node.Is(ATSPI_STATE_FOCUSED); })) return false;
  }
  return true;
}

}  // namespace tessal::test
