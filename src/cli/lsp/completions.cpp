// What may be typed at a place: in an expression what the rules of the template allow there, elsewhere the
// keywords of the section, the words of a value and the names of sections.
#include <algorithm>
#include <optional>
#include <string>

#include "cli/lsp/features.h"
#include "cli/lsp/field_words.h"
#include "cli/lsp/unfinished_text.h"
#include "core/completion.h"
#include "elements/format_words.h"
#include "expr/function_reference.h"
#include "platform/ascii.h"

namespace tessal::cli {

namespace {

/// More rows are no help to a reader; a client asks again as more is typed.
constexpr std::size_t kMostRows = 500;

enum ItemKind : int {
  kFunctionItem = 3,
  kVariableItem = 6,
  kModuleItem = 9,
  kPropertyItem = 10,
  kEnumMember = 20,
  kKeywordItem = 14,
  kConstantItem = 21
};

struct GroupRow {
  ItemKind kind;
  const char* detail;
};

/// In the order of `CompletionGroup`.
constexpr GroupRow kGroups[] = {
    {kVariableItem, ""},         {kFunctionItem, "function"}, {kFunctionItem, "user function"},
    {kKeywordItem, "verb"},      {kKeywordItem, "keyword"},   {kConstantItem, "built-in"},
    {kPropertyItem, "property"},
};

/// A list of items that all take the place of what was typed.
class ItemList final {
 public:
  explicit ItemList(Json typed) : range(std::move(typed)) {}

  void Add(std::string_view text, ItemKind kind, std::string_view detail, std::string_view meaning) {
    // Clients sort by this text: the order here is by what was typed.
    constexpr std::size_t kDigits = 5;
    std::string order = std::to_string(items.size());
    order.insert(0, kDigits - std::min(kDigits, order.size()), '0');
    Json item = {{"label", text}, {"kind", kind}, {"sortText", std::move(order)}};
    if (!detail.empty()) item["detail"] = detail;
    if (!meaning.empty()) item["documentation"] = meaning;
    item["textEdit"] = {{"range", range}, {"newText", text}};
    items.push_back(std::move(item));
  }

  Json Take(bool isWhole) { return {{"isIncomplete", !isWhole}, {"items", std::move(items)}}; }

 private:
  Json range;
  Json items = Json::array();
};

void AddElement(ItemList& list, const Completion& completion) {
  const CEL_Element& element = *completion.element;
  const PropertyPlace unit = element.PlaceWithLabel("Unit");
  std::string detail(element.KindText());
  if (unit != nullptr && !(element.*unit).Text().empty())
    detail += " [" + std::string((element.*unit).Text()) + "]";
  list.Add(completion.text, kVariableItem, detail, element.description.Text());
}

Json InExpression(const LoadedDocument& document, const ExpressionPlace& place) {
  const CaretContext context = ContextAt(place.text, place.caret);
  const std::string_view typed = place.text.substr(context.word.start, place.caret - context.word.start);
  ItemList list(document.RangeOf(place.start + context.word.start, place.start + place.caret));
  const std::vector<Completion> offered =
      Matching(CompletionsFor(document.Core(), *place.element, context.place), typed);
  const std::size_t count = std::min(offered.size(), kMostRows);
  for (std::size_t index = 0; index < count; ++index) {
    const Completion& completion = offered[index];
    if (completion.element != nullptr) {
      AddElement(list, completion);
      continue;
    }
    const GroupRow& row = kGroups[static_cast<std::size_t>(completion.group)];
    const FunctionReference* function =
        completion.group == CompletionGroup::Function ? ReferenceOfFunction(completion.text) : nullptr;
    if (function != nullptr) {
      list.Add(completion.text, row.kind, CallText(*function), function->purpose);
    } else {
      list.Add(completion.text, row.kind, row.detail, {});
    }
  }
  return list.Take(count == offered.size());
}

bool Begins(std::string_view word, std::string_view typed) {
  return EqualIgnoringCase(word.substr(0, typed.size()), typed);
}

/// The keywords that the section does not have yet.
void AddKeywords(const LoadedDocument& document, const CEL_Element& element, std::size_t section,
                 std::string_view typed, ItemList& list) {
  for (const std::string_view word : KeywordsOf(element)) {
    const auto& present = document.Outline().Keywords();
    const bool isThere =
        std::any_of(present.begin(), present.end(), [section, word](const OutlineKeyword& keyword) {
          return keyword.section == section && EqualIgnoringCase(keyword.word, word);
        });
    if (!isThere && Begins(word, typed)) list.Add(word, kPropertyItem, "keyword", MeaningOfKeyword(word));
  }
}

Json InLine(const LoadedDocument& document, std::size_t offset) {
  const std::string_view before = LineBefore(document, offset);
  std::size_t start = before.size();
  while (start > 0 && IsWordCharacter(before[start - 1])) --start;
  const std::string_view typed = before.substr(start);
  const std::string_view prefix = before.substr(0, start);
  const std::size_t last = prefix.find_last_not_of(" \t");
  ItemList list(document.RangeOf(offset - typed.size(), offset));
  const CEL_Element* element = document.ElementAt(offset);
  const auto section = document.Outline().SectionAt(offset);
  if (last == std::string_view::npos) {
    if (element != nullptr && section && document.SectionOf(*element) == section)
      AddKeywords(document, *element, *section, typed, list);
    if (section && Begins("EndSect", typed)) list.Add("EndSect", kKeywordItem, "", "Ends the section.");
  } else if (prefix[last] == '[' && prefix.find_first_not_of(" \t") == last) {
    for (const SectionWord& word : SectionWords()) {
      if (Begins(word.name, typed)) list.Add(word.name, kModuleItem, "section", word.meaning);
    }
  } else if (element != nullptr && prefix[last] == '\'') {
    for (const ValueWord& word : WordsOfValue(*element, KeywordOfLine(before))) {
      if (Begins(word.word, typed)) list.Add(word.word, kEnumMember, "", word.meaning);
    }
  }
  return list.Take(true);
}

/// The expression at a place, whether it is whole or not.
std::optional<ExpressionPlace> ExpressionOf(const LoadedDocument& document, std::size_t offset) {
  const auto whole = document.ExpressionAt(offset);
  return whole ? whole : UnfinishedExpression(document, offset);
}

Json ParametersOf(const FunctionReference& function) {
  Json parameters = Json::array();
  for (const ArgumentReference& argument : function.arguments) {
    const std::string unit = UnitInWords(function, argument.unit);
    parameters.push_back({{"label", argument.name},
                          {"documentation", std::string(argument.meaning) +
                                                (unit.empty() ? std::string() : " [" + unit + "]")}});
  }
  return parameters;
}

}  // namespace

Json Completions(const LoadedDocument& document, const Json& params) {
  const std::size_t offset = PositionIn(document, params);
  const auto expression = ExpressionOf(document, offset);
  return expression ? InExpression(document, *expression) : InLine(document, offset);
}

Json SignatureHelp(const LoadedDocument& document, const Json& params) {
  const auto place = ExpressionOf(document, PositionIn(document, params));
  if (!place) return nullptr;
  const auto call = ContextAt(place->text, place->caret).call;
  const FunctionReference* function =
      call ? ReferenceOfFunction(place->text.substr(call->name.start, call->name.length)) : nullptr;
  if (function == nullptr) return nullptr;
  const Json signature = {{"label", CallText(*function)},
                          {"documentation", function->purpose},
                          {"parameters", ParametersOf(*function)}};
  return {
      {"signatures", Json::array({signature})}, {"activeSignature", 0}, {"activeParameter", call->argument}};
}

}  // namespace tessal::cli
