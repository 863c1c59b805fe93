// What the built-in quantities are, in words. Names, kinds, units, defaults and limits are the catalogue's.
#pragma once

#include <span>
#include <string_view>

namespace tessal {

struct BuiltinReference {
  std::string_view name;     ///< the catalogue's
  std::string_view purpose;  ///< what the engine supplies, in a sentence or two
  std::string_view use;      ///< what a template takes it for
  std::string_view
      unit;  ///< as the units of the function reference; "unknown" where the text of the row is none
};

/// All rows, in the order of the catalogue.
std::span<const BuiltinReference> BuiltinReferences();

/// The reference of a name in any case, or none.
const BuiltinReference* ReferenceOfBuiltin(std::string_view name);

}  // namespace tessal
