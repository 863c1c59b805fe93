// Renaming a symbol, as text: whole words in the stored expressions are replaced, and the next rebuild finds
// the references again.
#pragma once

#include <cstdint>
#include <functional>
#include <map>
#include <string>
#include <string_view>
#include <vector>

namespace tessal {

class TemplateCore;

/// What a rename does to the expressions that use the symbol.
enum class Rewriting : std::uint8_t {
  None,        ///< nothing: the uses become undefined
  ByLetters,   ///< `ReplaceInExpression`, which changes longer names too
  WholeNames,  ///< `ReplaceName`
};

/// Replaces each whole occurrence of a word. Only letters bind: digits and the underscore do not make a word
/// longer, so renaming `a` changes `a_1` and `a2` too. The result of a replacement is not looked at again.
std::string ReplaceWord(std::string_view text, std::string_view oldWord, std::string_view newWord);

/// The same in an expression. It is looked at in its stored form, between quotes: the word rule knows the
/// opening one.
std::string ReplaceInExpression(std::string_view expression, std::string_view oldWord,
                                std::string_view newWord);

/// Replaces a name where it is the whole of an identifier, as the language reads it: `a_1`, numbers and
/// comments stay. What the rename looks at leaves no trace in the scanner.
std::string ReplaceName(std::string_view expression, std::string_view oldName, std::string_view newName);

/// New names by the old ones.
using NewNames = std::map<std::string, std::string, std::less<>>;

/// The same with several names at once: one may take the place of another.
std::string ReplaceNames(std::string_view expression, const NewNames& newNames);

/// A longer name, or a number, that a rename by letters would change into one that means nothing, or
/// something else.
struct LostName {
  std::string name;
  std::string becomes;
};

/// What the expressions that use a symbol would lose by a rename by letters, in the order of their first use.
/// A name that is undefined already is none of them. Empty when the rename is safe, or refused for the old
/// symbol.
std::vector<LostName> LostByRename(const TemplateCore& core, std::string_view oldSymbol,
                                   std::string_view newSymbol);

/// What becomes of it, in words for the user.
std::string LossText(const TemplateCore& core, const LostName& lost);

/// Why an element may not take a new symbol, in words for the user; empty when it may. Blanks at both ends of
/// the new symbol are the caller's to cut.
std::string RenameRefusal(const TemplateCore& core, std::string_view newSymbol);

/// What to say when a rename fails all the same.
std::string RenameFailure(std::string_view newSymbol);

}  // namespace tessal
