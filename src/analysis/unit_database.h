// The units that UDUNITS knows, each word read by the library and taken apart into base units. The database
// is read when the first word is looked up: it takes about ten milliseconds, and most commands need none.
#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "analysis/unit_value.h"

namespace tessal {

/// Why the database can not be read; empty when it can. Without it no unit is known.
const std::string& UnitDatabaseFailure();

/// What UDUNITS reads in a text of ASCII characters, "mmol" or "1000 tonne"; none for a text that is no unit,
/// or one whose numbers do not simply scale, as those of logarithms and dates. The zero of a temperature
/// scale does not count: degC is a kelvin. Raises `std::bad_alloc` when the library had no memory.
std::optional<Unit> UnitInDatabase(std::string_view text);

}  // namespace tessal
