// The check of units: the unit of every expression is inferred from the units that elements declare, and
// compared where the language or the template asks for one.
#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "analysis/analysis_finding.h"
#include "platform/uid.h"

namespace tessal {

class CEL_Element;
class TemplateCore;

/// What the names of substances in units mean: "mmol N/m3".
enum class Substances : std::uint8_t {
  Ignored,    ///< the same as "mmol/m3"
  Dimensions  ///< each substance is a dimension of its own
};

/// Units that clash, and where.
struct UnitFinding {
  AnalysisFinding finding;
  std::string expression;  ///< the smallest part that clashes
  std::string left;        ///< the units of the two sides, as people write them
  std::string right;
};

/// An element whose unit text can not be read; its unit counts as unknown.
struct UnknownUnit {
  Uid uid = Uid::None;
  std::string symbol;
  std::string unit;
};

struct UnitReport {
  std::vector<UnitFinding> findings;  ///< in the order of the template
  std::vector<UnknownUnit> unknown;
};

UnitReport CheckUnits(const TemplateCore& core, Substances substances);

/// How the unit texts of a template were read, each text once, in the order of first use.
struct UnitReading {
  std::string text;
  std::string read;  ///< in base units, in the spelling of UDUNITS; empty when it was not read
  std::string substance;
  std::size_t uses;
};
std::vector<UnitReading> ListUnits(const TemplateCore& core);

/// The unit of an element's expression as people write it; none where it is unknown or there is no
/// expression. For a state variable, that of its equation.
std::optional<std::string> InferredUnit(const TemplateCore& core, const CEL_Element& element);

}  // namespace tessal
