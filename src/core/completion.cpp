#include "core/completion.h"

#include <algorithm>
#include <array>
#include <optional>
#include <unordered_set>

#include "core/scope_rule.h"
#include "core/template_core.h"
#include "expr/builtin_catalogue.h"
#include "expr/function_catalogue.h"
#include "expr/semantic_checks.h"
#include "expr/user_function_names.h"
#include "platform/ascii.h"

namespace tessal {

namespace {

struct KeywordRow {
  std::string_view text;
  CaretPlace place;
};

constexpr std::array<KeywordRow, 6> kKeywords = {{
    {"IF", CaretPlace::Value},
    {"NOT", CaretPlace::Value},
    {"THEN", CaretPlace::Operator},
    {"ELSE", CaretPlace::Operator},
    {"AND", CaretPlace::Operator},
    {"OR", CaretPlace::Operator},
}};

/// Whether a symbol reads as one name in an expression; captions such as those of derived outputs do not.
bool IsName(std::string_view symbol) {
  return !symbol.empty() && !IsAsciiDigit(symbol.front()) &&
         std::all_of(symbol.begin(), symbol.end(), IsWordCharacter);
}

bool IsEquation(ElementKind kind) {
  return kind == ElementKind::StateVariable || kind == ElementKind::SpecieStateVariable;
}

/// One collection of what an expression may name.
class Offers final {
 public:
  Offers(const TemplateCore& templateCore, const SymbolRecord& userRecord)
      : core(templateCore), user(userRecord) {}

  void AddSymbols(CaretPlace place) {
    for (const CatalogueBuiltin& builtin : Builtins()) builtins.insert(builtin.name);
    std::unordered_set<std::string_view> seen;
    for (const SymbolRecord& record : core.SymbolTable()) {
      const std::string_view symbol = record.element->symbol.Text();
      builtins.erase(symbol);
      // A target is a class, and a class is a target only.
      if ((record.kind == ElementKind::Specie) != (place == CaretPlace::Target) || !IsName(symbol)) continue;
      if (core.HasSharedSymbols() && !seen.insert(symbol).second) continue;
      if (record.element == user.element || core.FindUseFault(user, record)) continue;
      Add(symbol, CompletionGroup::Symbol, record.element);
    }
  }

  void AddCallables() {
    for (const CatalogueFunction& function : Functions()) {
      if (!function.traits.isDeprecated) Add(function.name, CompletionGroup::Function);
    }
    for (const std::string& name : UserFunctionNames()) Add(name, CompletionGroup::UserFunction);
    if (user.kind <= ElementKind::Specie || IsEquation(user.kind)) return;
    for (const std::string_view verb : InteractionVerbs()) Add(verb, CompletionGroup::Verb);
  }

  void AddKeywords(CaretPlace place) {
    for (const KeywordRow& keyword : kKeywords) {
      if (keyword.place == place) Add(keyword.text, CompletionGroup::Keyword);
    }
  }

  /// Those that no element represents yet, and that one could represent where the expression may use it.
  void AddBuiltins() {
    if (IsEquation(user.kind)) return;
    for (const CatalogueBuiltin& builtin : Builtins()) {
      if (!builtins.contains(builtin.name) || IsDeprecatedBuiltin(builtin.id)) continue;
      SymbolRecord used;
      used.kind = builtin.kind == 1 ? ElementKind::Constant : ElementKind::Forcing;
      used.scope = ScopeFromText(LayerText(builtin.layer));
      used.spatial = SpatialFromText(VariationText(builtin.variation));
      if (!ScopeRuleViolation(user, used)) Add(builtin.name, CompletionGroup::Builtin);
    }
  }

  void Add(std::string_view text, CompletionGroup group, const CEL_Element* element = nullptr) {
    rows.push_back({text, group, element});
  }

  std::vector<Completion> Take() { return std::move(rows); }

 private:
  const TemplateCore& core;
  const SymbolRecord& user;
  std::unordered_set<std::string_view> builtins;  ///< those that no element represents
  std::vector<Completion> rows;
};

/// How well a text fits what was typed, 0 the best; nothing when it does not.
std::optional<int> FitOf(std::string_view text, std::string_view typed) {
  enum Fit : std::uint8_t { Same, Begins, PartBegins, Inside };
  if (text == typed) return Same;
  if (text.size() < typed.size()) return std::nullopt;
  const auto begins = [&](std::size_t place) {
    return EqualIgnoringCase(text.substr(place, typed.size()), typed);
  };
  if (begins(0)) return Begins;
  constexpr std::size_t kLettersOfAPart = 3;
  std::optional<int> fit;
  for (std::size_t place = 1; place + typed.size() <= text.size(); ++place) {
    if (!begins(place)) continue;
    if (text[place - 1] == '_') return PartBegins;
    if (typed.size() >= kLettersOfAPart) fit = Inside;
  }
  return fit;
}

bool ComesBefore(std::string_view left, std::string_view right) {
  return std::lexicographical_compare(left.begin(), left.end(), right.begin(), right.end(),
                                      [](char one, char other) { return UpperCase(one) < UpperCase(other); });
}

}  // namespace

std::vector<Completion> CompletionsFor(const TemplateCore& core, const CEL_Element& user, CaretPlace place) {
  const SymbolRecord* record = core.RecordOfElement(user);
  if (record == nullptr || place == CaretPlace::Nothing) return {};
  Offers offers(core, *record);
  if (place == CaretPlace::Property) {
    for (const std::string_view name : PropertyNames()) offers.Add(name, CompletionGroup::Property);
    return offers.Take();
  }
  if (place != CaretPlace::Operator) offers.AddSymbols(place);
  if (place == CaretPlace::Value) offers.AddCallables();
  offers.AddKeywords(place);
  if (place == CaretPlace::Value) offers.AddBuiltins();
  return offers.Take();
}

std::vector<Completion> Matching(const std::vector<Completion>& offered, std::string_view typed) {
  struct Ranked {
    int fit;
    const Completion* completion;
  };
  std::vector<Ranked> ranked;
  for (const Completion& completion : offered) {
    if (const auto fit = FitOf(completion.text, typed)) ranked.push_back({*fit, &completion});
  }
  std::stable_sort(ranked.begin(), ranked.end(), [](const Ranked& left, const Ranked& right) {
    const auto keyOf = [](const Ranked& row) { return std::pair(row.fit, row.completion->group); };
    if (keyOf(left) != keyOf(right)) return keyOf(left) < keyOf(right);
    return ComesBefore(left.completion->text, right.completion->text);
  });
  std::vector<Completion> rows;
  rows.reserve(ranked.size());
  for (const Ranked& row : ranked) rows.push_back(*row.completion);
  return rows;
}

}  // namespace tessal
