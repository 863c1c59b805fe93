// The choices that area searches offer come from the template around them: its classes and its values.
#include <map>

#include "core/template_core.h"

namespace tessal {

namespace {

ChoiceList ShareChoices(std::vector<CEL_Choice> choices) {
  return std::make_shared<const std::vector<CEL_Choice>>(std::move(choices));
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

void TemplateCore::NumberSpecies() {
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
  ForEachSearchFunction([&numbers](CEL_Lagrange_Spatial_Function& function) {
    const auto sought = numbers.find(function.lookFor.IntValue());
    if (sought != numbers.end()) function.lookFor.SetInt(sought->second);
  });
}

void TemplateCore::ForgetSpecie(std::int32_t number) {
  constexpr std::int32_t kNoSpecie = 0;
  const NotificationsOff silent;
  ForEachSearchFunction([number](CEL_Lagrange_Spatial_Function& function) {
    if (function.lookFor.IntValue() == number) function.lookFor.SetInt(kNoSpecie);
  });
}

void TemplateCore::RefreshSearchFunctionChoices() {
  if (species.empty()) return;
  const std::vector<NamedNumber> names = SpecieNames();
  std::vector<CEL_Choice> grid = NoVariable();
  Offer(grid, stateVariables);
  Offer(grid, constants);
  Offer(grid, forcings);
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
  misc.buildSpatialTree.SetBool(needTree);
}

}  // namespace tessal
