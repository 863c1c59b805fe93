#include "expr/function_catalogue.h"

#include <algorithm>
#include <unordered_map>

#include "expr/carbonate/options.h"
#include "expr/function_rows.h"
#include "expr/numeric/data_slots.h"
#include "platform/ascii.h"

namespace tessal {

namespace {

constexpr std::array<CatalogueGroup, 2> kGroups = {{{"Mathematica", 1}, {"Some other group", 2}}};

constexpr std::string_view kOptionFile = "TESSALpH.set";

CatalogueFunction MakeFunction(const FunctionRow& row) {
  CatalogueFunction function;
  function.name = UpperCase(row.name);
  function.id = row.id;
  function.functionClass = row.functionClass;
  function.argumentCount = static_cast<std::int32_t>(std::count_if(
      row.arguments.begin(), row.arguments.end(), [](std::string_view name) { return !name.empty(); }));
  // Set-up overwrites the engine's name with the catalogue's own.
  function.internalName = function.name;
  function.evaluator = row.evaluator;
  function.traits = row.traits;
  return function;
}

/// Names in any case: those that differ in it alone are the same.
struct HashOfName {
  std::size_t operator()(std::string_view name) const {
    std::size_t hash = 0;
    for (const char character : name) hash = hash * 31 + static_cast<unsigned char>(UpperCase(character));
    return hash;
  }
};

struct IsSameName {
  bool operator()(std::string_view left, std::string_view right) const {
    return EqualIgnoringCase(left, right);
  }
};

/// The catalogue of the process, and how many templates use it.
struct Catalogue {
  Catalogue() {
    for (const FunctionRow& row : FunctionRows()) {
      functions.push_back(MakeFunction(row));
      for (std::int32_t position = 1; position <= functions.back().argumentCount; ++position) {
        arguments.push_back({row.id, position, row.arguments[static_cast<std::size_t>(position - 1)]});
      }
    }
    // After the last insertion, so that the keys stay where they are.
    for (std::size_t place = 0; place < functions.size(); ++place)
      byName.emplace(functions[place].name, place);
  }

  std::vector<CatalogueFunction> functions;
  std::vector<CatalogueArgument> arguments;
  std::unordered_map<std::string_view, std::size_t, HashOfName, IsSameName>
      byName;  ///< the first row of each name
  int users = 0;
};

Catalogue& TheCatalogue() {
  static Catalogue catalogue;
  return catalogue;
}

const CatalogueFunction* FindExact(std::string_view upperName) {
  const CatalogueFunction* function = FindFunction(upperName);
  return function != nullptr && function->name == upperName ? function : nullptr;
}

}  // namespace

void InitCatalogues() {
  Catalogue& catalogue = TheCatalogue();
  if (catalogue.users++ > 0) return;
  ClearDataSlots();
  SetCarbonateDefaults();
  ReadOptionFile(std::string(kOptionFile));
}

void ReleaseCatalogues() {
  Catalogue& catalogue = TheCatalogue();
  if (catalogue.users > 0 && --catalogue.users == 0) ReleaseCarbonate();
}

const std::vector<CatalogueFunction>& Functions() {
  return TheCatalogue().functions;
}

const std::vector<CatalogueArgument>& Arguments() {
  return TheCatalogue().arguments;
}

const std::array<CatalogueGroup, 2>& Groups() {
  return kGroups;
}

const CatalogueFunction* FindFunction(std::string_view name) {
  const Catalogue& catalogue = TheCatalogue();
  const auto hit = catalogue.byName.find(name);
  return hit == catalogue.byName.end() ? nullptr : &catalogue.functions[hit->second];
}

int FindFunctionUpper(std::string_view name, std::string& internalName, std::int32_t& argumentCount,
                      std::int32_t& functionClass, std::int32_t& id) {
  const CatalogueFunction* function = FindFunction(name);
  if (function == nullptr) return 0;
  internalName = function->internalName;
  argumentCount = function->argumentCount;
  functionClass = function->functionClass;
  id = function->id;
  return 1;
}

std::uint32_t GetFunctionById(std::int32_t id, CatalogueFunction& record) {
  const auto& functions = Functions();
  const auto hit = std::find_if(functions.begin(), functions.end(),
                                [id](const CatalogueFunction& function) { return function.id == id; });
  if (hit == functions.end()) return kCatalogueNotFound;
  record = *hit;
  return 0;
}

std::uint32_t GetArgumentName(std::int32_t functionId, std::int32_t position, std::string& name) {
  const auto& arguments = Arguments();
  const auto hit = std::find_if(arguments.begin(), arguments.end(),
                                [functionId, position](const CatalogueArgument& argument) {
                                  return argument.functionId == functionId && argument.position == position;
                                });
  if (hit == arguments.end()) return kCatalogueNotFound;
  name = hit->name;
  return 0;
}

std::int32_t FunctionIdByName(std::string_view upperName) {
  const CatalogueFunction* function = FindExact(upperName);
  return function == nullptr ? -1 : function->id;
}

bool IsFunctionName(std::string& name) {
  name = UpperCase(name);
  return FindExact(name) != nullptr;
}

std::string JoinedArguments(const CatalogueFunction& function) {
  std::string joined;
  std::string name;
  for (std::int32_t position = 1; position <= function.argumentCount; ++position) {
    if (position > 1) joined += ',';
    if (GetArgumentName(function.id, position, name) == 0) joined += name;
  }
  return joined;
}

}  // namespace tessal
