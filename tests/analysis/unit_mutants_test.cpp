// How many slips in units the check finds: each example is spoilt in one place at a time. The listing has the
// shares, and each mutant that was not found.
#include <gtest/gtest.h>

#include <filesystem>
#include <set>

#include "analysis/declared_values.h"
#include "analysis/symbol_index.h"
#include "analysis/unit_check.h"
#include "analysis/unit_inference.h"
#include "analysis/unit_text.h"
#include "core/template_core.h"
#include "elements/element.h"
#include "expr/expression_node.h"
#include "expr/expression_shape.h"
#include "expr/node_span.h"
#include "support/case_file.h"

namespace tessal::test {
namespace {

/// Mutants of one sort, and what became of them.
struct Score {
  std::string title;
  int made = 0;
  int found = 0;
  std::string missed{};

  std::string Text() const {
    return "  " + title + ": " + std::to_string(found) + " of " + std::to_string(made) + "\n" + missed;
  }
};

CEL_Property& PropertyOf(CEL_Element& element, std::string_view label) {
  return element.*element.PlaceWithLabel(label);
}

class Mutants final {
 public:
  explicit Mutants(const std::filesystem::path& file) {
    EXPECT_TRUE(core.LoadWrapper(file.string())) << file;
    EXPECT_TRUE(CheckUnits(core, Substances::Ignored).findings.empty()) << file;
  }

  std::string Text() {
    // A change of the template may make its table again.
    for (std::size_t place = 0; place < core.SymbolTable().size(); ++place) {
      SpoilUnit(place);
      SpoilExpression(place);
    }
    return dimensions.Text() + factors.Text() + dropped.Text();
  }

 private:
  const SymbolRecord& At(std::size_t place) const { return core.SymbolTable()[place]; }

  void Try(CEL_Property& property, const std::string& text, const std::string& what, Score& score) {
    const std::string former(property.Text());
    ASSERT_TRUE(property.SetText(text));
    ++score.made;
    if (CheckUnits(core, Substances::Ignored).findings.empty()) {
      score.missed += "    " + what + "\n";
    } else {
      ++score.found;
    }
    ASSERT_TRUE(property.SetText(former));
  }

  /// Another dimension, and the same with another factor.
  void SpoilUnit(std::size_t place) {
    const SymbolRecord& record = At(place);
    const std::string text(DeclaredUnit(*record.element).value_or(""));
    const std::optional<Unit> unit = ReadUnitText(text);
    if (!unit || (record.referencedBy.empty() && record.expression == nullptr)) return;
    CEL_Property& property = PropertyOf(*record.element, "Unit");
    const std::string symbol = RecordSymbol(record);
    const std::string other = HaveSameDimension(*unit, *ReadUnitText("m")) ? "kg" : "m";
    Try(property, other, symbol + ": " + text + " -> " + other, dimensions);
    const std::string factor =
        IsDimensionless(*unit) ? "percent" : "1000 (" + (text[0] == '/' ? "1" + text : text) + ")";
    if (text != "percent") Try(property, factor, symbol + ": " + text + " -> " + factor, factors);
  }

  /// A factor that has a unit is left out of a product: 1 takes its place.
  void SpoilExpression(std::size_t place) {
    const RecordExpression expression = ExpressionOf(At(place));
    if (expression.tree == nullptr) return;
    const std::string text(expression.text);
    std::vector<std::string> spoilt;
    std::vector<const ExpressionNode*> nodes{expression.tree};
    while (!nodes.empty()) {
      const ExpressionNode& node = *nodes.back();
      nodes.pop_back();
      for (std::int32_t slot = 1; slot <= node.ChildCount(); ++slot) nodes.push_back(node.Child(slot));
      if (!IsProduct(node) && (node.Kind() != NodeKind::Arithmetic || node.Text() != "/")) continue;
      for (const std::int32_t slot : {1, 2}) {
        const ExpressionNode& factor = *node.Child(slot);
        // What is a product itself loses its factors one by one.
        if ((slot == 1 && (node.Text() == "/" || IsProduct(factor))) || !HasUnit(expression.text, factor))
          continue;
        const LexemeSpan span = SpanOf(factor, expression.text);
        spoilt.push_back(std::string(text).replace(span.start, span.length, "1"));
      }
    }
    for (const std::string& mutant : spoilt) {
      const SymbolRecord& record = At(place);
      CEL_Property& property = PropertyOf(*record.element, record.element->LabelOf(*record.expression));
      Try(property, "\"" + mutant + "\"", RecordSymbol(record) + ": " + mutant, dropped);
    }
  }

  bool HasUnit(std::string_view text, const ExpressionNode& factor) const {
    UnitInference inference(core, Substances::Ignored);
    std::vector<UnitClash> clashes;
    const ExpressionUnit value = inference.Infer({text, &factor}, clashes);
    return value.kind == ExpressionUnit::Kind::Known && !IsDimensionless(value.unit);
  }

  TemplateCore core;
  Score dimensions{"units of another dimension"};
  Score factors{"units of another factor"};
  Score dropped{"factors left out"};
};

TEST(UnitMutants, AreFound) {
  std::string text;
  for (const char* name : {"eutrophication", "fasham", "fish_larvae", "lake_management", "streeter_phelps"}) {
    const std::filesystem::path folder(TESSAL_SOURCE_DIR);
    text += std::string(name) + "\n" + Mutants(folder / "examples" / (std::string(name) + ".tessal")).Text();
  }
  ExpectListing("analysis/cases/unit_mutants.txt", text);
}

}  // namespace
}  // namespace tessal::test
