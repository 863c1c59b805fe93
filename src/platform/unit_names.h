// The host suite's names of unit types.
#pragma once

#include <cstdint>
#include <string>

namespace tessal {

/// The name of a unit type number. Not 0 when there is one; else 0, with the text untouched.
int unqGetItemTypeKey(std::int32_t unitType, std::string& text);

}  // namespace tessal
