#include "core/declaration_order.h"

#include "core/error_registry.h"
#include "core/symbol_table.h"
#include "elements/element.h"

namespace tessal {

bool CheckRecordOrder(const SymbolTable& table, const SymbolRecord& record) {
  const CEL_Element& user = *record.element;
  bool good = true;
  for (const std::uint32_t sequence : record.references) {
    const CEL_Element& used = *table.Used(sequence).element;
    if (user.Kind() == ElementKind::StateVariable) {
      if (used.Kind() == ElementKind::Process) continue;
      Errors().Report(RecordSymbol(record), user.GetUid(), {"not-a-process", {used.symbol.Text()}});
    } else {
      if (sequence <= static_cast<std::uint32_t>(user.id.IntValue())) continue;
      const std::string symbol = RecordSymbol(record);
      Errors().Report(symbol, user.GetUid(), {"order-violated", {used.symbol.Text(), symbol}});
    }
    good = false;
  }
  return good;
}

bool CheckDeclarationOrder(const SymbolTable& table) {
  bool good = true;
  for (const SymbolRecord& record : table.Records()) {
    // The classes check the order of their members themselves.
    if (record.element->Kind() >= ElementKind::Specie || !record.element->HasExpression()) continue;
    good = CheckRecordOrder(table, record) && good;
  }
  return good;
}

}  // namespace tessal
