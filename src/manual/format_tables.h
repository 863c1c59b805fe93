// The template format as a list of sections and one of keywords: what a save writes of a template that has
// one element of each kind, explained by the words of the format.
#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace tessal::manual {

struct WrittenKeyword {
  std::string name;
  std::string value;  ///< what a new element has, as the file holds it
};

struct WrittenSection {
  std::string name;  ///< "CONSTANT_" where it is numbered
  std::string path;  ///< the sections around it, with ' / ' between them; empty for the outermost
  std::string_view meaning;
  std::vector<WrittenKeyword> keywords;
};

struct KeywordChoice {
  std::string value;  ///< as the file holds it
  std::string meaning;
};

struct KeywordEntry {
  std::string name;
  std::string_view type;  ///< "text"
  std::string_view meaning;
  std::vector<KeywordChoice> choices;
};

struct FormatTables {
  std::vector<WrittenSection> sections;  ///< in the order of the file; each place that a section may have
  std::vector<KeywordEntry> keywords;    ///< in the order in which the sections first have them
};

/// Makes both. Raises `std::logic_error` for a section or a keyword that nobody has explained.
FormatTables ReadFormat();

}  // namespace tessal::manual
