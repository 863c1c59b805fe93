// The quantities that the simulation engine supplies by itself, and that a template's constants and forcings
// can represent.
#pragma once

#include <cstdint>
#include <span>
#include <string_view>
#include <vector>

namespace tessal {

struct CatalogueBuiltin {
  std::string_view name;
  std::int32_t id = 0;
  std::int32_t kind = 0;       ///< 1 a constant, 2 a forcing
  std::int32_t layer = 0;      ///< row of the layer texts
  std::int32_t variation = 0;  ///< 1 none, 2 horizontal, 3 horizontal and vertical
  std::int32_t unitType = 0;
  std::string_view unit;
  double defaultValue = 0.0;
  double minimum = 0.0;  ///< limits of 1e+08 and 1e+10 mean that there is no real limit
  double maximum = 0.0;
};

/// 0 with the record filled, or 0x80040306.
std::uint32_t GetBuiltinById(std::int32_t id, CatalogueBuiltin& record);

/// All rows, in the order of their ids.
const std::vector<CatalogueBuiltin>& Builtins();

/// The ids of the constants and of the forcings, in the order of their names.
const std::vector<std::int32_t>& ConstantBuiltinIds();
const std::vector<std::int32_t>& ForcingBuiltinIds();

bool IsDeprecatedBuiltin(std::int32_t id);

/// The scopes that layers are counted by.
std::span<const std::string_view> LayerTexts();

/// The scope and the spatial variation that an element takes from a row, as files spell them.
std::string_view LayerText(std::int32_t layer);
std::string_view VariationText(std::int32_t variation);

}  // namespace tessal
