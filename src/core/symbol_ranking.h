// How well a symbol fits a few letters that somebody has typed to go to it: the letters must be in the symbol
// in their order, and count more at its start, at the start of a word in it, and side by side.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace tessal {

class TemplateCore;
struct SymbolRecord;

/// The higher, the better; nothing when the letters are not in the symbol in their order. Capitals count as
/// small letters, and decide between equals. A word begins at the symbol's start, after an underscore, at a
/// capital after a small letter, and at a digit after a letter. No letters fit everything alike. Of long
/// texts the first 256 bytes count.
std::optional<int> RankSymbol(std::string_view symbol, std::string_view letters);

/// The name that people look for an element by, in UTF-8: its symbol; of a derived output the description,
/// where it has one.
std::string NameToGoTo(const SymbolRecord& record);

/// The records of the elements that fit the letters, the best first, and of equals the shorter, then the
/// earlier; at most so many. An element has one record here, though it may have two in the table.
std::vector<const SymbolRecord*> SymbolsByRank(const TemplateCore& core, std::string_view letters,
                                               std::size_t most);

}  // namespace tessal
