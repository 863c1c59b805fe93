#include "analysis/symbol_index.h"

#include "core/template_core.h"
#include "elements/property.h"
#include "expr/parser.h"
#include "expr/scanner.h"

namespace tessal {

SymbolIndex::SymbolIndex(const TemplateCore& indexed) : core(indexed) {
  records.reserve(core.SymbolTable().size());
  for (const SymbolRecord& record : core.SymbolTable()) {
    // Movements have captions, which no expression can name.
    if (record.kind == ElementKind::HorizontalVector || record.kind == ElementKind::VerticalEquation)
      continue;
    records.emplace(record.element->symbol.Text(), &record);
  }
}

const SymbolRecord* SymbolIndex::Find(std::string_view symbol) const {
  const auto hit = records.find(symbol);
  return hit == records.end() ? nullptr : hit->second;
}

RecordExpression ExpressionOf(const SymbolRecord& record) {
  if (record.expression == nullptr) return {};
  const ScannerStart start = ExpressionScannerStart();
  ResetExpressionScanner();
  const ExpressionNode* tree = record.expression->Parsed().Tree();
  SetExpressionScannerStart(start);
  return {StripExpressionQuotes(record.expression->Text()), tree};
}

}  // namespace tessal
