#include "elements/element_field.h"

#include <algorithm>

#include "elements/property.h"
#include "platform/number_text.h"

namespace tessal {

std::string FieldText(const ElementField& field) {
  switch (field.kind) {
    case FieldKind::Text:
    case FieldKind::Expression:
      return field.text;
    case FieldKind::Integer:
      return std::to_string(field.intValue);
    case FieldKind::Real:
      return PlainNumberText(field.realValue);
    case FieldKind::Boolean:
      return field.boolValue ? "True/Yes" : "False/No";
    case FieldKind::Invalid:
      break;
  }
  return "invalid";
}

const ElementField* FindField(const std::vector<ElementField>& fields, std::string_view name) {
  const auto hit = std::find_if(fields.begin(), fields.end(),
                                [name](const ElementField& field) { return field.name == name; });
  return hit == fields.end() ? nullptr : &*hit;
}

}  // namespace tessal
