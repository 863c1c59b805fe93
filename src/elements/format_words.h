// What the words of the format mean: sections, keywords, the fields of the forms and the choices that they
// offer, as tips, the reference of the format and editors of the text show them. A choice is explained by the
// label of its field, since several fields offer the same word.
#pragma once

#include <span>
#include <string>
#include <string_view>

namespace tessal {

/// What a field of a form is for, by its label; empty for a label without an explanation.
std::string_view MeaningOfField(std::string_view label);

/// What a choice of that field means, by the text that the form shows; empty for one that is a name of the
/// template's own.
std::string MeaningOfChoice(std::string_view label, std::string_view choice);

/// What a keyword of the format holds; empty for any other word.
std::string_view MeaningOfKeyword(std::string_view keyword);

/// The label of the field that shows a keyword; empty for one that no form shows.
std::string_view FieldOfKeyword(std::string_view keyword);

/// A section of the format, by its name or, where sections are numbered, by what comes before the number.
struct SectionWord {
  std::string_view name;
  std::string_view meaning;
  bool IsNumbered() const { return name.ends_with('_'); }
};

/// All sections, in the order of the file.
std::span<const SectionWord> SectionWords();

/// The row of a section as the file names it, "CONSTANT_12" too; none for a name that is not of the format.
const SectionWord* WordOfSection(std::string_view name);

}  // namespace tessal
