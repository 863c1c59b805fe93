// The members of a particle class that hold expressions: its auxiliaries and processes, its horizontal
// movements, and its downward movement.
#pragma once

#include "elements/element.h"

namespace tessal {

class CEL_Lagrange_Arithmetical_Expression final : public CEL_Element {
 public:
  explicit CEL_Lagrange_Arithmetical_Expression(std::string_view caption);

  /// Leaves the number of the class, to which it still belongs.
  void Reset() override;
  bool Check() override;

  /// Whether it is a process follows from its use: one that a state variable of its class uses is one.
  void Classify(bool isProcess);

  CEL_Property expressionType{ValueType::Text};
  CEL_Property specie{ValueType::Integer};  ///< the number of the owning class, from 1
  CEL_Property output{ValueType::Boolean};
  CEL_Property spatialVariation{ValueType::Text};
  CEL_Property unit{ValueType::Text};
  CEL_Property expression{ValueType::Expression};
};

/// What the movements of a class share: expressions, and nothing else in the file or among the fields.
class CEL_Movement : public CEL_Element {
 public:
  void Reset() override { ResetOwn(); }
  bool Check() override;
  void GetFields(std::vector<ElementField>& fields) const override;
  int SetFields(const std::vector<ElementField>& fields) override { return SetOwnFields(fields); }
  void AppendFullSymbol(std::string& text) const override;

 protected:
  CEL_Movement(ElementKind kind, std::string_view caption);
};

/// One horizontal movement. It takes two places in the symbol table: its direction, then its speed.
class CEL_Lagrange_Horizontal_Vector final : public CEL_Movement {
 public:
  explicit CEL_Lagrange_Horizontal_Vector(std::string_view caption);

  CEL_Property speed{ValueType::Expression};
  CEL_Property direction{ValueType::Expression};
};

class CEL_Lagrange_Vertical_Equation final : public CEL_Movement {
 public:
  explicit CEL_Lagrange_Vertical_Equation(std::string_view caption);

  CEL_Property speed{ValueType::Expression};
};

}  // namespace tessal
