// A particle class in its file: its own keywords, a section for each list of members, the equations apart,
// and the movements last.
#include "elements/list_section.h"
#include "elements/specie.h"
#include "keyfile/keywords.h"

namespace tessal {

namespace {

/// The descriptive texts as the section of a class names them, in its order.
struct TextKeyword {
  CEL_Property CEL_Element::*property;
  std::string_view keyword;
};

constexpr std::array<TextKeyword, 4> kTexts = {{
    {&CEL_Element::symbol, key::kName},
    {&CEL_Element::description, key::kDescription},
    {&CEL_Element::onlineHelp, key::kOnlineHelp},
    {&CEL_Element::documentation, key::kDocumentation},
}};

}  // namespace

void CEL_Lagrange_Specie::Read(KvfNode section, ReadStatus& status) {
  if (!kvfIsSection(section)) return;
  DropMembers();
  ReadBase(section, status);
  for (const TextKeyword& text : kTexts) ReadProperty(this->*text.property, section, text.keyword, status);
  ReadOwn(section, status);

  const auto readLists = [this, section, &status](bool withHead) {
    ForEachMemberList([this, section, &status, withHead](const auto& list) {
      if (list.hasHead != withHead) return;
      status.NoteAbsentSection(section, list.section);
      ReadList(section, list.section, withHead ? &Head(list.listKind) : nullptr, status,
               [this, &list]() -> CEL_Element& { return *AddMember(list.kind); });
    });
  };
  readLists(true);
  if (!stateVariables.empty()) status.NoteAbsentSection(section, section::kLagrangeEquations);
  const KvfNode equations = kvfSectionByNameNum(section, section::kLagrangeEquations, 1);
  if (equations != nullptr) ReadEquations(equations, stateVariables, status);
  readLists(false);
  status.NoteAbsentSection(section, section::kVerticalSpeedEquation);
  const KvfNode vertical = kvfSectionByNameNum(section, section::kVerticalSpeedEquation, 1);
  if (vertical != nullptr) verticalEquation->Read(vertical, status);
}

void CEL_Lagrange_Specie::Write(KvfHandle file, int& status) {
  for (const TextKeyword& text : kTexts) {
    WriteProperty(this->*text.property, file, text.keyword, *this, status);
  }
  WriteOwn(file, status);

  const auto writeLists = [this, file, &status](bool withHead) {
    ForEachMemberList([this, file, &status, withHead](const auto& list) {
      if (list.hasHead != withHead) return;
      WriteList(this->*list.members, list.section, list.prefix, withHead ? &Head(list.listKind) : nullptr,
                file, status);
    });
  };
  writeLists(true);
  WriteEquations(stateVariables, section::kLagrangeEquations, section::kStateVariableEquationPrefix, file,
                 status);
  writeLists(false);
  kvfAddSection(file, section::kVerticalSpeedEquation);
  verticalEquation->Write(file, status);
  kvfEndSection(file);
}

}  // namespace tessal
