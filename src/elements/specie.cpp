#include "elements/specie.h"

#include <algorithm>
#include <optional>

#include "core/error_registry.h"
#include "elements/element_checks.h"
#include "elements/element_owner.h"
#include "elements/property_io.h"
#include "expr/semantic_checks.h"
#include "keyfile/keywords.h"

namespace tessal {

namespace {

constexpr std::array<std::string_view, 1> kTransports = {"USER_SPECIFIED"};

const ChoiceList& TransportChoices() {
  static const ChoiceList kList = MakeTextChoices(kTransports);
  return kList;
}

// In file order; people read the transport before the two numbers.
constexpr std::array<PropertyRow, 4> kRows = {{
    {key::kScope, "Scope", ValueType::Text, nullptr, "WC"},
    {key::kProjectionTime, "Projection time", ValueType::Real, nullptr, "", 0.0, false, true},
    {key::kFieldOfView, "Field of view", ValueType::Real, nullptr, "", 180.0, false, true},
    {key::kTransport, "Transport", ValueType::Text, TransportChoices, kTransports[0]},
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

/// Reads one list section: its head keywords, then a member for each sub-section by position.
template <class AddMember>
void ReadList(KvfNode specie, std::string_view name, CEL_Element* head, int& status, AddMember addMember) {
  const KvfNode list = kvfSectionByNameNum(specie, name, 1);
  if (list == nullptr) return;
  if (head != nullptr) head->Read(list, status);
  const int count = kvfGetNoSections(list);
  for (int number = 1; number <= count; ++number) {
    CEL_Element& member = addMember();
    member.Read(kvfSectionByNum(list, number), status);
    member.SetLoaded(true);
  }
}

template <class Member>
void WriteList(const Sequence<Member>& members, std::string_view name, std::string_view memberPrefix,
               CEL_Element* head, KvfHandle file, int& status) {
  kvfAddSection(file, name);
  if (head != nullptr) head->Write(file, status);
  for (std::size_t place = 0; place < members.size(); ++place) {
    kvfAddSection(file, std::string(memberPrefix) + std::to_string(place + 1));
    members[place]->Write(file, status);
    kvfEndSection(file);
  }
  kvfEndSection(file);
}

Finding NotOfThisClass(std::string_view what, const CEL_Element& used, const CEL_Element& specie) {
  return {"foreign-member", {what, used.symbol.Text(), specie.symbol.Text()}};
}

/// What a state variable's equation may use: the arithmetic expressions of its class.
std::optional<Finding> FindEquationFault(const CEL_Element& used, const CEL_Lagrange_Specie& specie) {
  if (used.Kind() != ElementKind::ArithmeticExpression) {
    return Finding("foreign-equation-term", {used.symbol.Text(), specie.symbol.Text()});
  }
  const auto& expression = static_cast<const CEL_Lagrange_Arithmetical_Expression&>(used);
  if (expression.specie.IntValue() == specie.Index()) return std::nullopt;
  return NotOfThisClass("expression", used, specie);
}

/// What other members may use: the template's inputs and state variables, and members of their own class.
std::optional<Finding> FindExpressionFault(const CEL_Element& used, const CEL_Lagrange_Specie& specie) {
  switch (used.Kind()) {
    case ElementKind::StateVariable:
    case ElementKind::Constant:
    case ElementKind::Forcing:
      return std::nullopt;
    case ElementKind::SpecieStateVariable:
      if (specie.Owns(used)) return std::nullopt;
      return Finding("foreign-state-variable", {used.symbol.Text(), specie.symbol.Text()});
    case ElementKind::SpecieConstant:
      if (specie.Owns(used)) return std::nullopt;
      return NotOfThisClass("constant", used, specie);
    case ElementKind::SpatialFunction:
      if (specie.Owns(used)) return std::nullopt;
      return NotOfThisClass("spatial function", used, specie);
    case ElementKind::ArithmeticExpression:
      if (specie.Owns(used)) return std::nullopt;
      return NotOfThisClass("expression", used, specie);
    default:
      if (specie.Owns(used)) return std::nullopt;
      return NotOfThisClass("symbol", used, specie);
  }
}

/// Whether an element is declared behind its user. A class that is not behind this one is known already.
bool IsDeclaredAfter(const CEL_Element& used, const CEL_Element& user, const CEL_Lagrange_Specie& specie) {
  if (used.id.IntValue() <= user.id.IntValue()) return false;
  if (used.Kind() != ElementKind::Specie) return true;
  return static_cast<const CEL_Lagrange_Specie&>(used).Index() > specie.Index();
}

}  // namespace

CEL_Lagrange_Specie::CEL_Lagrange_Specie(std::string_view caption) : CEL_Element(caption) {
  SetKind(ElementKind::Specie);
  SetFileFlags(false, false, false);
  for (std::size_t place = 0; place < heads.size(); ++place) {
    const ElementKind listKind = KindAfter(ElementKind::SpecieStateVariableList, place);
    heads[place] = std::make_unique<CEL_ListHead>(listKind, tessal::KindText(listKind));
    heads[place]->SetParent(this);
  }
  Bind(kRows, {&scope, &projectionTime, &fieldOfView, &transport});
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
  stateVariables.clear();
  constants.clear();
  forcings.clear();
  spatialFunctions.clear();
  arithmeticExpressions.clear();
  horizontalVectors.clear();
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

template <class Member>
void CEL_Lagrange_Specie::Adopt(Member& member, ElementKind listKind) {
  member.SetListHeader(&Head(listKind));
  member.SetOwner(Owner());
  member.SetModifiedFlag(templateModified);
}

template <class Member>
Member& CEL_Lagrange_Specie::Append(Sequence<Member>& members, ElementKind listKind, std::string_view word) {
  members.push_back(std::make_unique<Member>(UnusedSymbol(word, members.size() + 1)));
  Adopt(*members.back(), listKind);
  return *members.back();
}

std::string CEL_Lagrange_Specie::UnusedSymbol(std::string_view word, std::size_t number) const {
  const std::string prefix = symbol.Text() + "_" + std::string(word);
  std::string candidate = prefix + std::to_string(number);
  while (Owner() != nullptr && Owner()->SymbolExists(candidate)) {
    candidate = prefix + std::to_string(++number);
  }
  return candidate;
}

CEL_Lagrange_StateVariable& CEL_Lagrange_Specie::AddStateVariable() {
  auto& member = Append(stateVariables, ElementKind::SpecieStateVariableList, "StateVariable_");
  member.specie.SetInt(index);
  return member;
}

CEL_Lagrange_Constant& CEL_Lagrange_Specie::AddConstant() {
  return Append(constants, ElementKind::SpecieConstantList, "Constant_");
}

CEL_Lagrange_Forcing& CEL_Lagrange_Specie::AddForcing() {
  return Append(forcings, ElementKind::SpecieForcingList, "Forcing_");
}

CEL_Lagrange_Spatial_Function& CEL_Lagrange_Specie::AddSpatialFunction() {
  return Append(spatialFunctions, ElementKind::SpatialFunctionList, "Search_Function_");
}

CEL_Lagrange_Arithmetical_Expression& CEL_Lagrange_Specie::AddArithmeticExpression() {
  auto& member =
      Append(arithmeticExpressions, ElementKind::ArithmeticExpressionList, "Arithmetic_Expression_");
  member.specie.SetInt(index);
  return member;
}

CEL_Lagrange_Horizontal_Vector& CEL_Lagrange_Specie::AddHorizontalVector() {
  std::size_t number = horizontalVectors.size() + 1;
  const auto caption = [&number] { return "Horizontal Vector" + std::to_string(number); };
  while (std::any_of(horizontalVectors.begin(), horizontalVectors.end(),
                     [&caption](const auto& vector) { return vector->symbol.Text() == caption(); })) {
    ++number;
  }
  horizontalVectors.push_back(std::make_unique<CEL_Lagrange_Horizontal_Vector>(caption()));
  Adopt(*horizontalVectors.back(), ElementKind::HorizontalVectorList);
  return *horizontalVectors.back();
}

void CEL_Lagrange_Specie::StampMembers() {
  for (const auto& member : stateVariables) member->specie.SetInt(index);
  for (const auto& member : arithmeticExpressions) member->specie.SetInt(index);
}

namespace {

/// Calls the visitor with every member of a class, in the order of its lists.
template <class Visitor>
void ForEachMember(const CEL_Lagrange_Specie& specie, Visitor visit) {
  for (const auto& member : specie.stateVariables) visit(*member);
  for (const auto& member : specie.constants) visit(*member);
  for (const auto& member : specie.forcings) visit(*member);
  for (const auto& member : specie.spatialFunctions) visit(*member);
  for (const auto& member : specie.arithmeticExpressions) visit(*member);
  for (const auto& member : specie.horizontalVectors) visit(*member);
  visit(*specie.verticalEquation);
}

}  // namespace

void CEL_Lagrange_Specie::SetOwner(ElementOwner* template_) {
  CEL_Element::SetOwner(template_);
  for (const auto& head : heads) head->SetOwner(template_);
  ForEachMember(*this, [template_](CEL_Element& member) { member.SetOwner(template_); });
}

void CEL_Lagrange_Specie::BindMembers(bool* flag) {
  templateModified = flag;
  CEL_Element::SetModifiedFlag(flag);
  for (const auto& head : heads) head->SetModifiedFlag(flag);
  ForEachMember(*this, [flag](CEL_Element& member) { member.SetModifiedFlag(flag); });
}

void CEL_Lagrange_Specie::Read(KvfNode section, int& status) {
  if (!kvfIsSection(section)) return;
  DropMembers();
  ReadBase(section, status);
  ReadProperty(symbol, section, key::kName, status);
  ReadProperty(description, section, key::kDescription, status);
  ReadProperty(onlineHelp, section, key::kOnlineHelp, status);
  ReadProperty(documentation, section, key::kDocumentation, status);
  ReadOwn(section, status);

  ReadList(section, section::kStateVariables, &Head(ElementKind::SpecieStateVariableList), status,
           [this]() -> CEL_Element& { return AddStateVariable(); });
  ReadList(section, section::kConstants, &Head(ElementKind::SpecieConstantList), status,
           [this]() -> CEL_Element& { return AddConstant(); });
  ReadList(section, section::kForcings, &Head(ElementKind::SpecieForcingList), status,
           [this]() -> CEL_Element& { return AddForcing(); });
  ReadList(section, section::kSpatialFunctions, &Head(ElementKind::SpatialFunctionList), status,
           [this]() -> CEL_Element& { return AddSpatialFunction(); });
  ReadList(section, section::kArithmeticalExpressions, &Head(ElementKind::ArithmeticExpressionList), status,
           [this]() -> CEL_Element& { return AddArithmeticExpression(); });
  ReadEquations(section, status);
  ReadList(section, section::kHorizontalVectors, nullptr, status,
           [this]() -> CEL_Element& { return AddHorizontalVector(); });
  const KvfNode vertical = kvfSectionByNameNum(section, section::kVerticalSpeedEquation, 1);
  if (vertical != nullptr) verticalEquation->Read(vertical, status);
}

void CEL_Lagrange_Specie::ReadEquations(KvfNode section, int& status) {
  const KvfNode equations = kvfSectionByNameNum(section, section::kLagrangeEquations, 1);
  if (equations == nullptr) return;
  const int count = kvfGetNoSections(equations);
  for (int number = 1; number <= count; ++number) {
    At(stateVariables, static_cast<std::size_t>(number - 1))
        .ReadEquation(kvfSectionByNum(equations, number), status);
  }
}

void CEL_Lagrange_Specie::Write(KvfHandle file, int& status) {
  WriteProperty(symbol, file, key::kName, *this, status);
  WriteProperty(description, file, key::kDescription, *this, status);
  WriteProperty(onlineHelp, file, key::kOnlineHelp, *this, status);
  WriteProperty(documentation, file, key::kDocumentation, *this, status);
  WriteOwn(file, status);

  WriteList(stateVariables, section::kStateVariables, section::kStateVariablePrefix,
            &Head(ElementKind::SpecieStateVariableList), file, status);
  WriteList(constants, section::kConstants, section::kConstantPrefix, &Head(ElementKind::SpecieConstantList),
            file, status);
  WriteList(forcings, section::kForcings, section::kForcingPrefix, &Head(ElementKind::SpecieForcingList),
            file, status);
  WriteList(spatialFunctions, section::kSpatialFunctions, section::kSpatialFunctionPrefix,
            &Head(ElementKind::SpatialFunctionList), file, status);
  WriteList(arithmeticExpressions, section::kArithmeticalExpressions, section::kArithmeticalExpressionPrefix,
            &Head(ElementKind::ArithmeticExpressionList), file, status);
  WriteEquations(file, status);
  WriteList(horizontalVectors, section::kHorizontalVectors, section::kHorizontalVectorPrefix, nullptr, file,
            status);
  kvfAddSection(file, section::kVerticalSpeedEquation);
  verticalEquation->Write(file, status);
  kvfEndSection(file);
}

void CEL_Lagrange_Specie::WriteEquations(KvfHandle file, int& status) {
  kvfAddSection(file, section::kLagrangeEquations);
  for (std::size_t place = 0; place < stateVariables.size(); ++place) {
    kvfAddSection(file, std::string(section::kStateVariableEquationPrefix) + std::to_string(place + 1));
    stateVariables[place]->WriteEquation(file, status);
    kvfEndSection(file);
  }
  kvfEndSection(file);
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

bool CEL_Lagrange_Specie::ParseExpression() {
  bool good = true;
  const auto parse = [&good](CEL_Element& member) { good = member.ParseExpression() && good; };
  for (const auto& member : arithmeticExpressions) parse(*member);
  for (const auto& member : stateVariables) parse(*member);
  for (const auto& member : horizontalVectors) parse(*member);
  parse(*verticalEquation);
  return good;
}

bool CEL_Lagrange_Specie::Check() {
  bool good = CheckTextContent(*this);
  const auto check = [this, &good](const CEL_Element& member) {
    good = CheckMemberReferences(member) && good;
  };
  for (const auto& member : stateVariables) check(*member);
  for (const auto& member : arithmeticExpressions) check(*member);
  for (const auto& member : horizontalVectors) check(*member);
  check(*verticalEquation);
  return good;
}

bool CEL_Lagrange_Specie::CheckMemberReferences(const CEL_Element& member) const {
  if (Owner() == nullptr) return true;
  const bool isEquation = member.Kind() == ElementKind::SpecieStateVariable;
  bool good = true;
  for (const CEL_Element* used : Owner()->ReferencedElements(member)) {
    auto finding = isEquation ? FindEquationFault(*used, *this) : FindExpressionFault(*used, *this);
    // Equations use what they use regardless of order: state variables are integrated.
    if (!isEquation && IsDeclaredAfter(*used, member, *this)) {
      finding = Finding("order-violated", {used->symbol.Text(), member.symbol.Text()});
    }
    if (!finding) continue;
    Errors().Report(member.symbol.Text(), member.GetUid(), *finding);
    good = false;
  }
  return good;
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
    const std::string refused = symbol.Text();
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
