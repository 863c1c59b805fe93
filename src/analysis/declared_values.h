// What elements of any family declare: a unit, and a value with its range. For analyses, which treat the
// families alike.
#pragma once

#include <optional>
#include <string_view>

namespace tessal {

class CEL_Element;

/// The text of an element's unit; none for a family without units.
std::optional<std::string_view> DeclaredUnit(const CEL_Element& element);

struct DeclaredValue {
  double value;
  double minimum;
  double maximum;
};

/// The default value of a state variable or an input, of the template or of a particle class; none for
/// others.
std::optional<DeclaredValue> DeclaredValueOf(const CEL_Element& element);

}  // namespace tessal
