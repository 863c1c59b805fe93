// The rule of declaration: a definition comes before its uses. Equations are free of it, and use processes
// only.
#pragma once

#include <optional>

#include "core/messages.h"

namespace tessal {

class SymbolTable;
struct SymbolRecord;

/// What one use of an element of the template's own collections breaks; nothing when it is allowed.
std::optional<Finding> OrderViolation(const SymbolRecord& user, const SymbolRecord& used);
/// Reports each use of the record that breaks the rule; true when there is none.
bool CheckRecordOrder(const SymbolTable& table, const SymbolRecord& user);
/// The same for all records of the template's own elements with expressions.
bool CheckDeclarationOrder(const SymbolTable& table);

}  // namespace tessal
