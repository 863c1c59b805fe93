// Finding in the texts and expressions of a template: a pattern in all that people write, and the uses of a
// symbol as the language reads them. Results are values; their texts and places are in UTF-8.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "core/text_pattern.h"
#include "core/text_walk.h"

namespace tessal {

enum class FindIn : std::uint8_t { All, Expressions, Texts };

struct FindQuery {
  PatternText pattern;
  FindIn in = FindIn::All;
};

/// A text with what was found in it.
struct FoundText {
  TextPlace place;
  TextRole role = TextRole::Text;
  ElementKind kind = ElementKind::None;  ///< of its owner
  bool isLocked = false;                 ///< the editor does not let it be changed
  int line = 0;                          ///< of the owner's section in the file, from 1; 0 for none
  std::string owner;                     ///< for people, in UTF-8 as the text
  std::string text;
  std::vector<TextMatch> matches;
};

struct FindResult {
  std::vector<FoundText> found;  ///< in the order of the template
  std::string failure;           ///< why the pattern cannot be used; empty when it can
};

/// Finds a pattern. The time is in proportion to the template.
FindResult FindTexts(const TemplateCore& core, const FindQuery& query);

/// Finds where the expressions use a name, by their tokens: longer names, numbers and comments are no uses. A
/// search that looks for the element counts as a use. The name need not be defined.
std::vector<FoundText> FindUses(const TemplateCore& core, std::string_view name);

/// How many matches there are in all.
std::size_t CountMatches(const std::vector<FoundText>& found);

}  // namespace tessal
