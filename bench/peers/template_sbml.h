// A template as SBML, Level 3 Version 1 Core, with its units, so that libSBML can check them: elements are
// parameters, expressions assignment rules, and equations rate rules over days. Particle classes are left
// out, and so is an expression with anything that SBML has no word for.
#pragma once

#include <cstdint>
#include <map>
#include <string>
#include <vector>

namespace tessal {

class TemplateCore;

namespace bench {

struct TemplateSbml {
  std::string text;
  /// The elements whose expressions the text holds, by the ids of their rules.
  std::map<std::string, std::uint32_t> sequences;
  std::vector<std::string> leftOut;  ///< the symbols of elements whose expressions it does not hold
};

/// Numbers in expressions have no unit. Michaelis-Menten terms and the mean light of a layer are function
/// definitions; a call of another function of the catalogue is a parameter with the unit of its result.
TemplateSbml ToSbml(const TemplateCore& core);

}  // namespace bench

}  // namespace tessal
