// What the words of the format mean: the fields of the forms and the choices that they offer, as tips show
// them. A word is explained by the label of its field, since several fields offer the same word.
#pragma once

#include <string>
#include <string_view>

namespace tessal {

/// What a field of a form is for, by its label; empty for a label without an explanation.
std::string_view MeaningOfField(std::string_view label);

/// What a choice of that field means, by the text that the form shows; empty for one that is a name of the
/// template's own.
std::string MeaningOfChoice(std::string_view label, std::string_view choice);

}  // namespace tessal
