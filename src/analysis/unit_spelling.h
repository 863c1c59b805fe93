// Units as text: for a reader, in base units and in what modellers use.
#pragma once

#include <string>

#include "analysis/unit_value.h"

namespace tessal {

/// In base units, so that UDUNITS reads the same from it: "0.001 m-3 kg", "1".
std::string InBaseUnits(const Unit& unit);

/// The substances with their powers, "N", "N/C"; empty without any.
std::string SubstanceText(const Unit& unit);

/// In the units of water quality, "g/m3/d", "m/s": those whose product is the unit, or with a factor where
/// there are none. With substances "mmol N/m3".
std::string AsModellersWrite(const Unit& unit);

}  // namespace tessal
