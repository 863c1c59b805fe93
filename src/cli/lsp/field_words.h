// The fields of an element's section as the file spells them: keywords, and the words that a value may be.
#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace tessal {
class CEL_Element;
class CEL_Property;
}  // namespace tessal

namespace tessal::cli {

/// The keywords of an element's section, in the order of the file.
std::vector<std::string_view> KeywordsOf(const CEL_Element& element);

/// The property that a keyword holds; none for a keyword of another section.
const CEL_Property* PropertyOf(const CEL_Element& element, std::string_view keyword);

/// A word that a value may be, and what it means.
struct ValueWord {
  std::string word;
  std::string meaning;
};

/// The words that the value of a keyword is chosen from; none for a free text or a number.
std::vector<ValueWord> WordsOfValue(const CEL_Element& element, std::string_view keyword);

}  // namespace tessal::cli
