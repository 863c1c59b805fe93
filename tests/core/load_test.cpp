#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <string_view>

#include "core/error_registry.h"
#include "core/loaded_template.h"
#include "support/template_text.h"

namespace tessal {
namespace {

using test::LoadedTemplate;
using test::Messages;
using test::TemplateText;

TEST(Load, FillsEveryCollection) {
  LoadedTemplate loaded(test::RandomTemplate(1, 40));
  ASSERT_TRUE(loaded.Loaded());
  EXPECT_EQ(Messages(), "");
  EXPECT_EQ(loaded.Undefined(), "");
  EXPECT_EQ(loaded->GetConstantCount(), 11U);
  EXPECT_EQ(loaded->GetSpecieCount(), 1U);
  EXPECT_FALSE(loaded->Modified());
  EXPECT_EQ(loaded->GetDerivedOutput(0).symbol.Text(), "Derived Output 1");
  std::uint32_t place = 0;
  for (const SymbolRecord& record : loaded->SymbolTable()) EXPECT_EQ(record.sequence, ++place);
  EXPECT_EQ(loaded->GetMisc()->tessalVersion.RealValue(), 2017001 * 0.001);
  EXPECT_EQ(loaded->GetMisc()->trigonometrics.Text(), "Radians");
  EXPECT_FALSE(loaded->GetMisc()->optimise.BoolValue());
}

TEST(Load, TellsWhyItFails) {
  TemplateCore core;
  EXPECT_FALSE(core.LoadWrapper("/nowhere/model.tessal"));
  EXPECT_EQ(Messages(), "4 LOAD : Can not open file /nowhere/model.tessal\n\n");
  struct Row {
    const char* text;
    const char* start;
  };
  const Row rows[] = {
      {"[TESSAL_SETUP]\n A = ]\nEndSect\n", "4 LOAD : Synthax error near line 2 position 6 : ]\n"},
      {"\x7f\x45\x4c\x46\x02\x01", "4 LOAD : Synthax error near line 1 position 1 : \x7f"},
  };
  for (const Row& row : rows) {
    LoadedTemplate loaded(row.text);
    EXPECT_FALSE(loaded.Loaded());
    EXPECT_EQ(Errors().Records().size(), 1U);
    EXPECT_EQ(Messages().substr(0, std::string_view(row.start).size()), row.start);
  }
  // More equations than state variables.
  std::string text = TemplateText().StateVariable("S", "0").Text();
  text.replace(text.find("[E]"), 3, "[X]\nEndSect\n[E]");
  EXPECT_FALSE(LoadedTemplate(text).Loaded());
  EXPECT_NE(Messages().find("4 LOAD : invalid vector<T> subscript"), std::string::npos);
}

TEST(Load, FilesWithoutMuchInThemLoad) {
  for (const char* text : {"", "\n[OTHER]\nEndSect\n", "\n[TESSAL_SETUP]\nEndSect\n", "// nothing\n"}) {
    LoadedTemplate loaded(text);
    EXPECT_TRUE(loaded.Loaded()) << text;
    const bool hasTarget = std::string_view(text).find("TESSAL") != std::string_view::npos;
    EXPECT_EQ(loaded->GetMisc() == nullptr, hasTarget) << text << ": only a target tells that it has none";
    EXPECT_EQ(loaded->SymbolTable().size(), 0U);
    EXPECT_EQ(Errors().GetErrorCount(3) + Errors().GetErrorCount(4), 0U) << text << Messages();
  }
  LoadedTemplate loaded("\n[TESSAL_SETUP]\nEndSect\n");
  EXPECT_EQ(Messages(), "");
  LoadedTemplate empty("");
  EXPECT_EQ(Messages(), "2 could not read template: : the file is empty, or no regular file\n");
}

TEST(Load, ATemplateCanBeReadAgainFromItsOwnFile) {
  LoadedTemplate loaded(TemplateText().Constant("k").Text());
  EXPECT_TRUE(loaded->LoadWrapper(loaded->TemplateFileName())) << Messages();
  EXPECT_EQ(loaded->GetConstantCount(), 1U);
  EXPECT_EQ(loaded->SaveFileName(), loaded.Path());
}

TEST(Load, MessagesAboutTheFileKnowTheirLine) {
  const auto lineOf = [](std::string_view part) {
    for (const ErrorRecord& record : Errors().Records()) {
      if (record.text.find(part) != std::string::npos) return record.line;
    }
    return -1;
  };
  const std::string text = TemplateText().Constant("k").Without("UNIT").Text();
  const auto heads =
      std::count(text.begin(), text.begin() + static_cast<std::ptrdiff_t>(text.find("[CONSTANT_1]")), '\n');
  LoadedTemplate missing(text);
  EXPECT_EQ(lineOf("could not find key UNIT in CONSTANT_1"), heads + 1);
  LoadedTemplate broken("\n[TESSAL_SETUP]\n A = ]\nEndSect\n");
  EXPECT_EQ(lineOf("Synthax error"), 3);
  LoadedTemplate crowded("\n[TESSAL_SETUP]\n[STATE_VARIABLE_EQUATIONS]\n[E]\nEndSect\nEndSect\nEndSect\n");
  EXPECT_EQ(lineOf("STATE_VARIABLE_EQUATIONS has more sub-sections than there are state variables"), 3);
}

TEST(Load, SettingsThatStandInTheFileAreNoAbsentOnes) {
  // The missing version keeps the integers behind it from being read; they keep what they had.
  std::string text = TemplateText().Misc("DOCUMENT_REVISION = 3\nOPTIMISE = 'YES'\n").Text();
  text.erase(text.find("PARSER_VERSION"), std::string_view("PARSER_VERSION = 2017.001\n").size());
  LoadedTemplate loaded(text);
  EXPECT_EQ(Messages(), "3 : could not find key PARSER_VERSION in MISC\n");
  EXPECT_EQ(loaded->GetDocumentRevision(), 0);
  EXPECT_TRUE(loaded->GetMisc()->optimise.BoolValue());
  EXPECT_EQ(loaded->GetMisc()->trigonometrics.Text(), "Radians");
}

TEST(Load, ReportsOneOfARunOfMissingNumbers) {
  LoadedTemplate loaded(TemplateText()
                            .Constant("k", "7")
                            .Without("DEFAULT_VALUE")
                            .Without("MIN_VALUE")
                            .Without("SYMBOL")
                            .Text());
  EXPECT_TRUE(loaded.Loaded());
  EXPECT_EQ(Messages().substr(0, Messages().find("2 ")),
            "3 : could not find key SYMBOL in CONSTANT_1\n3 : could not find key MIN_VALUE in CONSTANT_1\n");
  // What was not read keeps its default.
  EXPECT_EQ(loaded->GetConstant(0).maxValue.RealValue(), 100.0);
}

TEST(Load, OptionalKeysAndWrongTypes) {
  LoadedTemplate loaded(TemplateText()
                            .Process("p", "1")
                            .Without("CONTROLID")
                            .Without("CONTROLVALUE")
                            .Constant("k")
                            .Without("UNQ_TYPE")
                            .With("UNIT", "5")
                            .With("MIN_VALUE", "'text'")
                            .Text());
  EXPECT_EQ(loaded->GetProcess(0).controlId.IntValue(), -1);
  EXPECT_EQ(loaded->GetProcess(0).controlValue.RealValue(), 0.8);
  EXPECT_EQ(loaded->GetConstant(0).unqType.IntValue(), 999);
  EXPECT_EQ(loaded->GetConstant(0).unit.Text(), "5");
  EXPECT_EQ(Messages(), "3 : could not find key MIN_VALUE in CONSTANT_1\n");
}

TEST(Load, AStateVariableWithoutMaximumTakesTheMinimum) {
  LoadedTemplate loaded(
      TemplateText().StateVariable("S", "0").With("MIN_VALUE", "2").Without("MAX_VALUE").Text());
  EXPECT_EQ(loaded->GetStateVariable(0).maxValue.RealValue(), 2.0);
}

TEST(Load, NumbersOfTheFileAreSetRight) {
  LoadedTemplate loaded(
      TemplateText().Constant("a").With("ID", "99999").Constant("b").With("ID", "-5").Text());
  EXPECT_EQ(loaded->GetConstant(0).id.IntValue(), 1);
  EXPECT_EQ(loaded->GetConstant(1).id.IntValue(), 2);
  EXPECT_FALSE(loaded->Modified());
}

TEST(Load, ABadExpressionKeepsItsTextAndItsReferences) {
  LoadedTemplate loaded(TemplateText().Constant("k").Auxiliary("a", "k + (nobody").Text());
  EXPECT_TRUE(loaded.Loaded());
  EXPECT_EQ(loaded->GetAuxiliary(0).expression.Text(), "k + (nobody");
  EXPECT_EQ(loaded.References("a"), "k ");
  EXPECT_EQ(loaded.Undefined(), "nobody ");
  // Once from the compilation, once from the check.
  EXPECT_EQ(Errors().GetErrorCount(2), 2U);
}

TEST(Load, TruncatedAnywhereIsAMessageOrATemplate) {
  const std::string text = test::RandomTemplate(3, 4);
  for (std::size_t length = 0; length < text.size(); length += 7) {
    LoadedTemplate loaded(text.substr(0, length));
    EXPECT_TRUE(loaded.Loaded() || Errors().GetErrorCount(4) > 0) << length;
  }
}

TEST(Load, LineEndsAndByteOrderMarkMakeNoDifference) {
  const std::string text = test::RandomTemplate(5, 12);
  std::string full;
  for (const char character : text)
    full += character == '\n' ? std::string("\r\n") : std::string(1, character);
  LoadedTemplate bare(text);
  EXPECT_EQ(Messages(), "");
  LoadedTemplate windows("\xEF\xBB\xBF" + full);
  EXPECT_EQ(Messages(), "");
  EXPECT_EQ(bare->KeptTree().CountChildren(CKvfBaseItem::kSection), 2U);
  EXPECT_EQ(windows->KeptTree().CountChildren(CKvfBaseItem::kSection), 2U);
  EXPECT_EQ(bare->GetAuxiliary(0).expression.Text(), windows->GetAuxiliary(0).expression.Text());
}

}  // namespace
}  // namespace tessal
