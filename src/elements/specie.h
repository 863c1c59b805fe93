// One class of particles that the model tracks. It owns the members that describe a particle of the class:
// state variables, constants, forcings, area searches, arithmetic expressions, horizontal movements and the
// one downward movement.
#pragma once

#include <array>
#include <memory>

#include "elements/area_search.h"
#include "elements/element.h"
#include "elements/sequence.h"
#include "elements/specie_expressions.h"
#include "elements/specie_values.h"

namespace tessal {

class CEL_Lagrange_Specie final : public CEL_Element {
 public:
  static constexpr std::size_t kListCount = 7;

  explicit CEL_Lagrange_Specie(std::string_view caption);

  void Read(KvfNode section, int& status) override;
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

  CEL_Lagrange_StateVariable& AddStateVariable();
  CEL_Lagrange_Constant& AddConstant();
  CEL_Lagrange_Forcing& AddForcing();
  CEL_Lagrange_Spatial_Function& AddSpatialFunction();
  CEL_Lagrange_Arithmetical_Expression& AddArithmeticExpression();
  CEL_Lagrange_Horizontal_Vector& AddHorizontalVector();

  /// The list heads, in the order of the kinds 28 to 34.
  CEL_ListHead& Head(ElementKind listKind) const;
  const std::array<std::unique_ptr<CEL_ListHead>, kListCount>& Heads() const { return heads; }
  /// Whether an element is a member of this class, or the class itself (as the target of an interaction).
  bool Owns(const CEL_Element& element) const;

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
  Member& Append(Sequence<Member>& members, ElementKind listKind, std::string_view word);
  template <class Member>
  void Adopt(Member& member, ElementKind listKind);
  std::string UnusedSymbol(std::string_view word, std::size_t number) const;

  void DropMembers();
  void ReadEquations(KvfNode section, int& status);
  void WriteEquations(KvfHandle file, int& status);
  bool CheckMemberReferences(const CEL_Element& member) const;

  std::int32_t index = 0;
  bool* templateModified = nullptr;
  std::array<std::unique_ptr<CEL_ListHead>, kListCount> heads;
};

}  // namespace tessal
