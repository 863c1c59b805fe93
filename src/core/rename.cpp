#include "core/rename.h"

#include <utility>

#include "core/template_core.h"
#include "expr/scanner.h"
#include "expr/semantic_checks.h"
#include "platform/ascii.h"

namespace tessal {

std::string ReplaceWord(std::string_view text, std::string_view oldWord, std::string_view newWord) {
  if (oldWord.empty()) return std::string(text);
  std::string result;
  std::size_t copied = 0;
  std::size_t position = 0;
  while (true) {
    const std::size_t hit = text.find(oldWord, position);
    if (hit == std::string_view::npos) break;
    std::size_t end = hit + oldWord.size();
    // The left side is looked at from the third character on: the one at position 1 follows the opening quote
    // of a stored expression. It is looked at as the text is after the replacements so far.
    const std::size_t hitInResult = result.size() + (hit - copied);
    const char left = hit > copied ? text[hit - 1] : (result.empty() ? '\0' : result.back());
    const bool boundLeft = hitInResult > 1 && IsAsciiLetter(left);
    const bool boundRight = end < text.size() && IsAsciiLetter(text[end]);
    if (boundLeft || boundRight) {
      while (end < text.size() && IsAsciiLetter(text[end])) ++end;
      position = end;
      continue;
    }
    result += text.substr(copied, hit - copied);
    result += newWord;
    copied = position = end;
  }
  result += text.substr(copied);
  return result;
}

std::string ReplaceInExpression(std::string_view expression, std::string_view oldWord,
                                std::string_view newWord) {
  const std::string rewritten = ReplaceWord('"' + std::string(expression) + '"', oldWord, newWord);
  return std::string(StripExpressionQuotes(rewritten));
}

std::string RenameRefusal(const TemplateCore& core, std::string_view newSymbol) {
  const std::string quoted = "'" + std::string(newSymbol) + "'";
  if (!IsValidSymbolSpelling(newSymbol)) return quoted + " is not a valid identifier!";
  if (IsReservedName(newSymbol)) return quoted + " is invalid because it is an Tessal keyword!";
  if (core.SymbolExists(newSymbol)) return "An item with the name " + quoted + " already exists!";
  return {};
}

std::string RenameFailure(std::string_view newSymbol) {
  return "An error occured when renaming '" + std::string(newSymbol) + "' !";
}

bool TemplateCore::RenameSymbol(std::string_view oldSymbol, std::string_view newSymbol,
                                bool replaceInExpressions) {
  const SymbolRecord* renamed = state.table.BySymbol(oldSymbol);
  if (renamed == nullptr || !renamed->element->symbol.Editable() || SymbolExists(newSymbol)) return false;
  state.flags.modified = true;
  {
    // The rewrites must not change the table under the walk.
    const RebuildsOff noRebuilds(state.flags);
    if (replaceInExpressions) {
      state.table.ForEachElement(renamed->referencedBy, [oldSymbol, newSymbol](const SymbolRecord& user) {
        user.element->ForEachExpression([oldSymbol, newSymbol](const PropertyRow&, CEL_Property& expression) {
          expression.SetText(ReplaceInExpression(expression.Text(), oldSymbol, newSymbol));
        });
      });
    }
    renamed->element->symbol.SetText(newSymbol);
  }
  RebuildSymbolTable();
  return true;
}

}  // namespace tessal
