#include "cli/lsp/symbol_places.h"

#include <algorithm>

#include "expr/scanner.h"
#include "expr/token_spans.h"
#include "keyfile/keywords.h"
#include "platform/ascii.h"

namespace tessal::cli {

namespace {

constexpr std::string_view kPools = "TESSAL_POOLS";
constexpr std::string_view kBoundary = "BOUNDARY";

bool Holds(std::string_view part, std::string_view text, std::size_t offset) {
  const auto start = static_cast<std::size_t>(part.data() - text.data());
  return offset >= start && offset <= start + part.size();
}

/// The identifier of an expression at a place. Between two tokens the one that begins there counts.
std::string_view IdentifierAt(std::string_view expression, std::size_t caret) {
  std::string_view found;
  for (const TokenSpan& token : TokenSpans(expression)) {
    if (token.code != TokenCode::Identifier) continue;
    if (caret >= token.span.start && caret <= token.End()) found = TextOf(expression, token);
  }
  return found;
}

/// The same part of the text that the template was read into.
std::string_view InSource(const LoadedDocument& document, std::string_view part) {
  const auto start = static_cast<std::size_t>(part.data() - document.Text().data());
  return document.Core().SourceText().substr(start, part.size());
}

/// The keyword of an element's equation, where it is the symbol as it should be; empty for any other element.
std::string_view EquationKeywordOf(const LoadedDocument& document, const CEL_Element& element) {
  std::string_view found;
  element.ForEachExpression([&](const PropertyRow& row, const CEL_Property& expression) {
    // A row without a keyword is read under the element's symbol.
    if (!row.keyword.empty()) return;
    const std::string_view keyword = document.KeywordOf(expression.Text());
    if (EqualIgnoringCase(keyword, element.symbol.Text())) found = InSource(document, keyword);
  });
  return found;
}

/// Calls the visitor with each text in quotes of the value after a keyword.
template <class Visitor>
void ForEachQuoted(std::string_view text, std::string_view keyword, Visitor visit) {
  std::size_t place = text.find('=', static_cast<std::size_t>(keyword.data() - text.data()));
  while (place != std::string_view::npos) {
    const std::size_t quote = text.find_first_not_of(" \t\r\n,", place + 1);
    if (quote == std::string_view::npos || (text[quote] != '\'' && text[quote] != '|')) return;
    const std::size_t end = text.find(text[quote], quote + 1);
    if (end == std::string_view::npos) return;
    visit(text.substr(quote + 1, end - quote - 1));
    place = end;
  }
}

enum class PoolText : std::uint8_t { Expression, Process };

/// Calls the visitor with each expression and each process of the pools, as parts of the text that was read.
template <class Visitor>
void ForEachPoolText(const LoadedDocument& document, Visitor visit) {
  const auto& sections = document.Outline().Sections();
  for (const OutlineKeyword& keyword : document.Outline().Keywords()) {
    if (!keyword.section || !sections[*keyword.section].parent) continue;
    const OutlineSection& around = sections[*sections[*keyword.section].parent];
    if (around.parent || !EqualIgnoringCase(around.name, kPools)) continue;
    const bool isExpression = EqualIgnoringCase(keyword.word, key::kExpression);
    if (!isExpression && !EqualIgnoringCase(keyword.word, kBoundary)) continue;
    ForEachQuoted(document.Text(), keyword.word, [&](std::string_view value) {
      const std::string_view part = InSource(document, value);
      if (isExpression) {
        visit(StripExpressionQuotes(part), PoolText::Expression);
      } else {
        visit(part, PoolText::Process);
      }
    });
  }
}

/// The name at a place in the pools; empty where there is none.
std::string_view NameInPools(const LoadedDocument& document, std::size_t offset) {
  std::string_view found;
  ForEachPoolText(document, [&](std::string_view part, PoolText kind) {
    const std::size_t start = *document.OffsetOf(part);
    if (offset < start || offset > start + part.size()) return;
    found = kind == PoolText::Process ? part : IdentifierAt(part, offset - start);
  });
  return found;
}

class PlaceSearch final {
 public:
  PlaceSearch(const LoadedDocument& searched, std::string_view searchedName)
      : document(searched), name(searchedName), record(RecordOf(searched.Core(), searchedName)) {}

  std::vector<SymbolPlace> Run() {
    if (record != nullptr) {
      AddDeclaration(*record->element);
      const CEL_Element* previous = nullptr;
      for (const std::uint32_t sequence : record->referencedBy) {
        const CEL_Element* user = document.Core().FindRecordBySequence(sequence)->element;
        if (user != previous) AddUsesOf(*user);
        previous = user;
      }
    } else {
      ForEachElement(document.Core(), [this](const CEL_Element& element) { AddUsesOf(element); });
    }
    AddPools();
    std::sort(places.begin(), places.end(), [](const SymbolPlace& left, const SymbolPlace& right) {
      return left.part.data() < right.part.data();
    });
    return std::move(places);
  }

 private:
  void AddDeclaration(const CEL_Element& element) {
    const std::string_view symbol = element.symbol.Text();
    if (document.OffsetOf(symbol)) places.push_back({symbol, SymbolPlace::Role::Symbol});
    const std::string_view keyword = EquationKeywordOf(document, element);
    if (!keyword.empty()) places.push_back({keyword, SymbolPlace::Role::EquationKeyword});
  }

  void AddUsesOf(const CEL_Element& element) {
    element.ForEachExpression([this](const PropertyRow&, const CEL_Property& expression) {
      if (document.OffsetOf(expression.Text())) AddUses(StripExpressionQuotes(expression.Text()));
    });
  }

  void AddUses(std::string_view expression) {
    if (expression.find(name) == std::string_view::npos) return;
    for (const TokenSpan& token : TokenSpans(expression)) {
      const std::string_view lexeme = TextOf(expression, token);
      if (token.code == TokenCode::Identifier && lexeme == name)
        places.push_back({lexeme, SymbolPlace::Role::Use});
    }
  }

  void AddPools() {
    ForEachPoolText(document, [this](std::string_view part, PoolText kind) {
      if (kind == PoolText::Expression) {
        AddUses(part);
      } else if (part == name) {
        places.push_back({part, SymbolPlace::Role::Use});
      }
    });
  }

  const LoadedDocument& document;
  std::string_view name;
  const SymbolRecord* record;
  std::vector<SymbolPlace> places;
};

}  // namespace

const SymbolRecord* RecordOf(const TemplateCore& core, std::string_view name) {
  std::uint32_t sequence = 0;
  return core.FindSymbol(name, sequence) ? core.FindRecordBySequence(sequence) : nullptr;
}

std::optional<NameAtPlace> NameAt(const LoadedDocument& document, std::size_t offset) {
  const auto named = [&document](std::string_view name) {
    return NameAtPlace{name, RecordOf(document.Core(), name)};
  };
  const CEL_Element* element = document.ElementAt(offset);
  if (element == nullptr) {
    const std::string_view name = NameInPools(document, offset);
    return name.empty() ? std::nullopt : std::optional(named(name));
  }
  const std::string_view symbol = element->symbol.Text();
  const std::string_view source = document.Core().SourceText();
  if (document.OffsetOf(symbol) && Holds(symbol, source, offset)) return named(symbol);
  if (const auto expression = document.ExpressionAt(offset)) {
    const std::string_view identifier = IdentifierAt(expression->text, expression->caret);
    if (!identifier.empty()) return named(identifier);
    return std::nullopt;
  }
  // The keyword of an equation is the symbol again.
  const std::string_view keyword = EquationKeywordOf(document, *element);
  if (keyword.empty() || !Holds(keyword, source, offset)) return std::nullopt;
  return NameAtPlace{keyword, RecordOf(document.Core(), symbol)};
}

std::vector<SymbolPlace> PlacesOf(const LoadedDocument& document, std::string_view name) {
  return PlaceSearch(document, name).Run();
}

std::string_view DefinitionOf(const LoadedDocument& document, const CEL_Element& element) {
  if (document.OffsetOf(element.symbol.Text())) return element.symbol.Text();
  const auto section = document.SectionOf(element);
  if (!section) return {};
  const OutlineSection& found = document.Outline().Sections()[*section];
  return document.Core().SourceText().substr(found.start, found.name.size() + 2);
}

}  // namespace tessal::cli
