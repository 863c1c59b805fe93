// The names that expressions use, found fast: what an analysis makes at its start and drops at its end.
#pragma once

#include <string_view>
#include <unordered_map>

#include "core/symbol_table.h"

namespace tessal {

class ExpressionNode;
class TemplateCore;

class SymbolIndex final {
 public:
  /// Good until the template changes.
  explicit SymbolIndex(const TemplateCore& indexed);

  const TemplateCore& Template() const { return core; }
  /// The first record with this symbol, as references find it; none for an undefined name.
  const SymbolRecord* Find(std::string_view symbol) const;

 private:
  const TemplateCore& core;
  std::unordered_map<std::string_view, const SymbolRecord*> records;
};

/// The tree of a record's expression, and the text that its names and places are in; none for a record
/// without an expression, or one that does not parse. Leaves no trace in the scanner.
struct RecordExpression {
  std::string_view text;  ///< the quotes stripped
  const ExpressionNode* tree = nullptr;
};
RecordExpression ExpressionOf(const SymbolRecord& record);

}  // namespace tessal
