#include "core/creation.h"

#include <algorithm>
#include <array>
#include <optional>

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

/// The kind, and for a member of a particle class the list, that each index of the choice means.
struct ChoiceRow {
  ElementKind kind;
  ElementKind listKind;
};

constexpr std::array<ChoiceRow, CreationOffer::kChoiceCount> kChoices = {{
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

/// The mask that a user of a kind brings; none for kinds that leave the offer as it is.
std::optional<std::uint32_t> MaskForUser(ElementKind userKind) {
  const auto row = std::find_if(kOffers.begin(), kOffers.end(),
                                [userKind](const OfferRow& entry) { return entry.userKind == userKind; });
  return row == kOffers.end() ? std::nullopt : std::optional(row->mask);
}

void GiveDefaultTexts(CEL_Element& element, const std::string& symbol, std::string_view documentation) {
  element.symbol.SetText(symbol);
  element.description.SetText(symbol + " Description");
  element.onlineHelp.SetText(symbol + " Online help");
  element.documentation.SetText(documentation.empty() ? symbol + " Documentation"
                                                      : std::string(documentation));
}

}  // namespace

CreatedElement TemplateCore::CreateElement(const CreateRequest& request) {
  const EditStep step(history);
  // Off through the defaults below, and on after them, whatever it was before.
  SetNotifyChanges(false);
  CreatedElement created;
  CEL_Element* element = AddElement(request.kind);
  CEL_Lagrange_Specie* specie = GetParentSpecie(request.ownerId);
  if (element == nullptr && specie != nullptr) element = specie->AddMember(request.kind);
  if (element != nullptr) {
    if (!request.symbol.empty() && element->Kind() != ElementKind::HorizontalVector) {
      GiveDefaultTexts(*element, request.symbol, state.root.documentation.Text());
    }
    state.flags.modified = true;
    RebuildSymbolTable();
    created.uid = element->GetUid();
    created.placed = MoveBeforeFirstUser(created.uid, created.predecessor);
  }
  SetNotifyChanges(true);
  return created;
}

const CreateRequest* CreationOffer::RequestOf(int choice) const {
  const auto index = static_cast<std::size_t>(choice);
  return choice >= 0 && index < requests.size() ? &requests[index] : nullptr;
}

CreationOffer TemplateCore::OfferFor(const UndefinedSymbol& undefined) const {
  CreationOffer offer;
  offer.symbol = undefined.symbol;
  offer.question =
      "There are undefined symbols!\n\nDo you want to create symbol '" + undefined.symbol + "' ?";
  offer.mask = kPlainKindsMask;
  const CEL_Lagrange_Specie* specie = nullptr;
  // The last user decides; masks are not combined.
  for (const Uid user : undefined.usedBy) {
    const SymbolRecord* record = FindRecordByUid(user);
    if (record == nullptr) continue;
    if (const auto mask = MaskForUser(record->element->Kind())) offer.mask = *mask;
    if (record->specieIndex >= 0) specie = &ClassOf(Elements(), *record);
  }
  for (std::size_t choice = 0; choice < kChoices.size(); ++choice) {
    const ChoiceRow& row = kChoices[choice];
    CreateRequest& request = offer.requests[choice];
    request.symbol = undefined.symbol;
    request.kind = row.kind;
    const bool isMember = row.listKind != ElementKind::None;
    if (isMember && specie != nullptr) request.ownerId = specie->Head(row.listKind).GetUid();
  }
  return offer;
}

std::optional<CreationOffer> TemplateCore::OfferOf(std::string_view symbol) {
  const auto& names = UndefinedSymbols();
  const auto hit =
      std::find_if(names.begin(), names.end(), [symbol](const auto& name) { return name->symbol == symbol; });
  if (hit == names.end()) return std::nullopt;
  (*hit)->asked = true;
  return OfferFor(**hit);
}

std::optional<CreationOffer> TemplateCore::NextOffer() {
  for (const auto& undefined : UndefinedSymbols()) {
    if (undefined->asked) continue;
    undefined->asked = true;
    return OfferFor(*undefined);
  }
  return std::nullopt;
}

}  // namespace tessal
