#include "core/declaration_order.h"

#include "core/error_registry.h"
#include "core/symbol_table.h"
#include "elements/element.h"

namespace tessal {

std::optional<Finding> OrderViolation(const SymbolRecord& user, const SymbolRecord& used) {
  const std::string_view symbol = used.element->symbol.Text();
  if (user.kind == ElementKind::StateVariable) {
    if (used.kind == ElementKind::Process) return std::nullopt;
    return Finding("not-a-process", {symbol});
  }
  if (used.sequence <= static_cast<std::uint32_t>(user.element->id.IntValue())) return std::nullopt;
  return Finding("order-violated", {symbol, RecordSymbol(user)});
}

bool CheckRecordOrder(const SymbolTable& table, const SymbolRecord& record) {
  bool good = true;
  for (const std::uint32_t sequence : record.references) {
    const std::optional<Finding> violation = OrderViolation(record, table.Used(sequence));
    if (!violation) continue;
    Errors().Report(RecordSymbol(record), record.uid, *violation);
    good = false;
  }
  return good;
}

bool CheckDeclarationOrder(const SymbolTable& table) {
  bool good = true;
  for (const SymbolRecord& record : table.Records()) {
    // The classes check the order of their members themselves.
    if (record.kind >= ElementKind::Specie || record.expression == nullptr) continue;
    good = CheckRecordOrder(table, record) && good;
  }
  return good;
}

}  // namespace tessal
