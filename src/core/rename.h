// Renaming a symbol, as text: whole words in the stored expressions are replaced, and the next rebuild finds
// the references again.
#pragma once

#include <string>
#include <string_view>

namespace tessal {

class TemplateCore;

/// Replaces each whole occurrence of a word. Only letters bind: digits and the underscore do not make a word
/// longer, so renaming `a` changes `a_1` and `a2` too. The result of a replacement is not looked at again.
std::string ReplaceWord(std::string_view text, std::string_view oldWord, std::string_view newWord);

/// The same in an expression. It is looked at in its stored form, between quotes: the word rule knows the
/// opening one.
std::string ReplaceInExpression(std::string_view expression, std::string_view oldWord,
                                std::string_view newWord);

/// Why an element may not take a new symbol, in words for the user; empty when it may. Blanks at both ends of
/// the new symbol are the caller's to cut.
std::string RenameRefusal(const TemplateCore& core, std::string_view newSymbol);

/// What to say when a rename fails all the same.
std::string RenameFailure(std::string_view newSymbol);

}  // namespace tessal
