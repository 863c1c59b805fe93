#include "core/creation.h"

#include <gtest/gtest.h>

#include <map>

#include "core/loaded_template.h"
#include "support/template_text.h"

namespace tessal {
namespace {

using test::LoadedTemplate;
using test::TemplateText;

/// Answers by name: the index to choose, or -1 to say No. Notes what it was asked.
class ScriptedQuestions final : public CreationQuestions {
 public:
  ScriptedQuestions(TemplateCore& templateCore, std::map<std::string, int> scripted)
      : core(templateCore), answers(std::move(scripted)) {}

  bool AskYesNo(const std::string& question) override {
    const std::string start = "There are undefined symbols!\n\nDo you want to create symbol '";
    EXPECT_EQ(question.substr(0, start.size()), start);
    const std::string name = question.substr(start.size(), question.rfind("' ?") - start.size());
    asked += name + " ";
    return answers[name] >= 0;
  }
  int ChooseKind(const std::string& symbol, std::uint32_t mask) override {
    masks[symbol] = mask;
    return answers[symbol];
  }
  void Create(const CreateRequest& request) override { core.CreateElement(request); }

  std::string asked;
  std::map<std::string, std::uint32_t> masks;

 private:
  TemplateCore& core;
  std::map<std::string, int> answers;
};

TEST(Creation, AsksOnceForEachNameInOrder) {
  LoadedTemplate loaded(TemplateText().Auxiliary("a", "first + middle + third").Text());
  ScriptedQuestions questions(*loaded, {{"first", -1}, {"middle", 1}, {"third", -1}});
  EXPECT_TRUE(loaded->OfferUndefinedSymbols(questions));
  EXPECT_EQ(questions.asked, "first middle third ");
  EXPECT_EQ(loaded.Undefined(), "first third ");
  EXPECT_EQ(loaded->GetConstant(0).description.Text(), "middle Description");
  EXPECT_EQ(loaded->GetConstant(0).documentation.Text(), "middle Documentation");
  EXPECT_FALSE(loaded->OfferUndefinedSymbols(questions));
  EXPECT_EQ(questions.asked, "first middle third ");
}

TEST(Creation, OffersWhatTheLastUserMayUse) {
  LoadedTemplate loaded(TemplateText()
                            .StateVariable("S", "rate + both")
                            .Auxiliary("a", "both")
                            .DerivedOutput("shown")
                            .Specie("A", "A_new", {{"A_e", "inner"}})
                            .Text());
  loaded->GetSpecie(0).verticalEquation->speed.SetText("sink");
  ScriptedQuestions questions(
      *loaded, {{"rate", 4}, {"both", -1}, {"shown", 2}, {"A_new", 8}, {"inner", 6}, {"sink", 5}});
  questions.masks["both"] = 0;
  loaded->OfferUndefinedSymbols(questions);
  EXPECT_EQ(questions.masks["rate"], 16U);
  EXPECT_EQ(questions.masks["shown"], 31U);
  EXPECT_EQ(questions.masks["A_new"], 256U);
  EXPECT_EQ(questions.masks["inner"], 487U);
  EXPECT_EQ(questions.masks["sink"], 486U);
  EXPECT_EQ(loaded->GetProcess(0).symbol.Text(), "rate");
  const auto& specie = loaded->GetSpecie(0);
  EXPECT_EQ(specie.constants[0]->symbol.Text(), "inner");
  EXPECT_EQ(specie.stateVariables[1]->symbol.Text(), "sink");
  EXPECT_EQ(specie.arithmeticExpressions[1]->symbol.Text(), "A_new");
  EXPECT_EQ(specie.arithmeticExpressions[1]->expressionType.Text(), "PROCESS");
}

TEST(Creation, ANewElementStandsAheadOfItsUsersOfTheSameKind) {
  LoadedTemplate loaded(TemplateText().Auxiliary("a", "1").Auxiliary("b", "fresh").Text());
  CreateRequest request;
  request.symbol = "fresh";
  request.kind = kind::kAuxiliary;
  const CreatedElement created = loaded->CreateElement(request);
  EXPECT_TRUE(created.placed);
  EXPECT_EQ(created.predecessor, loaded.Uid("a"));
  EXPECT_EQ(loaded->GetAuxiliary(1).symbol.Text(), "fresh");
  EXPECT_TRUE(loaded->CheckDeclarationOrder());

  // Equations use processes regardless of order: the new one stays at the end.
  loaded->AddStateVariable().equation.SetText("later");
  loaded->AddProcess();
  request.symbol = "later";
  request.kind = kind::kProcess;
  EXPECT_FALSE(loaded->CreateElement(request).placed);
  EXPECT_EQ(loaded->GetProcess(1).symbol.Text(), "later");
  request.kind = 99;
  EXPECT_EQ(loaded->CreateElement(request).uid, 0U);
  EXPECT_TRUE(NotifyChanges()) << "also behind a request that makes nothing";
}

}  // namespace
}  // namespace tessal
