#include "keyfile/water_body.h"

#include <algorithm>
#include <array>

namespace tessal {

namespace {

struct ScopeRow {
  std::string_view text;
  Scope code;
  SpatialVariation varies;
  std::string_view brings;  ///< the variation that the choice of the scope sets
};

constexpr std::array<ScopeRow, 5> kScopes = {{
    {"Global", Scope::Global, SpatialVariation::None, {}},
    {scope::kWaterSurface, Scope::WaterSurface, SpatialVariation::Horizontal, variation::kHorizontal},
    {scope::kWaterBottom, Scope::WaterBottom, SpatialVariation::Horizontal, variation::kHorizontal},
    {scope::kSediment, Scope::Sediment, SpatialVariation::Horizontal, variation::kHorizontal},
    {scope::kWaterColumn, Scope::WaterColumn, SpatialVariation::HorizontalAndVertical,
     variation::kHorizontalAndVertical},
}};

struct VariationRow {
  std::string_view text;
  SpatialVariation code;
};

constexpr std::array<VariationRow, 3> kVariations = {{
    {variation::kNone, SpatialVariation::None},
    {variation::kHorizontal, SpatialVariation::Horizontal},
    {variation::kHorizontalAndVertical, SpatialVariation::HorizontalAndVertical},
}};

const ScopeRow* FindScope(std::string_view text) {
  const auto hit =
      std::find_if(kScopes.begin(), kScopes.end(), [text](const ScopeRow& row) { return row.text == text; });
  return hit == kScopes.end() ? nullptr : &*hit;
}

}  // namespace

Scope ScopeFromText(std::string_view text) {
  const ScopeRow* row = FindScope(text);
  return row == nullptr ? Scope::None : row->code;
}

SpatialVariation SpatialFromText(std::string_view text) {
  const auto hit = std::find_if(kVariations.begin(), kVariations.end(),
                                [text](const VariationRow& row) { return row.text == text; });
  return hit == kVariations.end() ? SpatialVariation::Unknown : hit->code;
}

SpatialVariation SpatialFromScope(Scope scope) {
  const auto hit = std::find_if(kScopes.begin(), kScopes.end(),
                                [scope](const ScopeRow& row) { return row.code == scope; });
  return hit == kScopes.end() ? SpatialVariation::Unknown : hit->varies;
}

std::string_view VariationOfScope(std::string_view scopeText) {
  const ScopeRow* row = FindScope(scopeText);
  return row == nullptr ? std::string_view() : row->brings;
}

}  // namespace tessal
