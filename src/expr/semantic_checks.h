// What the grammar cannot see: that each called function exists and gets the right number of arguments, that
// a particle property is a known one, and which texts may serve as symbols.
#pragma once

#include <cstdint>
#include <span>
#include <string_view>
#include <vector>

#include "core/messages.h"
#include "platform/uid.h"

namespace tessal {

class ExpressionNode;
class ParsedExpression;

/// Checks a parsed expression. Each finding, the failure of a parse among them, goes to the error registry
/// under the symbol and identity. False only when it did not parse.
bool CheckFunctions(std::string_view symbol, Uid uid, const ParsedExpression& parsed);

/// A finding on a call or a particle property, by its name.
struct CallFinding {
  Finding finding;
  std::string_view name;       ///< as in the tree
  std::int32_t arguments = 0;  ///< given to a call
};

/// The same findings on a tree as values, which go nowhere else.
std::vector<CallFinding> FindCallFaults(const ExpressionNode& tree);

/// Parses and checks an expression: 0 when it does not parse, else 1, also with findings.
int CheckFunctionsSpecified(std::string_view symbol, Uid uid, std::string_view expression);

/// The words of the tables.
std::span<const std::string_view> PropertyNames();
std::span<const std::string_view> InteractionVerbs();

/// Whether a text is one of the words of a table, exactly.
bool IsPropertyName(std::string_view text);
bool IsInteractionVerb(std::string_view text);
bool IsConditionalWord(std::string_view text);

/// A letter, then letters, digits and underscores.
bool IsValidSymbolSpelling(std::string_view text);

/// Spelt like a symbol and no user function's name, conditional word, verb or catalogue function, as
/// written: `sin` passes where `SIN` fails.
bool IsValidSymbol(std::string_view text);

/// A catalogue function, conditional word or verb in any case, or a number; the empty text reads as one.
bool IsReservedName(std::string_view text);

}  // namespace tessal
