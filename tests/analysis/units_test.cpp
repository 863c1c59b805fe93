// How unit texts are read, what units expressions have, and what the check of a template finds, by the files
// of cases. A unit that is a guess ends in " ~", one that follows from numbers alone is "any".
#include <gtest/gtest.h>

#include <memory>
#include <set>

#include "analysis/unit_check.h"
#include "analysis/unit_inference.h"
#include "analysis/unit_spelling.h"
#include "analysis/unit_text.h"
#include "core/loaded_template.h"
#include "elements/choices.h"
#include "expr/builtin_catalogue.h"
#include "expr/function_reference.h"
#include "expr/parser.h"
#include "support/case_file.h"
#include "support/template_text.h"

namespace tessal::test {
namespace {

std::string Reading(const std::string& text) {
  const std::optional<Unit> unit = ReadUnitText(text);
  if (!unit) return "not read\n";
  std::string shown = InBaseUnits(*unit) + "; " + AsModellersWrite(*unit);
  if (unit->isFactorOpen) shown += "; factor open";
  if (unit->hasUnnamedAmount) shown += "; amount of no substance";
  return shown + "\n";
}

TEST(Units, ReadTexts) {
  RunCases("analysis/cases/unit_texts.txt", [](const Case& lines) -> Answer {
    return [&lines](const CaseCall&) { return AnswerEach(lines.input, Reading); };
  });
}

// A row whose unit is not among these was meant to be readable.
TEST(Units, ReadAllThatTheCataloguesAsk) {
  std::set<std::string_view> unread;
  const auto read = [&unread](std::string_view text) {
    if (!ReadUnitText(text)) unread.insert(text);
  };
  for (const CatalogueBuiltin& row : Builtins()) read(row.unit);
  for (const UnitTypes* types :
       {&kPlainUnitTypes, &kInputUnitTypes, &kStateVariableUnitTypes, &kParticleUnitTypes}) {
    for (const UnitTypeRow& row : types->rows) read(row.unit);
  }
  EXPECT_EQ(unread, (std::set<std::string_view>{"", "auto", "dt/day", "mg/", "undefined"}));
  const auto readRule = [&read](const FunctionReference& function, std::string_view unit) {
    const std::optional<UnitRule> rule = RuleOfUnit(function, unit);
    if (rule && rule->kind == UnitRule::Kind::Fixed) read(rule->unit);
  };
  unread.clear();
  for (const FunctionGroup& group : FunctionGroups()) {
    for (const FunctionReference& function : group.functions) {
      readRule(function, function.resultUnit);
      for (const ArgumentReference& argument : function.arguments) readRule(function, argument.unit);
    }
  }
  EXPECT_EQ(unread, std::set<std::string_view>{});
}

/// What a template's own units give for the expression of a line.
class Expressions final {
 public:
  Expressions(const std::string& elements, Substances substances)
      : loaded(TemplateFromNotation(elements)), inference(*loaded, substances) {}

  std::string Of(const std::string& line) {
    const auto parsed = ParseExpression(line);
    if (parsed->Tree() == nullptr) return parsed->Failure()->finding.text;
    std::vector<UnitClash> clashes;
    const ExpressionUnit value = inference.Infer({line, parsed->Tree()}, clashes);
    std::string answer = UnitOf(value) + "\n";
    for (const UnitClash& clash : clashes) {
      answer +=
          "'" + line.substr(clash.place.start, clash.place.length) + "': " + clash.left + ", " + clash.right;
      answer += (clash.function.empty() ? "" : " for " + clash.argument) + "\n";
    }
    return answer;
  }

 private:
  static std::string UnitOf(const ExpressionUnit& value) {
    if (value.kind == ExpressionUnit::Kind::Unknown) return "unknown";
    if (value.kind == ExpressionUnit::Kind::Number) return "any";
    return ShownUnit(value) + (value.unit.isFactorOpen ? ", factor open" : "") + (value.isGuess ? " ~" : "");
  }

  LoadedTemplate loaded;
  UnitInference inference;
};

constexpr const char* kElements = R"(constant A | UNIT='mg/l'
constant B | UNIT='mg/l'
constant M | UNIT='mmol/m3'
constant mgN | UNIT='mg N/l'
constant mgC | UNIT='mg C/l'
constant NC | UNIT='g N/g C'
constant T | UNIT='degrees C'
constant k | UNIT='/d'
constant r | UNIT='/s'
constant h | UNIT='m'
constant w | UNIT='m/d'
constant x | UNIT='-'
constant pc | UNIT='percent'
constant I | UNIT='W/m2'
constant lat | UNIT='Degrees'
constant yr | UNIT='year'
constant u | UNIT='undefined')";

TEST(Units, FollowFromExpressions) {
  RunCases("analysis/cases/unit_expressions.txt", [](const Case& lines) -> Answer {
    return [&lines](const CaseCall& call) {
      Expressions expressions(kElements,
                              call.words == "strict" ? Substances::Dimensions : Substances::Ignored);
      return AnswerEach(lines.input,
                        [&expressions](const std::string& line) { return expressions.Of(line); });
    };
  });
}

std::string Report(const TemplateCore& core, Substances substances) {
  const UnitReport report = CheckUnits(core, substances);
  std::string text;
  for (const UnitFinding& unit : report.findings) {
    text += unit.finding.symbol + ": " + std::string(unit.finding.message->code) + ": " + unit.finding.text +
            "\n";
  }
  for (const UnknownUnit& unknown : report.unknown)
    text += "unknown: " + unknown.symbol + " '" + unknown.unit + "'\n";
  return text;
}

std::string Inferred(const TemplateCore& core) {
  std::string text;
  for (const SymbolRecord& record : core.SymbolTable()) {
    if (record.expression == nullptr) continue;
    text += RecordSymbol(record) + ": " + InferredUnit(core, *record.element).value_or("none") + "\n";
  }
  return text;
}

std::string List(const TemplateCore& core) {
  std::string text;
  for (const UnitReading& reading : ListUnits(core)) {
    text += "'" + reading.text + "' " + reading.read + " [" + reading.substance + "] " +
            std::to_string(reading.uses) + "\n";
  }
  return text;
}

TEST(Units, OfTemplatesAreChecked) {
  RunCases("analysis/cases/unit_checks.txt", [](const Case& elements) -> Answer {
    const auto loaded = std::make_shared<LoadedTemplate>(TemplateFromNotation(elements.input));
    return [loaded](const CaseCall& call) {
      if (call.words == "strict") return Report(**loaded, Substances::Dimensions);
      if (call.words == "inferred") return Inferred(**loaded);
      return call.words == "list" ? List(**loaded) : Report(**loaded, Substances::Ignored);
    };
  });
}

// A tree of a chain is as deep as the chain is long.
TEST(Units, OfLongChainsNeedNoDeepStack) {
  constexpr int kTerms = 100000;
  std::string sum = "A";
  std::string product = "x";
  for (int term = 1; term < kTerms; ++term) {
    sum += "+B";
    product += "*x";
  }
  Expressions expressions(kElements, Substances::Dimensions);
  EXPECT_EQ(expressions.Of(sum + "+h"), "mg/l\n'B+h': mg/l, m\n");
  EXPECT_EQ(expressions.Of(product), "-\n");
}

}  // namespace
}  // namespace tessal::test
