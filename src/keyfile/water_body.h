// Where an element lives in the water body and how it varies in space: the words of the format, and the codes
// by which the symbol table compares elements with the symbols that they use.
#pragma once

#include <cstdint>
#include <string_view>

namespace tessal {

enum class Scope : std::uint8_t {
  Global = 0,
  WaterSurface = 1,
  WaterBottom = 2,
  Sediment = 3,
  WaterColumn = 4,
  None = 5  ///< any other text
};

enum class SpatialVariation : std::uint8_t {
  None = 0,
  Horizontal = 1,
  HorizontalAndVertical = 2,
  Unknown = 3  ///< any other text
};

namespace scope {
inline constexpr std::string_view kWaterSurface = "WS";
inline constexpr std::string_view kWaterColumn = "WC";
inline constexpr std::string_view kWaterBottom = "WB";
inline constexpr std::string_view kSediment = "SED";
inline constexpr std::string_view kNotSpecified = "NOT_SPECIFIED";
}  // namespace scope

// Files and rules go by the misspelt forms: "HORIZONTAL" is no known value.
namespace variation {
inline constexpr std::string_view kNone = "NONE";
inline constexpr std::string_view kHorizontal = "HORISONTAL";
inline constexpr std::string_view kHorizontalAndVertical = "HORISONTAL_AND_VERTICAL";
}  // namespace variation

/// The code of a scope as it is in the file, exactly.
Scope ScopeFromText(std::string_view text);
SpatialVariation SpatialFromText(std::string_view text);

/// A state variable varies in space as its scope does.
SpatialVariation SpatialFromScope(Scope scope);

/// The word of the variation that a newly chosen scope brings with it; empty for a scope that brings none.
std::string_view VariationOfScope(std::string_view scopeText);

}  // namespace tessal
