// A quantity of the model with a transport behaviour, a value range and a time-derivative equation.
#pragma once

#include "elements/element.h"

namespace tessal {

class CEL_StateVariable final : public CEL_Element {
 public:
  explicit CEL_StateVariable(std::string_view caption);

  void Read(KvfNode section, ReadStatus& status) override;
  void Reset() override;
  bool Check() override;
  void OnPropertyChanged(CEL_Property& changed) override;
  void UpdateLocks() override;

  CEL_Property scope{ValueType::Text};
  CEL_Property transport{ValueType::Text};
  CEL_Property unit{ValueType::Text};
  CEL_Property defaultValue{ValueType::Real};
  CEL_Property minValue{ValueType::Real};
  CEL_Property maxValue{ValueType::Real};
  CEL_Property equation{ValueType::Expression};
};

}  // namespace tessal
