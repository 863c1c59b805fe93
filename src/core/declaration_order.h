// The rule of declaration: a definition comes before its uses. Equations are free of it, and use processes
// only.
#pragma once

namespace tessal {

class SymbolTable;
struct SymbolRecord;

/// Reports each use of the record that breaks the rule; true when there is none.
bool CheckRecordOrder(const SymbolTable& table, const SymbolRecord& user);
/// The same for all records of the template's own elements with expressions.
bool CheckDeclarationOrder(const SymbolTable& table);

}  // namespace tessal
