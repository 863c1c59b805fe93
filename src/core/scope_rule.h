// What elements may use by where they live in the water body and how they vary in space: the scope rule, and
// the older process rule that a template may be checked by in its place. Each reports what it finds; true
// when there is nothing.
#pragma once

#include <optional>

#include "core/messages.h"

namespace tessal {

class SymbolTable;
struct SymbolRecord;

/// What one use violates of a rule; nothing when it is allowed. The message has the symbol used for its
/// value.
std::optional<Message> ScopeRuleViolation(const SymbolRecord& user, const SymbolRecord& used);
std::optional<Message> ProcessRuleViolation(const SymbolRecord& user, const SymbolRecord& used);

bool CheckScopeRule(const SymbolTable& table);
bool CheckProcessRule(const SymbolTable& table);

}  // namespace tessal
