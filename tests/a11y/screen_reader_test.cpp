// What a screen reader says about the editor: each control has a name, the name is what is seen, and Tab
// leads to each once.
#include <gtest/gtest.h>

#include <algorithm>
#include <memory>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "a11y/editor_reader.h"
#include "support/case_file.h"

namespace tessal {
namespace {

using test::Accessible;
using test::Control;
using test::EditorReader;
using test::WithoutColon;

using Controls = std::vector<Control>;

/// The texts that a window shows beside its controls: its labels and its title.
std::set<std::string> SeenTexts(const Controls& controls) {
  std::set<std::string> texts;
  for (const Control& each : controls) {
    if (each.role == ATSPI_ROLE_LABEL) texts.insert(WithoutColon(each.name));
  }
  return texts;
}

bool IsMenuItem(const Control& control) {
  return control.role == ATSPI_ROLE_MENU_ITEM || control.role == ATSPI_ROLE_CHECK_MENU_ITEM;
}

bool IsButton(const Control& control) {
  return control.role == ATSPI_ROLE_PUSH_BUTTON || control.role == ATSPI_ROLE_TOGGLE_BUTTON ||
         control.role == ATSPI_ROLE_CHECK_BOX || control.role == ATSPI_ROLE_RADIO_BUTTON;
}

bool IsNamed(const Control& control) {
  if (control.role == ATSPI_ROLE_TABLE_CELL) return false;
  return control.isFocusable || IsMenuItem(control) || IsButton(control) ||
         control.role == ATSPI_ROLE_TABLE_COLUMN_HEADER;
}

/// What is wrong with the names of the controls of a window, or of a menu bar, a line for each.
class Complaints final {
 public:
  Complaints(const Controls& ofWindow, const std::set<std::string>& inMenus)
      : controls(ofWindow), commands(inMenus), labels(SeenTexts(ofWindow)), title(ofWindow.front().name) {
    for (const Control& each : controls) Judge(each);
  }

  const std::string& Text() const { return text; }

 private:
  void Judge(const Control& control) {
    if (IsNamed(control)) JudgeName(control);
    const bool isDescribed = control.isFocusable || control.role == ATSPI_ROLE_LABEL;
    if (isDescribed && control.handle.Description().find('<') != std::string::npos)
      Complain(control, "has markup in its description");
    if (control.role == ATSPI_ROLE_TEXT || control.role == ATSPI_ROLE_COMBO_BOX) JudgeField(control);
    // A button without a stop is a short cut to a command of a menu.
    if (IsButton(control) && !control.isFocusable && !commands.contains(control.name))
      Complain(control, "can be reached neither by Tab nor in a menu");
    if (control.role == ATSPI_ROLE_TREE || control.role == ATSPI_ROLE_TABLE) JudgeRows(control);
  }

  void JudgeName(const Control& control) {
    if (control.name.find_first_not_of(' ') == std::string::npos) Complain(control, "has no name");
    if (control.name.find_first_of("&\t\n") != std::string::npos)
      Complain(control, "has a mark of the keyboard in its name");
    if (IsTabStop(control) && !names.insert(control.Words()).second) Complain(control, "is there twice");
  }

  /// A field is named as its label is or, without one, as what it shows while it is empty.
  void JudgeField(const Control& control) {
    std::vector<std::string> labelling = control.handle.Labels();
    const auto isName = [&](const std::string& label) { return WithoutColon(label) == control.name; };
    if (!labelling.empty()) {
      if (std::none_of(labelling.begin(), labelling.end(), isName))
        Complain(control, "is labelled '" + labelling.front() + "'");
    } else if (control.role == ATSPI_ROLE_COMBO_BOX) {
      // Its name is what is chosen in it; what the choice is about, its tip says.
      if (control.handle.Description().empty()) Complain(control, "has neither a label nor a tip");
    } else if (!labels.contains(control.name) && control.handle.Description() != control.name &&
               title.find(control.name) == std::string::npos) {
      Complain(control, "has a name that is not seen");
    }
  }

  void JudgeRows(const Control& control) {
    const int columns = std::max(control.handle.ColumnCount(), 1);
    int place = 0;
    for (const Control& cell : controls) {
      const bool isCell = cell.role == ATSPI_ROLE_TABLE_CELL && &controls[cell.parent] == &control;
      if (isCell && place++ % columns == 0 && cell.name.empty())
        Complain(control, "has a row without a name");
    }
  }

  void Complain(const Control& control, const std::string& what) {
    text += "  " + control.Words() + " " + what + "\n";
  }

  const Controls& controls;
  const std::set<std::string>& commands;
  std::set<std::string> labels;
  std::set<std::string> names;
  std::string title;
  std::string text;
};

/// The names of the stops that Tab leads to, from the first on until it comes there again. Says what it never
/// came to, and where it came twice.
std::string WalkWithTab(const EditorReader& editor, const Controls& controls) {
  std::vector<const Control*> stops;
  for (const Control& each : controls) {
    if (IsTabStop(each)) stops.push_back(&each);
  }
  std::string walk;
  std::vector<const Control*> visited;
  const Control* present = nullptr;
  while (visited.size() <= stops.size()) {
    const Control* former = std::exchange(present, nullptr);
    editor.Keys().Type(XK_Tab);
    test::WaitUntil([&] {
      const auto hit = std::find_if(stops.begin(), stops.end(), [former](const Control* stop) {
        return stop != former && stop->handle.Is(ATSPI_STATE_FOCUSED);
      });
      if (hit != stops.end()) present = *hit;
      return present != nullptr;
    });
    if (present == nullptr || (!visited.empty() && present == visited.front())) break;
    visited.push_back(present);
    walk += "  " + present->Words() + "\n";
  }
  if (present == nullptr) walk += "  ! and from there to nothing that is seen\n";
  for (const Control* stop : stops) {
    const auto times = std::count(visited.begin(), visited.end(), stop);
    if (times != 1) walk += "  ! " + std::to_string(times) + " times at " + stop->Words() + "\n";
  }
  return walk;
}

class ScreenReader : public testing::Test {
 protected:
  static void SetUpTestSuite() {
    const std::vector<std::string> examples = {"eutrophication", "fish_larvae", "lake_management", "faults"};
    if (test::PrivateDesktop::Missing().empty()) editor = std::make_unique<EditorReader>(examples);
  }
  static void TearDownTestSuite() { editor.reset(); }

  /// The commands of the menus, whatever opens them.
  static Controls ReadMenus() {
    for (const Control& each : editor->Read()) {
      if (each.role == ATSPI_ROLE_MENU_BAR) return test::ReadControls(each.handle);
    }
    return {};
  }

  void SetUp() override {
    const std::string missing = test::PrivateDesktop::Missing();
    if (!missing.empty()) GTEST_SKIP() << missing << " is not installed: the editor is not read";
  }

  /// Judges the window on top, and adds the walk through it to the listing.
  void Visit(const std::string& page) {
    const Controls controls = editor->Read();
    ASSERT_FALSE(controls.empty()) << page;
    const std::string complaints = Complaints(controls, commands).Text();
    EXPECT_EQ(complaints, "") << page;
    const std::string walk = WalkWithTab(*editor, controls);
    EXPECT_EQ(walk.find('!'), std::string::npos) << page << "\n" << walk;
    walks += page + "\n" + walk;
  }

  static std::unique_ptr<EditorReader> editor;
  std::set<std::string> commands;
  std::string walks;
};

std::unique_ptr<EditorReader> ScreenReader::editor;

TEST_F(ScreenReader, NamesEveryCommandOfTheMenus) {
  const Controls menus = ReadMenus();
  constexpr std::size_t kFewest = 40;
  EXPECT_GT(menus.size(), kFewest);
  const std::string complaints = Complaints(menus, {}).Text();
  EXPECT_EQ(complaints, "");
}

TEST_F(ScreenReader, NamesEveryControlAndTabReachesEachOnce) {
  for (const Control& each : ReadMenus()) commands.insert(each.name);
  ASSERT_TRUE(editor->ShowDocument("eutrophication"));
  Visit("the root");
  ASSERT_TRUE(editor->ShowTab("Overview"));
  Visit("the overview");
  ASSERT_TRUE(editor->GoToNode({"Constants"}));
  Visit("a list");
  ASSERT_TRUE(editor->GoToSymbol("Topt"));
  Visit("a constant");
  ASSERT_TRUE(editor->OpenWindow("Go to Symbol", XK_k, {XK_Control_L}));
  Visit("the window that goes to a symbol");
  ASSERT_TRUE(editor->CloseWindow());

  for (const char* page : {"Findings", "Process Matrix", "Pools", "Influences"}) {
    editor->Keys().Type(XK_F9);
    ASSERT_TRUE(editor->Wait(ATSPI_ROLE_TREE, "Findings of the analyses"));
    ASSERT_TRUE(editor->ShowTab(page));
    Visit(std::string("the analyses: ") + page);
  }
  ASSERT_TRUE(editor->Press(ATSPI_ROLE_PUSH_BUTTON, "Close the analyses"));

  ASSERT_TRUE(editor->ShowDocument("fish_larvae"));
  ASSERT_TRUE(editor->GoToSymbol("production"));
  Visit("a process");
  ASSERT_TRUE(editor->Press(ATSPI_ROLE_PUSH_BUTTON, "Edit..."));
  ASSERT_TRUE(editor->WaitForTitle("Expression Editor"));
  Visit("the keypad");
  ASSERT_TRUE(editor->CloseWindow());
  ASSERT_TRUE(editor->GoToSymbol("Larva_food"));
  Visit("a search");
  ASSERT_TRUE(editor->GoToNode({"Particle Classes", "Larva"}));
  Visit("a particle class");

  ASSERT_TRUE(editor->ShowDocument("lake_management"));
  ASSERT_TRUE(editor->GoToNode({"Miscellaneous", "Visibility Groups"}));
  Visit("the visibility groups");
  editor->Keys().Type(XK_f, {XK_Control_L, XK_Shift_L});
  const Accessible pattern = editor->Wait(ATSPI_ROLE_TEXT, "Find");
  ASSERT_TRUE(pattern && pattern.SetText("Lake"));
  editor->Keys().Type(XK_Return);
  Visit("the find pane");
  test::ExpectListing("a11y/cases/walks.txt", walks);
}

TEST_F(ScreenReader, ReadsExpressionsAndMessages) {
  ASSERT_TRUE(editor->ShowDocument("fish_larvae"));
  ASSERT_TRUE(editor->GoToSymbol("production"));
  EXPECT_EQ(editor->Wait(ATSPI_ROLE_TEXT, "Expression").Text(), "kp*fT*Prey*(1 - Prey/cap)");
  ASSERT_TRUE(editor->ShowDocument("faults"));
  const Accessible messages = editor->Wait(ATSPI_ROLE_TREE, "Messages");
  ASSERT_TRUE(messages);
  constexpr int kFirstRow = 6;
  std::string read;
  for (const Accessible& cell : messages.Children(kFirstRow)) read += cell.Name() + "|";
  EXPECT_EQ(read,
            "Item|Error message|Critical Downward Velocity|Undefined symbol NOSUCH|Critical A_undefined|"
            "Undefined symbol nobody|");
}

}  // namespace
}  // namespace tessal
