// Where an element lives in the water body, and whether it varies in space: the codes by which the symbol
// table compares elements with the symbols that they use.
#pragma once

#include <cstdint>
#include <string_view>

namespace tessal {

namespace scope_code {
inline constexpr std::int32_t kGlobal = 0;
inline constexpr std::int32_t kWaterSurface = 1;
inline constexpr std::int32_t kWaterBottom = 2;
inline constexpr std::int32_t kSediment = 3;
inline constexpr std::int32_t kWaterColumn = 4;
inline constexpr std::int32_t kNone = 5;
}  // namespace scope_code

namespace spatial_code {
inline constexpr std::int32_t kNone = 0;
inline constexpr std::int32_t kHorizontal = 1;
inline constexpr std::int32_t kHorizontalAndVertical = 2;
inline constexpr std::int32_t kUnknown = 3;
}  // namespace spatial_code

/// The code of a scope as it stands in the file, exactly; 5 for any other text.
std::int32_t ScopeFromText(std::string_view text);

/// The code of a spatial variation as it stands in the file, exactly; 3 for any other text.
std::int32_t SpatialFromText(std::string_view text);

/// A state variable varies in space as its scope does.
std::int32_t SpatialFromScope(std::int32_t scope);

}  // namespace tessal
