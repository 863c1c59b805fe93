#include "elements/miscellaneous.h"

#include <array>
#include <limits>

#include "elements/element_checks.h"
#include "elements/element_owner.h"
#include "elements/list_section.h"
#include "elements/property_io.h"
#include "elements/version_stamp.h"
#include "keyfile/keywords.h"

namespace tessal {

namespace {

constexpr std::string_view kRadians = "Radians";
constexpr std::array<std::string_view, 2> kAngleUnits = {kRadians, "Degree"};

constexpr std::array<std::string_view, 7> kDebugLevels = {
    "No debug information", "Debug level 1", "Debug level 2", "Debug level 3",
    "Debug level 4",        "Debug level 5", "Debug level 6"};

const ChoiceList& AngleUnitChoices() {
  static const ChoiceList kList = MakeTextChoices(kAngleUnits);
  return kList;
}

const ChoiceList& DebugLevelChoices() {
  static const ChoiceList kList = [] {
    std::vector<CEL_Choice> choices;
    for (std::size_t level = 0; level < kDebugLevels.size(); ++level) {
      choices.push_back(CEL_Choice::Number(kDebugLevels[level], static_cast<std::int32_t>(level)));
    }
    return ShareChoices(std::move(choices));
  }();
  return kList;
}

// Old files lack some keywords, and that is not reported.
constexpr std::array<PropertyRow, 11> kRows = {{
    {PlaceOf(&CEL_Miscanellous::tessalVersion), key::kTessalVersion, "Tessal version", ValueType::Real},
    {PlaceOf(&CEL_Miscanellous::parserVersion), key::kParserVersion, "Parser version", ValueType::Real},
    ListedLast(OnlyWith(key::kDocumentRevision, {PlaceOf(&CEL_Miscanellous::documentRevision),
                                                 key::kDocumentRevision, "Revision", ValueType::Integer})),
    {PlaceOf(&CEL_Miscanellous::randSeed), key::kRandSeed, "Randseed", ValueType::Integer},
    {PlaceOf(&CEL_Miscanellous::debugLevel), key::kDebugLevel, "Debug level", ValueType::Integer,
     DebugLevelChoices},
    {PlaceOf(&CEL_Miscanellous::debugLog), key::kDebugLog, "Debug log", ValueType::Text},
    {PlaceOf(&CEL_Miscanellous::randomParticleDir), key::kRandomParticleDir, "Inital random particle dir",
     ValueType::Boolean, YesNoChoices, kNo},
    {PlaceOf(&CEL_Miscanellous::buildSpatialTree), key::kBuildSpatialTree, "Build spatial tree",
     ValueType::Boolean, YesNoChoices, kNo},
    {PlaceOf(&CEL_Miscanellous::checksum), key::kChecksum, "Checksum", ValueType::Text, nullptr, "0"},
    OnlyWith(key::kOptimise, {PlaceOf(&CEL_Miscanellous::optimise), key::kOptimise, "Optimise expressions",
                              ValueType::Boolean, YesNoChoices, kYes}),
    OnlyWith(key::kTrigonometrics, {PlaceOf(&CEL_Miscanellous::trigonometrics), key::kTrigonometrics,
                                    "Trigonometric unit", ValueType::Text, AngleUnitChoices, "Degree"}),
}};

}  // namespace

CEL_Miscanellous::CEL_Miscanellous() : CEL_Element(false, false, true) {
  SetKind(ElementKind::Miscellaneous);
  symbol.SetEditable(false);
  Bind(kRows);
  CEL_Miscanellous::Reset();
}

void CEL_Miscanellous::Reset() {
  // The settings outlive the file: the next load drops its text.
  RestartOwn();
  tessalVersion.SetReal(SoftwareVersion());
  parserVersion.SetReal(ParserVersion());
  ClearTexts();
  functionHead.ClearTexts();
  functions.clear();
  visibilities.Reset();
}

void CEL_Miscanellous::SetAbsentValues(KvfNode section) {
  if (!HasKeyword(section, key::kDocumentRevision)) documentRevision.SetInt(-1);
  if (!HasKeyword(section, key::kOptimise)) optimise.SetBool(false);
  if (!HasKeyword(section, key::kTrigonometrics)) trigonometrics.SetText(kRadians);
}

void CEL_Miscanellous::Read(KvfNode section, ReadStatus& status) {
  if (!kvfIsSection(section)) return;
  SetAbsentValues(section);
  CEL_Element::Read(section, status);
  tessalVersion.SetReal(RoundVersion(tessalVersion.RealValue()));
  parserVersion.SetReal(RoundVersion(parserVersion.RealValue()));
  ReadList(section, section::kExternalFunctions, &functionHead, status,
           [this]() -> CEL_Element& { return AddExternalFunction(); });
  visibilities.Read(section, status);
}

void CEL_Miscanellous::Write(KvfHandle file, int& status) {
  const std::int32_t revision = documentRevision.IntValue();
  if (revision >= 0 && revision < std::numeric_limits<std::int32_t>::max()) {
    documentRevision.SetInt(revision + 1);
  }
  CEL_Element::Write(file, status);
  if (!functions.empty()) {
    WriteList(functions, section::kExternalFunctions, section::kExternalFunctionPrefix, &functionHead, file,
              status);
  }
  if (!visibilities.groups.empty()) visibilities.Write(file, status);
}

int CEL_Miscanellous::SetFields(const std::vector<ElementField>& fields) {
  const int found = CEL_Element::SetFields(fields);
  tessalVersion.SetReal(RoundVersion(tessalVersion.RealValue()));
  parserVersion.SetReal(RoundVersion(parserVersion.RealValue()));
  return found;
}

bool CEL_Miscanellous::Check() {
  return CheckTextContent(*this);
}

void CEL_Miscanellous::SetModifiedFlag(bool* flag) {
  templateModified = flag;
  CEL_Element::SetModifiedFlag(flag);
  functionHead.SetModifiedFlag(flag);
  for (const auto& function : functions) function->SetModifiedFlag(flag);
  visibilities.SetModifiedFlag(flag);
}

void CEL_Miscanellous::SetOwner(ElementOwner* template_) {
  CEL_Element::SetOwner(template_);
  functionHead.SetOwner(template_);
  for (const auto& function : functions) function->SetOwner(template_);
  visibilities.SetOwner(template_);
}

CEL_ExternalFunction& CEL_Miscanellous::AddExternalFunction() {
  auto function = std::make_unique<CEL_ExternalFunction>("External User Function " +
                                                         std::to_string(functions.size() + 1));
  function->SetOwner(Owner());
  function->SetParent(this);
  function->SetModifiedFlag(templateModified);
  functions.push_back(std::move(function));
  MarkModified();
  if (Owner() != nullptr) Owner()->OnAppended(*functions.back());
  RebuildOwner();
  return *functions.back();
}

bool CEL_Miscanellous::RemoveExternalFunction(std::size_t index) {
  if (index >= functions.size()) return false;
  const auto place = functions.begin() + static_cast<std::ptrdiff_t>(index);
  std::unique_ptr<CEL_ExternalFunction> removed = std::move(*place);
  functions.erase(place);
  removed->Withdraw();
  MarkModified();
  if (Owner() != nullptr) Owner()->OnRemoved(std::move(removed), index);
  RebuildOwner();
  return true;
}

}  // namespace tessal
