#include "elements/external_function.h"

#include <array>

#include "keyfile/keywords.h"

namespace tessal {

namespace {

constexpr std::string_view kMathFunction = "AS_MATH_FUNC";

constexpr std::array<std::string_view, 7> kUses = {kMathFunction,     "ON_INITSTEP",    "ON_FINALISESTEP",
                                                   "ON_INITLOCATION", "ON_SETLOCATION", "ON_SETVOLUME",
                                                   "ON_SETSPECIES"};

const ChoiceList& UseChoices() {
  static const ChoiceList kList = MakeTextChoices(kUses);
  return kList;
}

const ChoiceList& ParameterChoices() {
  constexpr std::int32_t kMostParameters = 6;
  static const ChoiceList kList = [] {
    std::vector<CEL_Choice> choices{CEL_Choice::Number("none", 0)};
    for (std::int32_t count = 1; count <= kMostParameters; ++count) {
      choices.push_back(CEL_Choice::Number(std::to_string(count), count));
    }
    return ShareChoices(std::move(choices));
  }();
  return kList;
}

constexpr std::array<PropertyRow, 5> kRows = {{
    {PlaceOf(&CEL_ExternalFunction::publicName), key::kPublicName, "Public Name", ValueType::Text, nullptr,
     "External"},
    {PlaceOf(&CEL_ExternalFunction::parameters), key::kParameters, "Parameter Count", ValueType::Integer,
     ParameterChoices, "", 0.0},
    {PlaceOf(&CEL_ExternalFunction::usedAs), key::kUsedAs, "Used as", ValueType::Text, UseChoices,
     kMathFunction},
    {PlaceOf(&CEL_ExternalFunction::dll), key::kDll, "DLL", ValueType::Text},
    {PlaceOf(&CEL_ExternalFunction::entryPoint), key::kEntryPoint, "Entry Point", ValueType::Text},
}};

}  // namespace

CEL_ExternalFunction::CEL_ExternalFunction(std::string_view caption) : CEL_Element(caption) {
  SetKind(ElementKind::ExternalFunction);
  Bind(kRows);
  ListenTo({&publicName, &parameters, &usedAs});
  claim.Claim(publicName.Text());
}

void CEL_ExternalFunction::Reset() {
  ResetOwn();
  UpdateLocks();
  claim.Claim(publicName.Text());
}

void CEL_ExternalFunction::Read(KvfNode section, ReadStatus& status) {
  CEL_Element::Read(section, status);
  claim.Claim(publicName.Text());
}

void CEL_ExternalFunction::OnPropertyChanged(CEL_Property& changed) {
  if (&changed == &publicName) {
    claim.Claim(publicName.Text());
    RebuildOwner();
  } else if (&changed == &usedAs) {
    UpdateLocks();
  } else {
    RebuildOwner();
  }
}

void CEL_ExternalFunction::FollowValues() {
  CEL_Element::FollowValues();
  claim.Claim(publicName.Text());
}

void CEL_ExternalFunction::Withdraw() {
  claim.Release();
}

void CEL_ExternalFunction::UpdateLocks() {
  // The engine fixes the argument count of its hooks.
  parameters.SetEditable(usedAs.Text() == kMathFunction);
}

}  // namespace tessal
