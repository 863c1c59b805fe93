// The unit of an expression, from the units of what it names. Numbers are wild cards: as a term or a side of
// a comparison one takes the unit of the others, and as a factor it may hide a unit or a conversion, so that
// what it is a factor of is compared less strictly.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "analysis/symbol_index.h"
#include "analysis/unit_check.h"
#include "analysis/unit_text.h"
#include "analysis/unit_value.h"
#include "expr/function_reference.h"
#include "expr/scanner.h"

namespace tessal {

class ExpressionNode;

/// The unit of a part of an expression.
struct ExpressionUnit {
  enum class Kind : std::uint8_t {
    Unknown,
    Number,  ///< any: numbers alone
    Known
  };
  Kind kind = Kind::Unknown;
  Unit unit;  ///< when known
  /// Whether a number among the factors may have a unit of its own, "0.0986*wind": the unit is a guess, and a
  /// clash is no finding.
  bool isGuess = false;
  /// Whether there is a number at all, which may be what makes an argument fit: "EXP(-2*temp)".
  bool hasNumber = false;
  std::optional<double> number;  ///< of numbers alone, where it is known
  std::string_view spelling;     ///< the unit's text, where an element declares it
  const ExpressionNode* node = nullptr;

  bool IsCertain() const { return kind == Kind::Known && !isGuess; }
};

/// The unit's declared text, or as modellers write it.
std::string ShownUnit(const ExpressionUnit& value);

/// Two units that do not go together.
struct UnitClash {
  enum class Kind : std::uint8_t { Sum, Comparison, Branches, Argument, Assignment };
  Kind kind;
  LexemeSpan place;  ///< of the smallest part that has both
  std::string left;
  std::string right;
  std::string argument{};  ///< of an argument: its name
  std::string function{};  ///< and the function's
};

/// The units of a template's elements, and of expressions over them. Good until the template changes.
class UnitInference final {
 public:
  UnitInference(const TemplateCore& core, Substances substances);

  /// What the unit of an element was read as; none where it was not, or has none.
  std::optional<Unit> DeclaredOf(const CEL_Element& element);

  /// The unit of a parsed expression. The clashes in it are added, each once, and no more than twenty: what
  /// follows them is most often their consequence.
  ExpressionUnit Infer(const RecordExpression& expression, std::vector<UnitClash>& clashes);

 private:
  class Walk;

  std::optional<Unit> Read(std::string_view text);
  const FunctionReference* Function(std::string_view name);

  SymbolIndex index;
  Substances substances;
  UnitReader reader;
  std::unordered_map<std::string_view, const FunctionReference*> functions;
};

}  // namespace tessal
