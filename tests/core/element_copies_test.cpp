#include "core/element_copies.h"

#include <gtest/gtest.h>

#include "core/comparison.h"
#include "core/loaded_template.h"
#include "expr/scanner.h"
#include "support/template_text.h"

namespace tessal {
namespace {

std::vector<Uid> AllElements(const TemplateCore& core) {
  std::vector<Uid> uids;
  for (const SymbolRecord& record : core.SymbolTable()) uids.push_back(record.uid);
  return uids;
}

Uid UidOf(const TemplateCore& core, const std::string& symbol) {
  std::uint32_t sequence = 0;
  return core.FindSymbol(symbol, sequence) ? core.FindRecordBySequence(sequence)->uid : Uid::None;
}

std::string SymbolsOf(const TemplateCore& core, const std::vector<Uid>& uids) {
  std::string text;
  for (const Uid uid : uids) text += (text.empty() ? "" : " ") + core.GetElement(uid)->symbol.TextOf();
  return text;
}

TEST(ElementCopies, AreAllThatTheOriginalsAre) {
  for (unsigned seed = 1; seed <= 40; ++seed) {
    ResetExpressionScanner();
    test::LoadedTemplate original(test::RandomTemplate(seed, 30));
    const CopiedText copied = TextOfElements(*original, AllElements(*original));
    ASSERT_EQ(copied.refusal, "");
    TemplateCore other;
    SetNotifyChanges(true);
    other.History().Start();
    ASSERT_EQ(PasteElements(other, copied.text, {}).refusal, "") << "seed " << seed;
    for (const SymbolChange& change : CompareBySymbol(*original, other)) {
      // Groups, user functions, settings and the texts of lists are no elements.
      const CEL_Element* element = original->GetElement(UidOf(*original, change.symbol));
      EXPECT_TRUE(element == nullptr || !CanCopy(*element))
          << "seed " << seed << ": " << change.kind << " " << change.symbol << " "
          << (change.fields.empty()
                  ? ""
                  : change.fields[0].field + " " + change.fields[0].before + " -> " + change.fields[0].after);
    }
    EXPECT_EQ(other.History().UndoCount(), 1U);
    other.Undo();
    EXPECT_TRUE(other.SymbolTable().empty()) << "seed " << seed;
  }
}

constexpr const char* kModel = R"(constant k 0.3
constant k1 0.4
state A B - k
auxiliary B k1*k
class Fish
class.state Fish_w Fish_r
class.expression Fish_r k + 1
class Crab
class.state Crab_w 1
)";

TEST(ElementCopies, GetFreeNamesAndUseEachOther) {
  test::LoadedTemplate loaded(test::TemplateFromNotation(kModel));
  TemplateCore& core = *loaded;
  const CopiedText copied = TextOfElements(core, {UidOf(core, "B"), UidOf(core, "k1")});
  const PastedElements pasted = PasteElements(core, copied.text, {UidOf(core, "k"), Uid::None});
  EXPECT_EQ(SymbolsOf(core, pasted.uids), "k2 B2");
  // The constant that was not copied is the same for both.
  EXPECT_EQ(core.GetAuxiliary(1).expression.Text(), "k2*k");
  EXPECT_EQ(core.GetAuxiliary(0).expression.Text(), "k1*k");
  EXPECT_EQ(core.GetConstant(1).symbol.Text(), "k2") << "after the element that was named";
  const PastedElements again = DuplicateElements(core, {UidOf(core, "k1"), UidOf(core, "k")});
  EXPECT_EQ(SymbolsOf(core, again.uids), "k3 k4");
  EXPECT_EQ(SymbolsOf(core, AllElements(core)).substr(0, 18), "A k k3 k2 k1 k4 B ");
}

TEST(ElementCopies, OfMembersGoToTheClassThatTakesThem) {
  test::LoadedTemplate loaded(test::TemplateFromNotation(kModel));
  TemplateCore& core = *loaded;
  const CopiedText copied = TextOfElements(core, {UidOf(core, "Fish_w"), UidOf(core, "Fish_r")});
  const Uid crab = core.GetSpecie(1).GetUid();
  EXPECT_EQ(SymbolsOf(core, PasteElements(core, copied.text, {Uid::None, crab}).uids), "Fish_w2 Fish_r2");
  EXPECT_EQ(core.GetSpecie(1).stateVariables[1]->equation.Text(), "Fish_r2");
  EXPECT_EQ(SymbolsOf(core, PasteElements(core, copied.text, {}).uids), "Fish_w3 Fish_r3");
  EXPECT_EQ(core.GetSpecie(0).stateVariables.size(), 2U) << "without a class they go to that of the name";
  TemplateCore empty;
  const PastedElements refused = PasteElements(empty, copied.text, {});
  EXPECT_NE(refused.refusal, "");
  EXPECT_TRUE(refused.uids.empty());
  const PastedElements wholeClass =
      PasteElements(empty, TextOfElements(core, {core.GetSpecie(0).GetUid()}).text, {});
  EXPECT_EQ(SymbolsOf(empty, wholeClass.uids), "Fish");
  EXPECT_EQ(empty.GetSpecie(0).stateVariables.size(), 2U);
}

TEST(ElementCopies, OfSearchesLookAtWhatTheirOriginalsDo) {
  test::LoadedTemplate loaded(test::TemplateFromNotation(kModel));
  TemplateCore& core = *loaded;
  CEL_Lagrange_Spatial_Function& search = core.GetSpecie(0).AddSpatialFunction();
  core.RebuildSymbolTable();
  search.variableId.SetInt(core.GetConstant(1).id.IntValue());
  search.lookFor.SetInt(2);
  const std::string alone = TextOfElements(core, {search.GetUid()}).text;
  const std::string withBoth =
      TextOfElements(core, {search.GetUid(), UidOf(core, "k1"), core.GetSpecie(1).GetUid()}).text;
  const auto pasted = [&core](const std::string& text) {
    const Uid uid = PasteElements(core, text, {}).uids.back();
    return static_cast<CEL_Lagrange_Spatial_Function*>(core.GetElement(uid));
  };
  const auto symbolOf = [&core](const CEL_Lagrange_Spatial_Function& function) {
    return core.GetElementBySequence(static_cast<std::uint32_t>(function.variableId.IntValue()))
        ->symbol.TextOf();
  };
  const auto* copy = pasted(alone);
  EXPECT_EQ(symbolOf(*copy), "k1");
  EXPECT_EQ(copy->lookFor.IntValue(), 2);
  PasteElements(core, withBoth, {});
  const auto& searches = core.GetSpecie(0).spatialFunctions;
  EXPECT_EQ(symbolOf(*searches.back()), "k2") << "a copy of what they look at, where there is one";
  EXPECT_EQ(searches.back()->lookFor.IntValue(), 3);
  TemplateCore other;
  PasteElements(other, TextOfElements(core, {core.GetSpecie(0).GetUid()}).text, {});
  EXPECT_EQ(other.GetSpecie(0).spatialFunctions[0]->variableId.IntValue(), -1);
}

TEST(ElementCopies, OfNoTemplateAreRefused) {
  TemplateCore core;
  core.SetModified(false);
  core.History().Start();
  for (const std::string text :
       {"", "k = 3", "[TESSAL_SETUP]\nEndSect\n", "\x01\xff[", "[TESSAL_SETUP]\n[CONST"}) {
    const PastedElements pasted = PasteElements(core, text, {});
    EXPECT_NE(pasted.refusal, "") << text;
    EXPECT_TRUE(pasted.uids.empty() && !core.Modified()) << text;
  }
  EXPECT_EQ(core.History().UndoCount(), 0U);
}

}  // namespace
}  // namespace tessal
