#include "elements/specie.h"

#include <algorithm>
#include <optional>

#include "core/error_registry.h"
#include "elements/element_owner.h"
#include "elements/free_name.h"
#include "expr/semantic_checks.h"
#include "keyfile/keywords.h"
#include "keyfile/water_body.h"

namespace tessal {

namespace {

constexpr std::array<std::string_view, 1> kTransports = {"USER_SPECIFIED"};

const ChoiceList& TransportChoices() {
  static const ChoiceList kList = MakeTextChoices(kTransports);
  return kList;
}

// In file order; people read the transport before the two numbers.
constexpr std::array<PropertyRow, 4> kRows = {{
    {PlaceOf(&CEL_Lagrange_Specie::scope), key::kScope, "Scope", ValueType::Text, nullptr,
     scope::kWaterColumn},
    ListedLast({PlaceOf(&CEL_Lagrange_Specie::projectionTime), key::kProjectionTime, "Projection time",
                ValueType::Real, nullptr, "", 0.0}),
    ListedLast({PlaceOf(&CEL_Lagrange_Specie::fieldOfView), key::kFieldOfView, "Field of view",
                ValueType::Real, nullptr, "", 180.0}),
    {PlaceOf(&CEL_Lagrange_Specie::transport), key::kTransport, "Transport", ValueType::Text,
     TransportChoices, kTransports[0]},
}};

/// The descriptive fields, in the order of field lists.
struct TextRow {
  std::string_view label;
  CEL_Property CEL_Element::*property;
};

constexpr std::array<TextRow, 4> kTextRows = {{
    {"Name", &CEL_Element::symbol},
    {"Description", &CEL_Element::description},
    {"Documentation", &CEL_Element::documentation},
    {"Online help", &CEL_Element::onlineHelp},
}};

}  // namespace

CEL_Lagrange_Specie::CEL_Lagrange_Specie(std::string_view caption) : CEL_Element(caption) {
  SetKind(ElementKind::Specie);
  SetFileFlags(false, false, false);
  for (std::size_t place = 0; place < heads.size(); ++place) {
    const ElementKind listKind = KindAfter(ElementKind::SpecieStateVariableList, place);
    heads[place] = std::make_unique<CEL_ListHead>(listKind, tessal::KindText(listKind));
    heads[place]->SetParent(this);
  }
  Bind(kRows);
  ListenTo({&symbol, &id, &description, &documentation, &scope, &projectionTime, &fieldOfView, &transport});
  DropMembers();
  SetLoaded(true);
}

CEL_ListHead& CEL_Lagrange_Specie::Head(ElementKind listKind) const {
  const auto place =
      static_cast<std::size_t>(NumberOf(listKind) - NumberOf(ElementKind::SpecieStateVariableList));
  if (place >= heads.size()) throw SubscriptFailure();
  return *heads[place];
}

bool CEL_Lagrange_Specie::Owns(const CEL_Element& element) const {
  if (&element == this) return true;
  return element.ListHeader() != nullptr && element.ListHeader()->Parent() == this;
}

void CEL_Lagrange_Specie::DropMembers() {
  ForEachMemberList([this](const auto& list) { (this->*list.members).clear(); });
  highestCaption = 0;
  verticalEquation = std::make_unique<CEL_Lagrange_Vertical_Equation>("Downward Velocity");
  Adopt(*verticalEquation, ElementKind::VerticalEquationList);
}

void CEL_Lagrange_Specie::Reset() {
  symbol.SetText("");
  ClearTexts();
  index = 0;
  ResetOwn();
  DropMembers();
}

void CEL_Lagrange_Specie::Adopt(CEL_Element& member, ElementKind listKind) {
  member.SetListHeader(&Head(listKind));
  member.SetOwner(Owner());
  member.SetModifiedFlag(templateModified);
}

std::string CEL_Lagrange_Specie::NewCaption(std::string_view word, std::size_t number) {
  // A number above all that were given so far is free. Only after a deletion may one below them not be.
  if (number <= highestCaption) {
    number = FirstFreeNumber(word, number, [this](const std::string& caption) {
      return std::any_of(horizontalVectors.begin(), horizontalVectors.end(),
                         [&caption](const auto& vector) { return vector->symbol.Text() == caption; });
    });
  }
  highestCaption = std::max(highestCaption, number);
  return NumberedName(word, number);
}

std::string CEL_Lagrange_Specie::NewName(ElementKind kind, std::string_view word, std::size_t number) {
  // Movements have captions of their own, which the class's name does not begin.
  if (kind == ElementKind::HorizontalVector) return NewCaption(word, number);
  const std::string prefix = std::string(symbol.Text()) + '_' + std::string(word);
  return FirstFreeName(prefix, number, [this](const std::string& name) {
    return Owner() != nullptr && Owner()->SymbolExists(name);
  });
}

template <class Member>
Member& CEL_Lagrange_Specie::Add(const MemberList<Member>& list) {
  auto& members = this->*list.members;
  members.push_back(std::make_unique<Member>(NewName(list.kind, list.word, members.size() + 1)));
  Member& member = *members.back();
  Adopt(member, list.listKind);
  if (Owner() != nullptr) Owner()->OnAppended(member);
  if constexpr (requires { member.specie; }) member.specie.SetInt(index);
  // A class's parent is the template's root, whose text every new element starts with.
  if (Parent() != nullptr) member.documentation.SetText(Parent()->documentation.Text());
  if (templateModified != nullptr) *templateModified = true;
  return member;
}

CEL_Element* CEL_Lagrange_Specie::AddMember(ElementKind kind) {
  CEL_Element* added = nullptr;
  ForEachMemberList([this, kind, &added](const auto& list) {
    if (list.kind == kind) added = &Add(list);
  });
  return added;
}

CEL_Lagrange_StateVariable& CEL_Lagrange_Specie::AddStateVariable() {
  return Add(std::get<MemberList<CEL_Lagrange_StateVariable>>(kMemberLists));
}

CEL_Lagrange_Constant& CEL_Lagrange_Specie::AddConstant() {
  return Add(std::get<MemberList<CEL_Lagrange_Constant>>(kMemberLists));
}

CEL_Lagrange_Forcing& CEL_Lagrange_Specie::AddForcing() {
  return Add(std::get<MemberList<CEL_Lagrange_Forcing>>(kMemberLists));
}

CEL_Lagrange_Spatial_Function& CEL_Lagrange_Specie::AddSpatialFunction() {
  return Add(std::get<MemberList<CEL_Lagrange_Spatial_Function>>(kMemberLists));
}

CEL_Lagrange_Arithmetical_Expression& CEL_Lagrange_Specie::AddArithmeticExpression() {
  return Add(std::get<MemberList<CEL_Lagrange_Arithmetical_Expression>>(kMemberLists));
}

CEL_Lagrange_Horizontal_Vector& CEL_Lagrange_Specie::AddHorizontalVector() {
  return Add(std::get<MemberList<CEL_Lagrange_Horizontal_Vector>>(kMemberLists));
}

void CEL_Lagrange_Specie::StampMembers() {
  ForEachMemberList([this](const auto& list) {
    for (const auto& member : this->*list.members) {
      if constexpr (requires { member->specie; }) member->specie.SetInt(index);
    }
  });
}

void CEL_Lagrange_Specie::SetOwner(ElementOwner* template_) {
  CEL_Element::SetOwner(template_);
  for (const auto& head : heads) head->SetOwner(template_);
  ForEachMember([template_](CEL_Element& member) { member.SetOwner(template_); });
}

void CEL_Lagrange_Specie::BindMembers(bool* flag) {
  templateModified = flag;
  CEL_Element::SetModifiedFlag(flag);
  for (const auto& head : heads) head->SetModifiedFlag(flag);
  ForEachMember([flag](CEL_Element& member) { member.SetModifiedFlag(flag); });
}

void CEL_Lagrange_Specie::GetFields(std::vector<ElementField>& fields) const {
  AppendCaption(fields);
  for (const TextRow& row : kTextRows) fields.push_back(MakeField(row.label, this->*row.property));
  AppendOwnFields(fields);
}

int CEL_Lagrange_Specie::SetFields(const std::vector<ElementField>& fields) {
  int found = 0;
  for (const TextRow& row : kTextRows) {
    const ElementField* field = FindField(fields, row.label);
    if (field != nullptr && SetFromField(this->*row.property, *field)) ++found;
  }
  return found + SetOwnFields(fields);
}

void CEL_Lagrange_Specie::OnPropertyChanged(CEL_Property& changed) {
  if (&changed == &description && description.Text().find('!') != std::string::npos) {
    Errors().ReportCheck(symbol.Text(), GetUid(), {"illegal-text"});
  }
  if (&changed != &symbol) return;
  std::optional<Message> fault;
  if (!IsValidSymbol(symbol.Text())) {
    fault = Message("illegal-symbol");
  } else if (Owner() != nullptr && Owner()->IsSymbolTakenByOther(GetUid(), symbol.Text())) {
    fault = Message("symbol-taken");
  }
  if (fault) {
    const std::string refused(symbol.Text());
    {
      const NotificationsOff silent;  // going back is no new change to judge
      symbol.SetText(symbol.PrevText());
    }
    Errors().ReportCheck(refused, GetUid(), {*fault, {refused}});
    return;
  }
  ParseExpression();
  RebuildOwner();
}

}  // namespace tessal
