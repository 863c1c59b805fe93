#include "core/rename.h"

#include <utility>

#include "core/template_core.h"
#include "expr/scanner.h"
#include "expr/semantic_checks.h"
#include "platform/ascii.h"

namespace tessal {

namespace {

/// Rewrites an expression in its stored form, between quotes: the word rule knows the opening one.
std::string ReplaceInExpression(std::string_view expression, std::string_view oldWord,
                                std::string_view newWord) {
  const std::string rewritten = ReplaceWord('"' + std::string(expression) + '"', oldWord, newWord);
  return std::string(StripExpressionQuotes(rewritten));
}

ElementField TextField(std::string_view name, std::string_view text) {
  ElementField field;
  field.kind = FieldKind::Text;
  field.name = name;
  field.text = text;
  return field;
}

}  // namespace

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
    // of a stored expression. It is looked at as the text stands behind the replacements so far.
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
  std::uint32_t sequence = 0;
  if (SymbolExists(newSymbol) || !FindSymbol(oldSymbol, sequence)) return false;
  flags.modified = true;
  // The rewrites must not change the table under the walk.
  flags.rebuildEnabled = false;
  if (replaceInExpressions) RewriteUsers(Record(sequence), oldSymbol, newSymbol);
  GetElementBySequence(sequence)->symbol.SetText(newSymbol);
  ApplySymbol(sequence, newSymbol);
  flags.rebuildEnabled = true;
  RebuildSymbolTable();
  return true;
}

void TemplateCore::RewriteUsers(const SymbolRecord& renamed, std::string_view oldSymbol,
                                std::string_view newSymbol) {
  const auto rewrite = [oldSymbol, newSymbol](CEL_Property& expression) {
    expression.SetText(ReplaceInExpression(expression.Text(), oldSymbol, newSymbol));
  };
  const CEL_Element* previous = nullptr;
  for (const std::uint32_t sequence : renamed.referencedBy) {
    const SymbolRecord& user = Record(sequence);
    // A movement has two records, side by side; its first one rewrites both expressions.
    if (std::exchange(previous, user.element) == user.element) continue;
    switch (user.element->Kind()) {
      case ElementKind::HorizontalVector: {
        auto& vector = static_cast<CEL_Lagrange_Horizontal_Vector&>(*user.element);
        rewrite(vector.direction);
        rewrite(vector.speed);
        break;
      }
      case ElementKind::VerticalEquation:
        rewrite(static_cast<CEL_Lagrange_Vertical_Equation&>(*user.element).speed);
        break;
      default:
        ApplyExpression(sequence, ReplaceInExpression(user.text, oldSymbol, newSymbol));
        break;
    }
  }
}

bool TemplateCore::ApplyExpression(std::uint32_t sequence, std::string_view text) {
  return ApplyFields(sequence, {TextField("Expression", text), TextField("Equation", text)});
}

bool TemplateCore::ApplySymbol(std::uint32_t sequence, std::string_view text) {
  return ApplyFields(sequence, {TextField("Symbol", text)});
}

bool TemplateCore::ApplyFields(std::uint32_t sequence, const std::vector<ElementField>& fields) {
  CEL_Element* element = GetElementBySequence(sequence);
  if (element == nullptr || element->SetFields(fields) == 0) return false;
  flags.modified = true;
  return true;
}

}  // namespace tessal
