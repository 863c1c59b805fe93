#include "cli/lsp/field_words.h"

#include <algorithm>

#include "elements/element.h"
#include "elements/format_words.h"
#include "keyfile/keywords.h"
#include "platform/ascii.h"

namespace tessal::cli {

namespace {

/// What the sections of all elements have before their own keywords.
constexpr std::string_view kShared[] = {key::kSymbol, key::kId, key::kDescription, key::kOnlineHelp,
                                        key::kDocumentation};

}  // namespace

std::vector<std::string_view> KeywordsOf(const CEL_Element& element) {
  std::vector<std::string_view> words(std::begin(kShared), std::end(kShared));
  if (element.Kind() == ElementKind::Specie) words.front() = key::kName;
  for (const PropertyRow& row : element.Rows()) {
    const std::string_view word = row.writtenAs.empty() ? row.keyword : row.writtenAs;
    const bool isNew = !word.empty() && std::find(words.begin(), words.end(), word) == words.end();
    if (isNew) words.push_back(word);
  }
  return words;
}

const CEL_Property* PropertyOf(const CEL_Element& element, std::string_view keyword) {
  for (const PropertyRow& row : element.Rows()) {
    const bool isIt = EqualIgnoringCase(row.keyword, keyword) || EqualIgnoringCase(row.writtenAs, keyword);
    if (isIt && !keyword.empty()) return &(element.*row.place);
  }
  return nullptr;
}

std::vector<ValueWord> WordsOfValue(const CEL_Element& element, std::string_view keyword) {
  std::vector<ValueWord> words;
  const CEL_Property* property = PropertyOf(element, keyword);
  if (property == nullptr || !property->HasChoices()) return words;
  for (const CEL_Choice& choice : property->Choices()) {
    if (choice.fileText.empty() || !choice.enabled) continue;
    words.push_back({choice.fileText, MeaningOfChoice(FieldOfKeyword(keyword), choice.display)});
  }
  return words;
}

}  // namespace tessal::cli
