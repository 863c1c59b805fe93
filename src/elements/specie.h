// One class of particles that the model tracks. It owns the members that describe a particle of the class:
// state variables, constants, forcings, area searches, arithmetic expressions, horizontal movements and the
// one downward movement.
#pragma once

#include <array>
#include <memory>
#include <optional>
#include <tuple>

#include "core/messages.h"
#include "elements/area_search.h"
#include "elements/element.h"
#include "elements/sequence.h"
#include "elements/specie_expressions.h"
#include "elements/specie_values.h"
#include "keyfile/keywords.h"

namespace tessal {

class CEL_Lagrange_Specie;

/// A list of members: where the class holds it, what is in it, and how it is in the file.
template <class Member>
struct MemberList {
  Sequence<Member> CEL_Lagrange_Specie::*members;
  ElementKind kind;
  ElementKind listKind;
  std::string_view section;
  std::string_view prefix;  ///< of the sub-sections
  std::string_view word;    ///< begins a default symbol, after the class's name
  bool hasHead;             ///< whether the file holds the texts of the list's head
};

template <class Member>
MemberList(Sequence<Member> CEL_Lagrange_Specie::*, ElementKind, ElementKind, std::string_view,
           std::string_view, std::string_view, bool) -> MemberList<Member>;

class CEL_Lagrange_Specie final : public CEL_Element {
 public:
  static constexpr std::size_t kListCount = 7;

  explicit CEL_Lagrange_Specie(std::string_view caption);

  void Read(KvfNode section, ReadStatus& status) override;
  void Write(KvfHandle file, int& status) override;
  void Reset() override;
  bool Check() override;
  /// Compiles the expressions of all members.
  bool ParseExpression() override;
  void GetFields(std::vector<ElementField>& fields) const override;
  int SetFields(const std::vector<ElementField>& fields) override;
  void OnPropertyChanged(CEL_Property& changed) override;
  void SetOwner(ElementOwner* template_) override;
  /// Reaches the class, its list heads and all its members.
  void SetModifiedFlag(bool* flag) override { BindMembers(flag); }
  void BindMembers(bool* flag);

  /// The number among the classes, from 1; 0 before the template has given it one.
  std::int32_t Index() const { return index; }
  void SetIndex(std::int32_t number) { index = number; }
  /// Writes the class's number into the members that name their class, where it differs.
  void StampMembers();

  /// Makes a member of the kind at the end of its list, with a symbol that is not in use; none for a kind
  /// without a list.
  CEL_Element* AddMember(ElementKind kind);
  CEL_Lagrange_StateVariable& AddStateVariable();
  CEL_Lagrange_Constant& AddConstant();
  CEL_Lagrange_Forcing& AddForcing();
  CEL_Lagrange_Spatial_Function& AddSpatialFunction();
  CEL_Lagrange_Arithmetical_Expression& AddArithmeticExpression();
  CEL_Lagrange_Horizontal_Vector& AddHorizontalVector();
  /// Calls the visitor with every member, in the order of the lists.
  template <class Visitor>
  void ForEachMember(Visitor visit) const;

  /// The list heads, in the order of the kinds 28 to 34.
  CEL_ListHead& Head(ElementKind listKind) const;
  const std::array<std::unique_ptr<CEL_ListHead>, kListCount>& Heads() const { return heads; }
  /// Whether an element is a member of this class, or the class itself (as the target of an interaction).
  bool Owns(const CEL_Element& element) const;

  /// Why an expression of a member may not use an element; nothing when it may.
  std::optional<Finding> FindUseFault(const CEL_Element& member, const CEL_Element& used) const;

  Sequence<CEL_Lagrange_StateVariable> stateVariables;
  Sequence<CEL_Lagrange_Constant> constants;
  Sequence<CEL_Lagrange_Forcing> forcings;
  Sequence<CEL_Lagrange_Spatial_Function> spatialFunctions;
  Sequence<CEL_Lagrange_Arithmetical_Expression> arithmeticExpressions;
  Sequence<CEL_Lagrange_Horizontal_Vector> horizontalVectors;
  std::unique_ptr<CEL_Lagrange_Vertical_Equation> verticalEquation;

  CEL_Property scope{ValueType::Text};
  CEL_Property projectionTime{ValueType::Real};  ///< seconds
  CEL_Property fieldOfView{ValueType::Real};     ///< degrees
  CEL_Property transport{ValueType::Text};

 private:
  template <class Member>
  Member& Add(const MemberList<Member>& list);
  void Adopt(CEL_Element& member, ElementKind listKind);
  std::string NewName(ElementKind kind, std::string_view word, std::size_t number);
  std::string NewCaption(std::string_view word, std::size_t number);

  void DropMembers();
  bool CheckMemberReferences(const CEL_Element& member) const;

  std::int32_t index = 0;
  std::size_t highestCaption = 0;  ///< the highest number of a movement's caption so far
  bool* templateModified = nullptr;
  std::array<std::unique_ptr<CEL_ListHead>, kListCount> heads;
};

/// The lists of a class, in the order of the file. The equations come before the movements, and the one
/// downward movement after them.
inline constexpr std::tuple kMemberLists{
    MemberList{&CEL_Lagrange_Specie::stateVariables, ElementKind::SpecieStateVariable,
               ElementKind::SpecieStateVariableList, section::kStateVariables, section::kStateVariablePrefix,
               "StateVariable_", true},
    MemberList{&CEL_Lagrange_Specie::constants, ElementKind::SpecieConstant, ElementKind::SpecieConstantList,
               section::kConstants, section::kConstantPrefix, "Constant_", true},
    MemberList{&CEL_Lagrange_Specie::forcings, ElementKind::SpecieForcing, ElementKind::SpecieForcingList,
               section::kForcings, section::kForcingPrefix, "Forcing_", true},
    MemberList{&CEL_Lagrange_Specie::spatialFunctions, ElementKind::SpatialFunction,
               ElementKind::SpatialFunctionList, section::kSpatialFunctions, section::kSpatialFunctionPrefix,
               "Search_Function_", true},
    MemberList{&CEL_Lagrange_Specie::arithmeticExpressions, ElementKind::ArithmeticExpression,
               ElementKind::ArithmeticExpressionList, section::kArithmeticalExpressions,
               section::kArithmeticalExpressionPrefix, "Arithmetic_Expression_", true},
    MemberList{&CEL_Lagrange_Specie::horizontalVectors, ElementKind::HorizontalVector,
               ElementKind::HorizontalVectorList, section::kHorizontalVectors,
               section::kHorizontalVectorPrefix, "Horizontal Vector", false},
};

/// Calls the visitor with each row of the lists.
template <class Visitor>
void ForEachMemberList(Visitor visit) {
  std::apply([&visit](const auto&... list) { (visit(list), ...); }, kMemberLists);
}

/// Calls the operation with the row of the kind; false for a kind without a list.
template <class Operation>
bool WithMemberList(ElementKind kind, Operation operation) {
  return std::apply(
      [kind, &operation](const auto&... list) {
        return ((list.kind == kind && (operation(list), true)) || ...);
      },
      kMemberLists);
}

template <class Visitor>
void CEL_Lagrange_Specie::ForEachMember(Visitor visit) const {
  ForEachMemberList([this, &visit](const auto& list) {
    for (const auto& member : this->*list.members) visit(*member);
  });
  visit(*verticalEquation);
}

}  // namespace tessal
