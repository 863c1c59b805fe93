#include "core/creation.h"

#include <array>

#include "core/template_core.h"

namespace tessal {

namespace {

constexpr std::uint32_t kPlainKindsMask = 31;

/// What a name may become, by the kind of its last user that has a row here. The masks carry the rules of
/// scope and order into the offer.
struct OfferRow {
  ElementKind userKind;
  std::uint32_t mask;
};

constexpr std::array<OfferRow, 8> kOffers = {{
    {ElementKind::StateVariable, 16},
    {ElementKind::Auxiliary, 15},
    {ElementKind::SpecieStateVariable, 256},
    {ElementKind::SpecieConstant, 486},
    {ElementKind::SpatialFunction, 486},
    {ElementKind::HorizontalVector, 486},
    {ElementKind::VerticalEquation, 486},
    {ElementKind::ArithmeticExpression, 487},
}};

/// The kind, and for a member of a particle class the list, that each index of the choice stands for.
struct ChoiceRow {
  ElementKind kind;
  ElementKind listKind;
};

constexpr std::array<ChoiceRow, 9> kChoices = {{
    {ElementKind::StateVariable, ElementKind::None},
    {ElementKind::Constant, ElementKind::None},
    {ElementKind::Forcing, ElementKind::None},
    {ElementKind::Auxiliary, ElementKind::None},
    {ElementKind::Process, ElementKind::None},
    {ElementKind::SpecieStateVariable, ElementKind::SpecieStateVariableList},
    {ElementKind::SpecieConstant, ElementKind::SpecieConstantList},
    {ElementKind::SpatialFunction, ElementKind::SpatialFunctionList},
    {ElementKind::ArithmeticExpression, ElementKind::ArithmeticExpressionList},
}};

void GiveDefaultTexts(CEL_Element& element, const std::string& symbol, const std::string& documentation) {
  element.symbol.SetText(symbol);
  element.description.SetText(symbol + " Description");
  element.onlineHelp.SetText(symbol + " Online help");
  element.documentation.SetText(documentation.empty() ? symbol + " Documentation" : documentation);
}

}  // namespace

CEL_Element* TemplateCore::AddByRequest(const CreateRequest& request) {
  CEL_Lagrange_Specie* specie = GetParentSpecie(request.ownerId);
  switch (request.kind) {
    case ElementKind::StateVariable:
      return &AddStateVariable();
    case ElementKind::Constant:
      return &AddConstant();
    case ElementKind::Forcing:
      return &AddForcing();
    case ElementKind::Auxiliary:
      return &AddAuxiliary();
    case ElementKind::Process:
      return &AddProcess();
    case ElementKind::DerivedOutput:
      return &AddDerivedOutput();
    case ElementKind::Specie:
      return &AddSpecie();
    case ElementKind::SpecieStateVariable:
      return specie == nullptr ? nullptr : &specie->AddStateVariable();
    case ElementKind::SpecieConstant:
      return specie == nullptr ? nullptr : &specie->AddConstant();
    case ElementKind::SpecieForcing:
      return specie == nullptr ? nullptr : &specie->AddForcing();
    case ElementKind::SpatialFunction:
      return specie == nullptr ? nullptr : &specie->AddSpatialFunction();
    case ElementKind::ArithmeticExpression:
      return specie == nullptr ? nullptr : &specie->AddArithmeticExpression();
    case ElementKind::HorizontalVector:
      return specie == nullptr ? nullptr : &specie->AddHorizontalVector();
    default:
      return nullptr;
  }
}

CreatedElement TemplateCore::CreateElement(const CreateRequest& request) {
  // Off through the defaults below, and on behind them, whatever it was before.
  SetNotifyChanges(false);
  CreatedElement created;
  if (CEL_Element* element = AddByRequest(request)) {
    if (!request.symbol.empty() && element->Kind() != ElementKind::HorizontalVector) {
      GiveDefaultTexts(*element, request.symbol, root.documentation.Text());
    }
    flags.modified = true;
    RebuildSymbolTable();
    created.uid = element->GetUid();
    created.placed = MoveBeforeFirstUser(created.uid, created.predecessor);
  }
  SetNotifyChanges(true);
  return created;
}

CreateRequest TemplateCore::RequestFor(const UndefinedSymbol& undefined, int choice) const {
  CreateRequest request;
  const ChoiceRow& row = kChoices.at(static_cast<std::size_t>(choice));
  request.symbol = undefined.symbol;
  request.kind = row.kind;
  if (row.listKind == ElementKind::None) return request;
  for (const Uid user : undefined.usedBy) {
    const SymbolRecord* record = FindRecordByUid(user);
    if (record == nullptr || record->specieIndex < 0) continue;
    const auto& specie = At(species, static_cast<std::size_t>(record->specieIndex));
    request.ownerId = specie.Head(row.listKind).GetUid();
  }
  return request;
}

std::uint32_t TemplateCore::OfferMask(const UndefinedSymbol& undefined) const {
  std::uint32_t mask = kPlainKindsMask;
  for (const Uid user : undefined.usedBy) {
    const SymbolRecord* record = FindRecordByUid(user);
    if (record == nullptr) continue;
    for (const OfferRow& row : kOffers) {
      // The last user decides; masks are not combined.
      if (row.userKind == record->element->Kind()) mask = row.mask;
    }
  }
  return mask;
}

bool TemplateCore::OfferUndefinedSymbols(CreationQuestions& questions) {
  bool created = false;
  std::size_t position = 0;
  while (position < undefinedSymbols.size()) {
    // Each creation rebuilds the list, so the position moves only over entries that are marked already.
    UndefinedSymbol& undefined = *undefinedSymbols[position];
    if (undefined.asked) {
      ++position;
    } else {
      undefined.asked = true;
      created = OfferSymbol(undefined, questions) || created;
    }
    if (created) RebuildSymbolTable();
  }
  return created;
}

bool TemplateCore::OfferSymbol(const UndefinedSymbol& undefined, CreationQuestions& questions) const {
  if (!questions.AskYesNo("There are undefined symbols!\n\nDo you want to create symbol '" +
                          undefined.symbol + "' ?")) {
    return false;
  }
  const int choice = questions.ChooseKind(undefined.symbol, OfferMask(undefined));
  if (choice < 0 || static_cast<std::size_t>(choice) >= kChoices.size()) return false;
  questions.Create(RequestFor(undefined, choice));
  return true;
}

}  // namespace tessal
