// Slips in the units of a template: the mutants that checks of units are to find.
#pragma once

#include <string>
#include <vector>

namespace tessal::bench {

/// A template with one slip.
struct UnitSlip {
  std::string what;  ///< "mg/l -> m", "gro1 without AC1"
  std::string text;
};

/// Each declared unit of the template's own elements, replaced by one of another dimension.
std::vector<UnitSlip> UnitsOfOtherDimensions(const std::string& text);
/// Each that has a word in a small table, replaced by one of the same dimension: a rate a second for a rate
/// a day.
std::vector<UnitSlip> UnitsOfOtherSizes(const std::string& text);
/// Each factor or divisor that is a name with a unit, left out with the sign that joins it, in expressions
/// that have a keyword of their own. The text is that of the file.
std::vector<UnitSlip> FactorsLeftOut(const std::string& path, const std::string& text);

}  // namespace tessal::bench
