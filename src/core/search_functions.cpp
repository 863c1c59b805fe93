#include "core/search_functions.h"

#include <algorithm>
#include <map>
#include <unordered_map>

#include "core/collections.h"

namespace tessal {

namespace {

/// The marker of a lost reference, as it has always been spelt.
constexpr std::string_view kLostName = "unkown";
constexpr std::string_view kUnresolvedName = "unknown";

/// Numbered choices that many properties share, and where the choice of a number is among them.
class NumberChoices final {
 public:
  explicit NumberChoices(std::vector<CEL_Choice> choices) : list(ShareChoices(std::move(choices))) {
    std::int32_t place = 0;
    // The first choice of a number is the one that counts.
    for (const CEL_Choice& choice : *list) places.emplace(choice.intValue, place++);
  }

  void OfferTo(CEL_Property& property) const {
    property.SetChoices(list);
    const auto place = places.find(property.IntValue());
    property.SelectIndex(place == places.end() ? -1 : place->second);
  }

 private:
  ChoiceList list;
  std::unordered_map<std::int32_t, std::int32_t> places;
};

template <class Elements>
void Append(std::vector<CEL_Choice>& choices, const Elements& elements) {
  for (const auto& element : elements) {
    choices.push_back(CEL_Choice::Number(element->symbol.Text(), element->id.IntValue()));
  }
}

/// Values that a search may look at, after the choice of none.
template <class... Lists>
NumberChoices ValueChoices(const Lists&... lists) {
  std::vector<CEL_Choice> choices = {CEL_Choice::Number("NONE", -1)};
  (Append(choices, lists), ...);
  return NumberChoices(std::move(choices));
}

/// The particle classes by their numbers, after the choices that are there already.
NumberChoices ClassChoices(const Collections& collections, std::vector<CEL_Choice> choices) {
  for (const auto& specie : collections.species) {
    choices.push_back(CEL_Choice::Number(specie->symbol.Text(), specie->Index()));
  }
  return NumberChoices(std::move(choices));
}

/// What the template offers to its searches. Each list is made once: their lengths and their number both grow
/// with the template.
class SearchChoices final {
 public:
  explicit SearchChoices(const Collections& collections)
      : owners(ClassChoices(collections, {})),
        lookedFor(ClassChoices(collections, FirstLookForChoices())),
        gridValues(ValueChoices(collections.stateVariables, collections.constants, collections.forcings)) {
    for (const auto& specie : collections.species) {
      particleValues.emplace(specie->Index(), ValueChoices(specie->stateVariables));
    }
  }

  /// Offers to a search of the class of that number.
  void OfferTo(CEL_Lagrange_Spatial_Function& function, std::int32_t specie) const {
    owners.OfferTo(function.specieId);
    lookedFor.OfferTo(function.lookFor);
    ValuesFor(function, specie).OfferTo(function.variableId);
  }

 private:
  const NumberChoices& ValuesFor(const CEL_Lagrange_Spatial_Function& function, std::int32_t specie) const {
    if (function.SearchesGrid()) return gridValues;
    if (!function.SearchesParticles()) return noValues;
    const std::int32_t sought = function.lookFor.IntValue();
    const auto values =
        particleValues.find(sought == CEL_Lagrange_Spatial_Function::kOwnSpecie ? specie : sought);
    return values == particleValues.end() ? noValues : values->second;
  }

  NumberChoices owners;
  NumberChoices lookedFor;
  NumberChoices gridValues;
  NumberChoices noValues = ValueChoices();
  std::unordered_map<std::int32_t, NumberChoices> particleValues;  ///< by the number of the class
};

}  // namespace

void NumberSpecies(const Collections& collections) {
  const auto& species = collections.species;
  const NotificationsOff silent;
  std::map<std::int32_t, std::int32_t> numbers;  // new by old
  for (std::size_t place = 0; place < species.size(); ++place) {
    const auto number = static_cast<std::int32_t>(place + 1);
    const std::int32_t former = species[place]->Index();
    numbers.emplace(former, number);
    for (const auto& function : species[place]->spatialFunctions) {
      if (function->specieId.IntValue() == former) function->specieId.SetInt(number);
    }
    species[place]->SetIndex(number);
    species[place]->StampMembers();
  }
  ForEachSearchFunction(collections, [&numbers](CEL_Lagrange_Spatial_Function& function) {
    const auto sought = numbers.find(function.lookFor.IntValue());
    if (sought != numbers.end()) function.lookFor.SetInt(sought->second);
  });
}

void ForgetSpecie(const Collections& collections, std::int32_t number) {
  constexpr std::int32_t kNoSpecie = 0;
  const NotificationsOff silent;
  ForEachSearchFunction(collections, [number](CEL_Lagrange_Spatial_Function& function) {
    if (function.lookFor.IntValue() == number) function.lookFor.SetInt(kNoSpecie);
  });
}

bool HasSearchFunction(const Collections& collections) {
  return std::any_of(collections.species.begin(), collections.species.end(),
                     [](const auto& specie) { return !specie->spatialFunctions.empty(); });
}

void ResolveReferencesToNames(const Collections& collections) {
  if (!HasSearchFunction(collections)) return;
  std::unordered_map<std::int32_t, const CEL_Element*> byId;
  ForEachNamedElement(collections,
                      [&byId](const CEL_Element& element) { byId.emplace(element.id.IntValue(), &element); });
  ForEachSearchFunction(collections, [&byId](CEL_Lagrange_Spatial_Function& function) {
    const std::int32_t number = function.variableId.IntValue();
    const auto hit = number > 0 ? byId.find(number) : byId.end();
    function.SetVariableName(hit == byId.end() ? kLostName : std::string_view(hit->second->symbol.Text()));
  });
}

void ResolveNamesToReferences(const Collections& collections) {
  if (!HasSearchFunction(collections)) return;
  std::unordered_map<std::string_view, const CEL_Element*> byName;
  ForEachNamedElement(collections, [&byName](const CEL_Element& element) {
    byName.emplace(element.symbol.Text(), &element);
  });
  ForEachSearchFunction(collections, [&byName](CEL_Lagrange_Spatial_Function& function) {
    if (function.VariableName() == kUnresolvedName) return;
    const auto hit = byName.find(function.VariableName());
    if (hit != byName.end()) function.variableId.SetInt(hit->second->id.IntValue());
  });
}

bool NeedSpatialTree(const Collections& collections) {
  bool needTree = false;
  ForEachSearchFunction(collections, [&needTree](const CEL_Lagrange_Spatial_Function& function) {
    needTree = needTree || function.SearchesParticles();
  });
  return needTree;
}

void OfferSearchChoices(const Collections& collections) {
  for (const auto& specie : collections.species) {
    for (const auto& function : specie->spatialFunctions) function->specieId.SetInt(specie->Index());
  }
  FillSearchChoices(collections);
}

void FillSearchChoices(const Collections& collections) {
  const SearchChoices choices(collections);
  for (const auto& specie : collections.species) {
    for (const auto& function : specie->spatialFunctions) choices.OfferTo(*function, specie->Index());
  }
}

}  // namespace tessal
