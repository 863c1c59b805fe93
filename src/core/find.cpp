#include "core/find.h"

#include <numeric>
#include <utility>

#include "core/template_core.h"
#include "expr/token_walk.h"
#include "platform/text_encoding.h"

namespace tessal {

namespace {

FoundText Found(const TemplateCore& core, const TextOfTemplate& text, std::string shown,
                std::vector<TextMatch> matches) {
  return {text.place,
          text.role,
          text.kind,
          text.isLocked,
          text.element == nullptr ? 0 : text.element->SourceLine(),
          ToUtf8(OwnerName(core, text)),
          std::move(shown),
          std::move(matches)};
}

bool IsLookedIn(FindIn in, TextRole role) {
  return in == FindIn::All || (in == FindIn::Expressions) == (role == TextRole::Expression);
}

std::vector<TextMatch> UsesIn(std::string_view expression, std::string_view name) {
  std::vector<TextMatch> uses;
  ForEachToken(expression, [&uses, expression, name](TokenCode code, std::string_view lexeme) {
    if (code != TokenCode::Identifier || lexeme != name) return;
    uses.push_back({static_cast<std::size_t>(lexeme.data() - expression.data()), lexeme.size()});
  });
  return uses;
}

/// The searches that look for an element of the name.
void AppendSearches(const TemplateCore& core, std::string_view name, std::vector<FoundText>& found) {
  ForEachSearchFunction(core.Elements(), [&core, name, &found](const CEL_Lagrange_Spatial_Function& search) {
    if (search.VariableName() != name || search.variableId.IntValue() < 1) return;
    TextOfTemplate text;
    text.place = {search.GetUid(), search.LabelOf(search.variableId)};
    text.kind = search.Kind();
    text.element = &search;
    found.push_back(Found(core, text, std::string(name), {{0, name.size()}}));
  });
}

}  // namespace

FindResult FindTexts(const TemplateCore& core, const FindQuery& query) {
  FindResult result;
  const TextPattern pattern(query.pattern);
  result.failure = pattern.Failure();
  if (!result.failure.empty() || query.pattern.text.empty()) return result;
  ForEachText(core, [&core, &query, &pattern, &result](const TextOfTemplate& text) {
    if (text.text.empty() || !IsLookedIn(query.in, text.role)) return;
    std::string shown = ToUtf8(text.text);
    std::vector<TextMatch> matches = pattern.MatchesIn(shown);
    if (!matches.empty()) result.found.push_back(Found(core, text, std::move(shown), std::move(matches)));
  });
  return result;
}

std::vector<FoundText> FindUses(const TemplateCore& core, std::string_view name) {
  std::vector<FoundText> found;
  if (name.empty()) return found;
  ForEachText(core, [&core, name, &found](const TextOfTemplate& text) {
    if (text.role != TextRole::Expression || text.text.find(name) == std::string_view::npos) return;
    // Identifiers are ASCII: they are the same in the text that is shown.
    std::string shown = ToUtf8(text.text);
    std::vector<TextMatch> uses = UsesIn(shown, name);
    if (!uses.empty()) found.push_back(Found(core, text, std::move(shown), std::move(uses)));
  });
  AppendSearches(core, name, found);
  return found;
}

std::size_t CountMatches(const std::vector<FoundText>& found) {
  return std::accumulate(found.begin(), found.end(), std::size_t{0},
                         [](std::size_t sum, const FoundText& text) { return sum + text.matches.size(); });
}

}  // namespace tessal
