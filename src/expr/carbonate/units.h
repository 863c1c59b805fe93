// Concentrations are in micromoles per kilogram outside the carbonate system and in moles inside it.
#pragma once

namespace tessal {

constexpr double MolesFromMicromoles(double micromoles) {
  return micromoles * 1e-6;
}

constexpr double MicromolesFromMoles(double moles) {
  return moles * 1e6;
}

}  // namespace tessal
