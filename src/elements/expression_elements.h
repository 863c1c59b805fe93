// The elements of the template that hold one expression: named intermediate values, rates that state
// variable equations use, and quantities reported from the run.
#pragma once

#include "elements/element.h"

namespace tessal {

/// What the three share: a place in the water body, a unit, and an expression.
class CEL_ExpressionElement : public CEL_Element {
 public:
  void Reset() override;
  bool Check() override;
  void OnPropertyChanged(CEL_Property& changed) override;

  CEL_Property scope{ValueType::Text};
  CEL_Property spatialVariation{ValueType::Text};
  CEL_Property unit{ValueType::Text};
  CEL_Property expression{ValueType::Expression};

 protected:
  CEL_ExpressionElement(ElementKind kindNumber, std::string_view caption);
};

class CEL_Auxilliary_Variable final : public CEL_ExpressionElement {
 public:
  explicit CEL_Auxilliary_Variable(std::string_view caption);

  CEL_Property output{ValueType::Boolean};
};

class CEL_Process final : public CEL_ExpressionElement {
 public:
  explicit CEL_Process(std::string_view caption);

  CEL_Property output{ValueType::Boolean};
  CEL_Property processType{ValueType::Text};
  CEL_Property controlId{ValueType::Integer};
  CEL_Property controlValue{ValueType::Real};
};

/// Has no symbol in the file: its caption follows its place in the list.
class CEL_Derived_Output final : public CEL_ExpressionElement {
 public:
  explicit CEL_Derived_Output(std::string_view caption);

  CEL_Property format{ValueType::Text};
};

}  // namespace tessal
