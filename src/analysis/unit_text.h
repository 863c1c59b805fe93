// Reads the text of a unit as a modeller has written it: "mmol N/m3", "/d", "degrees C", "m^1/2 /s". The
// words are read by the tables of spellings and by UDUNITS, the arithmetic between them here.
#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>

#include "analysis/unit_value.h"

namespace tessal {

/// The unit of a text, with the substances of its amounts; none for a text that can not be read.
std::optional<Unit> ReadUnitText(std::string_view text);

/// Reads each text once: templates have few units and many elements. Texts must outlive the reader.
class UnitReader final {
 public:
  /// None for a text that can not be read; good as long as the reader.
  const Unit* Read(std::string_view text);

 private:
  std::unordered_map<std::string_view, std::optional<Unit>> units;
};

}  // namespace tessal
