// What elements may use by where they live in the water body and how they vary in space: the scope rule, and
// the older process rule that a template may be checked by in its place. Each reports what it finds; true
// when there is nothing.
#pragma once

namespace tessal {

class SymbolTable;

bool CheckScopeRule(const SymbolTable& table);
bool CheckProcessRule(const SymbolTable& table);

}  // namespace tessal
