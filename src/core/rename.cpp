#include "core/rename.h"

#include <algorithm>
#include <cstddef>
#include <unordered_set>
#include <utility>

#include "core/pools.h"
#include "core/template_core.h"
#include "expr/scanner.h"
#include "expr/semantic_checks.h"
#include "expr/token_walk.h"
#include "platform/ascii.h"

namespace tessal {

namespace {

/// `ReplaceWord`, with the places of what it replaced in the text.
std::string ReplaceWordAt(std::string_view text, std::string_view oldWord, std::string_view newWord,
                          std::vector<std::size_t>& places) {
  places.clear();
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
    places.push_back(hit);
    result += text.substr(copied, hit - copied);
    result += newWord;
    copied = position = end;
  }
  result += text.substr(copied);
  return result;
}

std::string Quoted(std::string_view expression) {
  return '"' + std::string(expression) + '"';
}

/// Collects the names that a rename loses, over the expressions that use its symbol.
class LossSearch final {
 public:
  LossSearch(const TemplateCore& core, std::string_view oldSymbol, std::string_view newSymbol)
      : oldName(oldSymbol), newName(newSymbol) {
    for (const auto& name : core.UndefinedSymbols()) undefined.insert(name->symbol);
  }

  void LookAt(std::string_view expression) {
    ReplaceWordAt(Quoted(expression), oldName, newName, places);
    auto place = places.cbegin();
    ForEachToken(expression, [this, &place, expression](TokenCode /*code*/, std::string_view lexeme) {
      const auto begin = static_cast<std::size_t>(lexeme.data() - expression.data()) + kQuote;
      while (place != places.cend() && *place < begin) ++place;  // in a comment
      std::string becomes;
      std::size_t copied = 0;
      for (; place != places.cend() && *place < begin + lexeme.size(); ++place) {
        becomes.append(lexeme.substr(copied, *place - begin - copied)).append(newName);
        copied = *place - begin + oldName.size();
      }
      if (copied == 0 || lexeme == oldName || undefined.contains(lexeme)) return;
      becomes += lexeme.substr(copied);
      if (noted.insert(std::string(lexeme)).second) {
        lost.push_back({std::string(lexeme), std::move(becomes)});
      }
    });
  }

  std::vector<LostName> Take() { return std::move(lost); }

 private:
  /// The opening quote of the stored form, in which the places count.
  static constexpr std::size_t kQuote = 1;

  std::string_view oldName;
  std::string_view newName;
  std::unordered_set<std::string_view> undefined;
  std::vector<std::size_t> places;
  std::unordered_set<std::string> noted;
  std::vector<LostName> lost;
};

/// The record of a symbol that may become the new one; none when there is no such.
const SymbolRecord* RecordToRename(const TemplateCore& core, std::string_view oldSymbol,
                                   std::string_view newSymbol) {
  std::uint32_t sequence = 0;
  if (core.SymbolExists(newSymbol) || !core.FindSymbol(oldSymbol, sequence)) return nullptr;
  const SymbolRecord* record = core.FindRecordBySequence(sequence);
  return record->element->symbol.Editable() ? record : nullptr;
}

/// Calls the visitor with each expression of each element that uses the record's.
template <class Visitor>
void ForEachUsingExpression(const TemplateCore& core, const SymbolRecord& used, Visitor visit) {
  const CEL_Element* previous = nullptr;
  for (const std::uint32_t sequence : used.referencedBy) {
    CEL_Element* user = core.FindRecordBySequence(sequence)->element;
    // The two records of a movement are side by side.
    if (user == previous) continue;
    previous = user;
    user->ForEachExpression([&visit](const PropertyRow&, CEL_Property& expression) { visit(expression); });
  }
}

using Replacement = std::string (*)(std::string_view, std::string_view, std::string_view);

/// The pools name symbols too. Those that can not be read stay as they are.
void RenameInPools(TemplateCore& core, const std::string& oldName, const std::string& newName,
                   Replacement replace) {
  PoolsRead read = PoolsOf(core);
  const std::vector<Pool> former = read.pools;
  for (Pool& pool : read.pools) {
    pool.expression = replace(pool.expression, oldName, newName);
    std::replace(pool.boundary.begin(), pool.boundary.end(), oldName, newName);
  }
  std::string failure;
  if (read.pools != former) SetPools(core, read.pools, failure);
}

}  // namespace

std::string ReplaceWord(std::string_view text, std::string_view oldWord, std::string_view newWord) {
  std::vector<std::size_t> places;
  return ReplaceWordAt(text, oldWord, newWord, places);
}

std::string ReplaceInExpression(std::string_view expression, std::string_view oldWord,
                                std::string_view newWord) {
  const std::string rewritten = ReplaceWord(Quoted(expression), oldWord, newWord);
  return std::string(StripExpressionQuotes(rewritten));
}

std::string ReplaceName(std::string_view expression, std::string_view oldName, std::string_view newName) {
  return ReplaceNames(expression, {{std::string(oldName), std::string(newName)}});
}

std::string ReplaceNames(std::string_view expression, const NewNames& newNames) {
  std::string result;
  const char* copied = expression.data();
  ForEachToken(expression, [&result, &copied, &newNames](TokenCode code, std::string_view lexeme) {
    const auto found = code == TokenCode::Identifier ? newNames.find(lexeme) : newNames.end();
    if (found == newNames.end()) return;
    result.append(copied, lexeme.data());
    // In "2a", which does not parse, a new name `e5` would become part of a number.
    if (!result.empty() && IsAsciiDigit(result.back())) result += ' ';
    result += found->second;
    copied = lexeme.data() + lexeme.size();
  });
  return result.append(copied, expression.data() + expression.size());
}

std::vector<LostName> LostByRename(const TemplateCore& core, std::string_view oldSymbol,
                                   std::string_view newSymbol) {
  const SymbolRecord* renamed = RecordToRename(core, oldSymbol, newSymbol);
  if (renamed == nullptr) return {};
  LossSearch search(core, oldSymbol, newSymbol);
  ForEachUsingExpression(core, *renamed,
                         [&search](const CEL_Property& expression) { search.LookAt(expression.Text()); });
  return search.Take();
}

std::string LossText(const TemplateCore& core, const LostName& lost) {
  const bool isTaken = core.SymbolExists(lost.becomes);
  return "'" + lost.name + "' to '" + lost.becomes +
         (isTaken ? "', which is another symbol" : "', which is undefined");
}

std::string RenameRefusal(const TemplateCore& core, std::string_view newSymbol) {
  const std::string quoted = "'" + std::string(newSymbol) + "'";
  if (!IsValidSymbolSpelling(newSymbol)) return quoted + " is not a valid identifier!";
  if (IsReservedName(newSymbol) || !IsValidSymbol(newSymbol)) {
    return quoted + " is invalid because it is an Tessal keyword!";
  }
  if (core.SymbolExists(newSymbol)) return "An item with the name " + quoted + " already exists!";
  return {};
}

std::string RenameFailure(std::string_view newSymbol) {
  return "An error occured when renaming '" + std::string(newSymbol) + "' !";
}

bool TemplateCore::RenameSymbol(std::string_view oldSymbol, std::string_view newSymbol,
                                bool replaceInExpressions) {
  return Rename(oldSymbol, newSymbol, replaceInExpressions ? Rewriting::ByLetters : Rewriting::None);
}

bool TemplateCore::Rename(std::string_view oldSymbol, std::string_view newSymbol, Rewriting rewriting) {
  const SymbolRecord* renamed = RecordToRename(*this, oldSymbol, newSymbol);
  if (renamed == nullptr) return false;
  // The caller's may be a view into what is about to change.
  const std::string oldName(oldSymbol);
  const std::string newName(newSymbol);
  const EditStep step(history);
  const bool wasModified = state.flags.modified;
  {
    // The rewrites must not change the table under the walk.
    const RebuildsOff noRebuilds(state.flags);
    CEL_Property& symbol = renamed->element->symbol;
    symbol.SetText(newName);
    if (symbol.Text() != newName) {
      // The element has rules of its own and kept its symbol.
      state.flags.modified = wasModified;
      return false;
    }
    state.flags.modified = true;
    if (rewriting != Rewriting::None) {
      const Replacement replace = rewriting == Rewriting::ByLetters ? ReplaceInExpression : ReplaceName;
      ForEachUsingExpression(*this, *renamed, [replace, &oldName, &newName](CEL_Property& expression) {
        expression.SetText(replace(expression.Text(), oldName, newName));
      });
      RenameInPools(*this, oldName, newName, replace);
    }
  }
  RebuildSymbolTable();
  return true;
}

}  // namespace tessal
