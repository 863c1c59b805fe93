// Numbers in key-file text, the same whatever the locale. What does not fit reads as the nearest limit.
#pragma once

#include <cstdint>
#include <string_view>

namespace tessal {

/// The 32-bit integer of a text of an optional sign and digits.
std::int32_t KvfInteger(std::string_view text);

/// The real of a text of an optional sign, digits, and optionally a point, digits and an exponent.
double KvfReal(std::string_view text);

// Whether such a text fits its type, and so reads as what it says.
bool KvfIntegerFits(std::string_view text);
bool KvfRealFits(std::string_view text);

}  // namespace tessal
