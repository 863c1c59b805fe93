// A named value of an element, as the documentation and the overview see it and as a rename sets it.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace tessal {

enum class FieldKind : std::int32_t {
  Invalid = 0,
  Text = 1,
  Integer = 2,
  Real = 3,
  Boolean = 4,
  Expression = 5
};

struct ElementField {
  FieldKind kind = FieldKind::Invalid;
  std::string name;  ///< the field's label, such as "Symbol"
  std::string text;  ///< value of the kinds Text and Expression
  std::int32_t intValue = 0;
  double realValue = 0.0;
  bool boolValue = false;
  bool flags[2] = {true, true};
  std::vector<std::string> choiceTexts;  ///< the allowed texts of a field that has choices
  std::vector<std::vector<ElementField>>
      choiceFields;  ///< for each allowed text, the fields that depend on it
};

/// The value as text; "invalid" for a field without a kind.
std::string FieldText(const ElementField& field);

/// The first field of that name, or none.
const ElementField* FindField(const std::vector<ElementField>& fields, std::string_view name);

}  // namespace tessal
