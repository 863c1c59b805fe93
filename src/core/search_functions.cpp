// The choices that area searches offer come from the template around them: its classes and its values.
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

void TemplateCore::RefreshSearchFunctionChoices() {
  if (species.empty()) return;
  const std::vector<NamedNumber> names = SpecieNames();
  std::vector<CEL_Choice> grid = NoVariable();
  Offer(grid, stateVariables);
  Offer(grid, constants);
  Offer(grid, forcings);
  const ChoiceList gridValues = ShareChoices(std::move(grid));
  const ChoiceList noValues = ShareChoices(NoVariable());
  std::vector<ChoiceList> particleValues;  // of each class
  for (const auto& specie : species) {
    std::vector<CEL_Choice> values = NoVariable();
    Offer(values, specie->stateVariables);
    particleValues.push_back(ShareChoices(std::move(values)));
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
        const auto place = static_cast<std::size_t>((sought == -1 ? specie->Index() : sought) - 1);
        if (place < particleValues.size()) function->variableId.SetChoices(particleValues[place]);
      }
      function->SelectPresentValues();
    }
  }
  misc.buildSpatialTree.SetBool(needTree);
}

}  // namespace tessal
