// The functions that expressions may call: names, arguments and, for a host of the expression layer, what
// computes them. The same for every element.
#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "expr/numeric/evaluator.h"

namespace tessal {

/// The answer of a look-up that finds no row.
inline constexpr std::uint32_t kCatalogueNotFound = 0x80040306U;

/// What is special about a function.
struct FunctionTraits {
  bool takesAngle = false;      ///< its first argument is an angle
  bool givesAngle = false;      ///< its value is an angle
  bool swapsArguments = false;  ///< a host gives its two arguments in the other order
  bool drawsRandomNumbers = false;
  bool needsEngine = false;  ///< its value or effect is the simulation engine's
  bool keepsState = false;   ///< it reads or writes what another call left
  bool isDeprecated = false;
};

struct CatalogueFunction {
  std::string name;  ///< in upper case
  std::int32_t id = 0;
  /// 1 plain mathematics, 3 calendar of a time, 4 to 7 one each, 2 all others.
  std::int32_t functionClass = 0;
  std::int32_t argumentCount = 0;
  std::string internalName;       ///< in the catalogue as set up, the name again
  Evaluator evaluator = nullptr;  ///< none when the simulation engine alone computes it
  FunctionTraits traits;
};

struct CatalogueArgument {
  std::int32_t functionId;
  std::int32_t position;  ///< from 1
  std::string_view name;  ///< as messages show it
};

struct CatalogueGroup {
  std::string_view name;
  std::int32_t id;
};

/// Counts one more user; the first one sets the catalogues up and reads the option file of the current
/// folder.
void InitCatalogues();
/// Counts one user fewer; after the last one the state that belongs to the catalogues is released.
void ReleaseCatalogues();

/// The rows in table order.
const std::vector<CatalogueFunction>& Functions();
const std::vector<CatalogueArgument>& Arguments();
const std::array<CatalogueGroup, 2>& Groups();

/// The row of a name in any case; none when there is none.
const CatalogueFunction* FindFunction(std::string_view name);

/// The same with outputs, which stay untouched when nothing is found. 1 or 0.
int FindFunctionUpper(std::string_view name, std::string& internalName, std::int32_t& argumentCount,
                      std::int32_t& functionClass, std::int32_t& id);

/// 0, or `kCatalogueNotFound`.
std::uint32_t GetFunctionById(std::int32_t id, CatalogueFunction& record);
/// The name of an argument, its position from 1: 0, or `kCatalogueNotFound`.
std::uint32_t GetArgumentName(std::int32_t functionId, std::int32_t position, std::string& name);
/// The id of a name that is in upper case already; -1 for none.
std::int32_t FunctionIdByName(std::string_view upperName);
/// Whether a name is a function's. Turns the ASCII letters of the given text into capitals.
bool IsFunctionName(std::string& name);

/// The argument names joined by commas, as messages show them.
std::string JoinedArguments(const CatalogueFunction& function);

}  // namespace tessal
