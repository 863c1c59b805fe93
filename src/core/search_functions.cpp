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

bool HasSearchFunction(const Sequence<CEL_Lagrange_Specie>& species) {
  return std::any_of(species.begin(), species.end(),
                     [](const auto& specie) { return !specie->spatialFunctions.empty(); });
}

std::vector<CEL_Choice> NoVariable() {
  return {CEL_Choice::Number("NONE", -1)};
}

template <class Elements>
void Offer(std::vector<CEL_Choice>& choices, const Elements& elements) {
  for (const auto& element : elements) {
    choices.push_back(CEL_Choice::Number(element->symbol.Text(), element->id.IntValue()));
  }
}

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

void ResolveReferencesToNames(const Collections& collections) {
  if (!HasSearchFunction(collections.species)) return;
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
  if (!HasSearchFunction(collections.species)) return;
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

bool OfferSearchChoices(const Collections& collections) {
  const auto& species = collections.species;
  std::vector<NamedNumber> names;
  for (const auto& specie : species) names.push_back({specie->symbol.Text(), specie->Index()});
  std::vector<CEL_Choice> grid = NoVariable();
  Offer(grid, collections.stateVariables);
  Offer(grid, collections.constants);
  Offer(grid, collections.forcings);
  const ChoiceList gridValues = ShareChoices(std::move(grid));
  const ChoiceList noValues = ShareChoices(NoVariable());
  std::map<std::int32_t, ChoiceList> particleValues;  // by the number of the class
  for (const auto& specie : species) {
    std::vector<CEL_Choice> values = NoVariable();
    Offer(values, specie->stateVariables);
    particleValues.emplace(specie->Index(), ShareChoices(std::move(values)));
  }

  bool needTree = false;
  for (const auto& specie : species) {
    for (const auto& function : specie->spatialFunctions) {
      function->OfferSpecies(names);
      function->specieId.SetInt(specie->Index());
      function->variableId.SetChoices(noValues);
      if (function->SearchesGrid()) {
        function->variableId.SetChoices(gridValues);
      } else if (function->SearchesParticles()) {
        needTree = true;
        const std::int32_t sought = function->lookFor.IntValue();
        const auto values = particleValues.find(sought == -1 ? specie->Index() : sought);
        if (values != particleValues.end()) function->variableId.SetChoices(values->second);
      }
      function->SelectPresentValues();
    }
  }
  return needTree;
}

}  // namespace tessal
