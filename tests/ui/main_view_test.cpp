// The tree, the error list, the history and the hints of the main view.
#include <gtest/gtest.h>

#include <QAction>
#include <QMenu>
#include <QTest>
#include <QTimer>
#include <QToolBar>

#include "support/template_text.h"
#include "ui/create_hint.h"
#include "ui/editor.h"
#include "ui/node_commands.h"
#include "ui/strings.h"

namespace tessal {
namespace {

using test::Editor;
using test::SmallModel;
using test::TemplateText;

/// The captions of a tree, indented.
std::string Outline(const QTreeWidgetItem& item, const std::string& indent = "") {
  std::string text = indent + item.text(0).toStdString() + "\n";
  for (int place = 0; place < item.childCount(); ++place) text += Outline(*item.child(place), indent + " ");
  return text;
}

void Send(Editor& editor, int number, std::int32_t argument = 0) {
  const NumberHint hint(argument);
  editor.Document().UpdateAllViews(nullptr, number, &hint);
}

TEST(Tree, ShowsEveryKindInItsPlace) {
  Editor empty(TemplateText().Text());
  ASSERT_TRUE(empty.IsOpen());
  EXPECT_EQ(
      Outline(*empty.Tree().RootItem()),
      "Tessal Setup\n State Variables\n Constants\n Forcing\n Auxiliaries\n Processes\n Derived Outputs\n");

  Editor full(SmallModel()
                  .DerivedOutput("S")
                  .With("DESCRIPTION", "'Total'")
                  .Specie("Fish", "Fish_up", {{"Fish_up", "1"}})
                  .Misc()
                  .Text());
  ASSERT_TRUE(full.IsOpen());
  EXPECT_EQ(
      Outline(*full.Tree().RootItem()),
      "Tessal Setup\n State Variables\n  S\n Constants\n  k\n Forcing\n  f\n Auxiliaries\n  a\n Processes\n"
      "  p\n Derived Outputs\n  Total\n Miscellaneous\n  Visibility Groups\n Particle Classes\n  Fish\n"
      "   State Variables\n    Fish_Mass\n   Constants\n   Restricted area search\n"
      "   Arithmetic Expressions\n    Fish_up\n   Horizontal Movement\n    Horizontal Vector1\n"
      "   Downward Movement\n    Downward Velocity\n");
  EXPECT_TRUE(full.Tree().RootItem()->isExpanded());
  EXPECT_FALSE(full.Node("Constants")->isExpanded());
  EXPECT_TRUE(full.Node("Particle Classes")->isExpanded());
}

TEST(ErrorList, UsersOfUndefinedSymbolsStandOnTopInReverse) {
  Editor editor(TemplateText()
                    .Constant("low", "-1")
                    .Auxiliary("a1", "A")
                    .Auxiliary("a2", "A")
                    .Auxiliary("b1", "B")
                    .Auxiliary("b2", "B")
                    .Text());
  ASSERT_TRUE(editor.IsOpen());
  const QStringList expected = {"a2: Undefined symbol A", "b2: Undefined symbol B", "b1: Undefined symbol B",
                                "a1: Undefined symbol A",
                                "low: Warning: The (default) value is lower than the minimum!"};
  EXPECT_EQ(editor.Rows(), expected);

  CErrorList& list = editor.View().ErrorList();
  QTest::mouseClick(list.viewport(), Qt::LeftButton, {}, list.visualItemRect(list.topLevelItem(1)).center());
  EXPECT_EQ(editor.Selected(), "b2") << "a click goes to the element of the row";
  ASSERT_NE(list.currentItem(), nullptr);
  EXPECT_EQ(list.currentItem()->text(0), "b2") << "the row stays selected when the list is made anew";
  editor.Select("b2");
  list.setFocus();
  list.setCurrentItem(list.topLevelItem(4));
  QTest::keyClick(&list, Qt::Key_Return);
  EXPECT_EQ(editor.Selected(), "low");
}

TEST(ErrorList, AMessageOfNoElementGoesToTheRoot) {
  // The message is one of the load; the validation that follows an edit does not find it again.
  Editor editor(TemplateText().Constant("k").Without("UNIT").Text());
  ASSERT_TRUE(editor.IsOpen());
  EXPECT_TRUE(editor.Rows().isEmpty());
  editor.Select("k");
  emit editor.View().ErrorList().ElementChosen(-1);
  EXPECT_EQ(editor.Selected(), "Tessal Setup");
}

TEST(History, KeepsThirtyNodesNewestFirstAndGoesBothWays) {
  TemplateText text;
  constexpr int kNodes = 31;
  for (int number = 1; number <= kNodes; ++number) text.Constant("k" + std::to_string(number));
  Editor editor(text.Text());
  ASSERT_TRUE(editor.IsOpen());
  const CNavigationHistory& history = editor.View().History();
  for (int number = 1; number <= kNodes; ++number) editor.Select(QStringLiteral("k%1").arg(number));
  ASSERT_EQ(history.Entries().size(), 30U);
  EXPECT_EQ(history.Entries().front().caption, "k31");
  EXPECT_EQ(history.Entries().back().caption, "k2") << "the oldest went";
  EXPECT_EQ(history.Position(), 0);

  const auto actions = editor.View().findChild<QToolBar*>()->actions();
  QAction* back = actions.at(0);
  QAction* forward = actions.at(1);
  EXPECT_FALSE(forward->isEnabled());
  back->trigger();
  back->trigger();
  EXPECT_EQ(editor.Selected(), "k29");
  EXPECT_EQ(history.Position(), 2);
  EXPECT_TRUE(forward->isEnabled());
  forward->trigger();
  EXPECT_EQ(editor.Selected(), "k30");

  // An older entry, chosen from the list, cuts none of the newer ones.
  QMenu& menu = editor.View().HistoryMenu();
  emit menu.aboutToShow();
  ASSERT_EQ(menu.actions().size(), 30);
  EXPECT_TRUE(menu.actions().at(1)->isChecked());
  menu.actions().at(5)->trigger();
  EXPECT_EQ(editor.Selected(), "k26");
  EXPECT_EQ(history.Entries().size(), 30U);
  EXPECT_EQ(history.Position(), 1) << "entered ahead of the one that was shown";
  forward->trigger();
  EXPECT_EQ(editor.Selected(), "k31");
}

TEST(History, EntersANewNodeBeforeThePresentOne) {
  CNavigationHistory history;
  EXPECT_EQ(history.Back(), 0) << "an empty list finds nothing";
  for (const std::int32_t id : {1, 2, 3, 4}) history.Add(id, std::to_string(id));
  history.Back();
  history.Back();
  ASSERT_EQ(history.Position(), 2);
  history.Add(9, "9");
  std::string order;
  for (const CHistoryData& entry : history.Entries()) order += entry.caption;
  EXPECT_EQ(order, "43921");
  EXPECT_EQ(history.Position(), 2);
}

TEST(Selection, WritesTheFormThatIsLeftWhateverItHolds) {
  Editor editor(SmallModel().Text());
  ASSERT_TRUE(editor.IsOpen());
  editor.Select("k");
  editor.Type(1097, "9 lives");
  editor.Tree().setCurrentItem(editor.Node("Forcing"));
  EXPECT_EQ(editor.User().TakeLog(), QStringList{"'9 lives' is not a valid identifier!"});
  EXPECT_EQ(editor.Selected(), "Forcing") << "the selection moves on";
  EXPECT_EQ(editor.Children("Constants"), QStringList{"k"});

  // The caption is that of the node that is left.
  editor.Select("k");
  editor.Type(1097, "decay");
  editor.View().SelectById(editor.IdOf("f"));
  EXPECT_EQ(editor.Children("Constants"), QStringList{"decay"});
  EXPECT_EQ(editor.Children("Forcing"), QStringList{"f"});
  EXPECT_EQ(editor.Core().GetAuxiliary(0).expression.Text(), "decay*f");
}

TEST(Menu, OffersWhatCanBeDoneWithANode) {
  Editor editor(SmallModel().Specie("Fish", "Fish_up", {{"Fish_up", "1"}}).Misc().Text());
  ASSERT_TRUE(editor.IsOpen());
  editor.Core().AddConstant();
  struct Row {
    const char* caption;
    std::int32_t kindToCreate;
    std::int32_t owner;  // 0: the node's own id
    bool offersDelete;
    bool canDelete;
  };
  constexpr Row kRows[] = {
      {"Tessal Setup", 0, 0, false, false},
      {"Miscellaneous", 0, 0, false, false},
      {"State Variables", 1, folder_id::kStateVariables, false, false},
      {"Constants", 2, -3, false, false},
      {"k", 2, -3, true, false},
      {"p", 5, 0, true, false},
      {"Particle Classes", 7, -9, false, false},
      {"Fish", 7, -9, true, true},
      {"Visibility Groups", 19, -11, false, false},
      {"Arithmetic Expressions", 12, 0, false, false},
      {"Horizontal Movement", 13, 0, false, false},
      {"Downward Movement", 0, 0, false, false},
      {"Downward Velocity", 0, 0, false, false},
  };
  for (const Row& row : kRows) {
    const CItemData& data = CElementTree::DataOf(*editor.Node(row.caption));
    const NodeCommands commands = CommandsOfNode(data, editor.Core());
    EXPECT_EQ(commands.kindToCreate, row.kindToCreate) << row.caption;
    if (row.kindToCreate == 0) continue;
    if (row.owner != 0) {
      EXPECT_EQ(commands.ownerId, row.owner) << row.caption;
    }
    EXPECT_EQ(commands.offersDelete, row.offersDelete) << row.caption;
    EXPECT_EQ(commands.offersDelete && commands.canDelete, row.canDelete) << row.caption;
    EXPECT_TRUE(commands.canCreate) << row.caption;
  }
  // A class has no more than five movements.
  const CItemData movement = CElementTree::DataOf(*editor.Node("Horizontal Movement"));
  constexpr std::size_t kMost = 5;
  while (editor.Core().GetSpecie(0).horizontalVectors.size() < kMost) {
    editor.View().CreateElement({"", kind::kHorizontalVector, movement.id});
  }
  EXPECT_FALSE(CommandsOfNode(movement, editor.Core()).canCreate);
  EXPECT_EQ(editor.Children("Horizontal Movement").size(), 5);
}

/// Chooses an entry of the menu that the next right click opens.
void ChooseFromMenu(Editor& editor, const QString& caption, const QString& entry) {
  CElementTree& tree = editor.Tree();
  tree.scrollToItem(editor.Node(caption));
  QTimer::singleShot(0, &tree, [&entry] {
    auto* menu = qobject_cast<QMenu*>(QApplication::activePopupWidget());
    ASSERT_NE(menu, nullptr);
    for (QAction* action : menu->actions()) {
      if (action->text() == entry) {
        EXPECT_TRUE(action->isEnabled());
        action->trigger();
      }
    }
    menu->close();
  });
  emit tree.customContextMenuRequested(tree.visualItemRect(editor.Node(caption)).center());
}

TEST(Menu, CreatesAndDeletes) {
  Editor editor(TemplateText().Constant("k1").Constant("k2").Constant("k3").Text());
  ASSERT_TRUE(editor.IsOpen());
  ChooseFromMenu(editor, "Constants", strings::kCreateNew);
  EXPECT_EQ(editor.Selected(), "*Constant_4");
  EXPECT_TRUE(editor.Document().IsModified());
  editor.Select("k3");
  ChooseFromMenu(editor, "k3", strings::kDelete);
  EXPECT_EQ(editor.Selected(), "Constant_4") << "the next sibling";
  ChooseFromMenu(editor, "Constant_4", strings::kDelete);
  EXPECT_EQ(editor.Selected(), "k2") << "the one before, without a next";
  ChooseFromMenu(editor, "k1", strings::kDelete);
  ChooseFromMenu(editor, "k2", strings::kDelete);
  EXPECT_EQ(editor.Selected(), "Constants") << "the folder, without a sibling";
  EXPECT_EQ(editor.Core().GetConstantCount(), 0U);
}

TEST(Hints, CreateGivesTextsAPlaceAndAStar) {
  Editor editor(SmallModel().Text());
  ASSERT_TRUE(editor.IsOpen());
  editor.Core().GetAuxiliary(0).expression.SetText("fresh*f");
  editor.Core().RebuildSymbolTable();
  const CreateHint create({"fresh", kind::kAuxiliary, 0});
  editor.Document().UpdateAllViews(nullptr, hint::kCreateElement, &create);
  EXPECT_EQ(editor.Children("Auxiliaries"), (QStringList{"*fresh", "a"})) << "ahead of its user";
  EXPECT_EQ(editor.Core().GetAuxiliary(0).description.Text(), "fresh Description");
  EXPECT_TRUE(editor.Document().IsModified()) << "after each hint the document follows the template";
  editor.Select("*fresh");
  EXPECT_EQ(editor.Children("Auxiliaries"), (QStringList{"*fresh", "a"}))
      << "the next refresh takes the star off";
  editor.Select("a");
  EXPECT_EQ(editor.Children("Auxiliaries"), (QStringList{"fresh", "a"}));

  const CreateHint specie({"", kind::kSpecie, folder_id::kParticleClasses});
  editor.Document().UpdateAllViews(nullptr, hint::kCreateElement, &specie);
  EXPECT_EQ(editor.Children("Specie_1").size(), 6) << "a class comes with all of its folders";
  const CreateHint nothing({"", 77, 0});
  editor.Document().UpdateAllViews(nullptr, hint::kCreateElement, &nothing);
}

TEST(Hints, MovesAndDeletionsKeepNodesWhole) {
  Editor editor(TemplateText().Constant("k1").Constant("k2").Constant("k3").Text());
  ASSERT_TRUE(editor.IsOpen());
  editor.Select("k2");
  const std::int32_t id = editor.IdOf("k2");
  Send(editor, hint::kMoveUp, id);
  Send(editor, hint::kMoveUp, id);
  EXPECT_EQ(editor.Children("Constants"), (QStringList{"k2", "k1", "k3"}));
  Send(editor, hint::kMoveDown, id);
  Send(editor, hint::kMoveDown, id);
  Send(editor, hint::kMoveDown, id);
  EXPECT_EQ(editor.Children("Constants"), (QStringList{"k1", "k3", "k2"}));
  EXPECT_EQ(editor.Selected(), "k2");
  EXPECT_EQ(editor.IdOf("k2"), id);
  Send(editor, hint::kDeleteItem, id);
  EXPECT_EQ(editor.Children("Constants"), (QStringList{"k1", "k3"}));
  // Numbers that mean nothing do nothing.
  constexpr std::int32_t kNobody = 99999;
  for (const int number : {3, 4, 6, 8, 9, 10, 12, 13, 15, 99}) Send(editor, number, kNobody);
  EXPECT_EQ(editor.Selected(), "k3");
}

TEST(Hints, VisibilityGroupsKeepTheirNumbers) {
  Editor editor(SmallModel().Misc().Text());
  ASSERT_TRUE(editor.IsOpen());
  const auto numbers = [&editor] {
    QString text;
    for (QTreeWidgetItem* item : editor.Tree().GroupItems()) {
      text += item->text(0) + u':' + QString::number(CElementTree::DataOf(*item).groupIndex) + u' ';
    }
    return text;
  };
  for (int group = 0; group < 3; ++group) Send(editor, hint::kAddGroup);
  EXPECT_EQ(numbers(), "Group_1:1 Group_2:2 Group_3:3 ");
  Send(editor, hint::kSelectGroup, 2);
  EXPECT_EQ(editor.Selected(), "Group_3");
  const RenameGroupHint rename(1, "Public");
  editor.Document().UpdateAllViews(nullptr, hint::kRenameGroup, &rename);
  Send(editor, hint::kDeleteGroup, 2);
  EXPECT_EQ(numbers(), "Group_1:1 Public:2 ");
  Send(editor, hint::kDeleteGroup, 0);
  EXPECT_EQ(numbers(), "Public:1 ");
  EXPECT_EQ(editor.Core().GetMisc()->Visibilities().groups.size(), 1U);
  // A group that is made through the creation turns the listeners off until the next element is made.
  EXPECT_EQ(editor.View().CreateElement({"", kind::kVisibilityGroup, 0}), 0U);
  EXPECT_FALSE(NotifyChanges());
  EXPECT_EQ(editor.Tree().GroupItems().size(), 2U);
  EXPECT_NE(editor.View().CreateElement({"", kind::kConstant, 0}), 0U);
  EXPECT_TRUE(NotifyChanges());
}

TEST(Hints, BranchesComeAndGoWithoutTheirElements) {
  Editor editor(SmallModel().Specie("Fish", "Fish_up", {{"Fish_up", "1"}}).Misc().Text());
  ASSERT_TRUE(editor.IsOpen());
  const std::string whole = Outline(*editor.Tree().RootItem());
  editor.Select("Fish_up");
  Send(editor, hint::kShowParticles, 0);
  Send(editor, hint::kShowMisc, 0);
  EXPECT_EQ(editor.Tree().FindById(folder_id::kParticleClasses), nullptr);
  EXPECT_EQ(editor.Tree().FindById(folder_id::kMiscellaneous), nullptr);
  EXPECT_EQ(editor.Core().GetSpecieCount(), 1U);
  Send(editor, hint::kShowParticles, 1);
  Send(editor, hint::kShowMisc, 1);
  Send(editor, hint::kShowMisc, 1);
  EXPECT_EQ(Outline(*editor.Tree().RootItem()), whole);
}

TEST(Keyboard, ReachesTheFormTheHelpAndEveryField) {
  Editor editor(SmallModel().Text());
  ASSERT_TRUE(editor.IsOpen());
  editor.Select("S");
  QTest::keyClick(&editor.Tree(), Qt::Key_Tab);
  EXPECT_EQ(QApplication::focusWidget()->objectName(), "1097");
  // From the symbol on, Tab goes through the fields in their order.
  QStringList reached;
  for (int step = 0; step < 16; ++step) {
    reached.append(QApplication::focusWidget()->objectName());
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Tab);
  }
  const QStringList fields = {"1097", "1074", "1083", "1076", "1021", "1129", "1055", "1059",
                              "1079", "1045", "1071", "1085", "1084", "1115", "1023", "1094"};
  EXPECT_EQ(reached, fields);
  for (const auto& [caption, topic] :
       {std::pair{"S", 131172}, {"Constants", 131174}, {"f", 131178}, {"Tessal Setup", 131179}}) {
    editor.Select(caption);
    QTest::keyClick(&editor.Tree(), Qt::Key_F1);
    EXPECT_EQ(editor.User().TakeLog(), QStringList{QStringLiteral("help %1").arg(topic)}) << caption;
  }
}

}  // namespace
}  // namespace tessal
