#include "core/creation.h"

#include <array>

#include "core/template_core.h"

namespace tessal {

namespace {

constexpr std::uint32_t kPlainKindsMask = 31;

/// What a name may become, by the kind of its last user that has a row here. The masks carry the rules of
/// scope and order into the offer.
struct OfferRow {
  std::int32_t userKind;
  std::uint32_t mask;
};

constexpr std::array<OfferRow, 8> kOffers = {{
    {kind::kStateVariable, 16},
    {kind::kAuxiliary, 15},
    {kind::kSpecieStateVariable, 256},
    {kind::kSpecieConstant, 486},
    {kind::kSpatialFunction, 486},
    {kind::kHorizontalVector, 486},
    {kind::kVerticalEquation, 486},
    {kind::kArithmeticExpression, 487},
}};

/// The kind, and for a member of a particle class the list, that each index of the choice stands for.
struct ChoiceRow {
  std::int32_t kind;
  std::int32_t listKind;
};

constexpr std::array<ChoiceRow, 9> kChoices = {{
    {kind::kStateVariable, 0},
    {kind::kConstant, 0},
    {kind::kForcing, 0},
    {kind::kAuxiliary, 0},
    {kind::kProcess, 0},
    {kind::kSpecieStateVariable, kind::kSpecieStateVariableList},
    {kind::kSpecieConstant, kind::kSpecieConstantList},
    {kind::kSpatialFunction, kind::kSpatialFunctionList},
    {kind::kArithmeticExpression, kind::kArithmeticExpressionList},
}};

void GiveDefaultTexts(CEL_Element& element, const std::string& symbol, const std::string& documentation) {
  element.symbol.SetText(symbol);
  element.description.SetText(symbol + " Description");
  element.onlineHelp.SetText(symbol + " Online help");
  element.documentation.SetText(documentation.empty() ? symbol + " Documentation" : documentation);
}

}  // namespace

CEL_Element* TemplateCore::AddByRequest(const CreateRequest& request) {
  CEL_Lagrange_Specie* specie = GetParentSpecie(static_cast<std::uint32_t>(request.ownerId));
  switch (static_cast<std::int32_t>(request.kind)) {
    case kind::kStateVariable:
      return &AddStateVariable();
    case kind::kConstant:
      return &AddConstant();
    case kind::kForcing:
      return &AddForcing();
    case kind::kAuxiliary:
      return &AddAuxiliary();
    case kind::kProcess:
      return &AddProcess();
    case kind::kDerivedOutput:
      return &AddDerivedOutput();
    case kind::kSpecie:
      return &AddSpecie();
    case kind::kSpecieStateVariable:
      return specie == nullptr ? nullptr : &specie->AddStateVariable();
    case kind::kSpecieConstant:
      return specie == nullptr ? nullptr : &specie->AddConstant();
    case kind::kSpecieForcing:
      return specie == nullptr ? nullptr : &specie->AddForcing();
    case kind::kSpatialFunction:
      return specie == nullptr ? nullptr : &specie->AddSpatialFunction();
    case kind::kArithmeticExpression:
      return specie == nullptr ? nullptr : &specie->AddArithmeticExpression();
    case kind::kHorizontalVector:
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
    if (!request.symbol.empty() && element->Kind() != kind::kHorizontalVector) {
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
  request.kind = static_cast<std::uint32_t>(row.kind);
  if (row.listKind == 0) return request;
  for (const std::uint32_t user : undefined.usedBy) {
    const SymbolRecord* record = FindRecordByUid(user);
    if (record == nullptr || record->specieIndex < 0) continue;
    const auto& specie = At(species, static_cast<std::size_t>(record->specieIndex));
    request.ownerId = specie.Head(row.listKind).MessageUid();
  }
  return request;
}

std::uint32_t TemplateCore::OfferMask(const UndefinedSymbol& undefined) const {
  std::uint32_t mask = kPlainKindsMask;
  for (const std::uint32_t user : undefined.usedBy) {
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
