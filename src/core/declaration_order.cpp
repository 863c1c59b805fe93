#include "core/declaration_order.h"

#include "core/error_registry.h"
#include "core/symbol_table.h"
#include "elements/element.h"

namespace tessal {

bool CheckRecordOrder(const SymbolTable& table, const SymbolRecord& record) {
  const CEL_Element& user = *record.element;
  const bool isEquation = record.kind == ElementKind::StateVariable;
  bool good = true;
  for (const std::uint32_t sequence : record.references) {
    const SymbolRecord& usedRecord = table.Used(sequence);
    const bool isFine = isEquation ? usedRecord.kind == ElementKind::Process
                                   : sequence <= static_cast<std::uint32_t>(user.id.IntValue());
    if (isFine) continue;
    const CEL_Element& used = *usedRecord.element;
    if (isEquation) {
      Errors().Report(RecordSymbol(record), user.GetUid(), {"not-a-process", {used.symbol.Text()}});
    } else {
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
    if (record.kind >= ElementKind::Specie || record.expression == nullptr) continue;
    good = CheckRecordOrder(table, record) && good;
  }
  return good;
}

}  // namespace tessal
