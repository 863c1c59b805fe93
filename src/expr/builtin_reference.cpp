#include "expr/builtin_reference.h"

#include <algorithm>

#include "platform/ascii.h"

namespace tessal {

namespace {

// clang-format off
constexpr BuiltinReference kRows[] = {
    {"DOMAIN_LATITUDE", "The latitude of the whole model area, one value for a run; north is positive.",
     "the length of the day and the height of the sun where the area is small; for one in each cell see "
     "LATITUDE", "degree"},
};
// clang-format on

}  // namespace

std::span<const BuiltinReference> BuiltinReferences() {
  return kRows;
}

const BuiltinReference* ReferenceOfBuiltin(std::string_view name) {
  const auto* hit = std::find_if(std::begin(kRows), std::end(kRows), [name](const BuiltinReference& row) {
    return EqualIgnoringCase(row.name, name);
  });
  return hit == std::end(kRows) ? nullptr : hit;
}

}  // namespace tessal
