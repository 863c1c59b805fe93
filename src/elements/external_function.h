// A function that a plug-in module of the simulation engine supplies. Used as a math function, its public
// name joins the names that expressions may call; the module and its entry point are data for the engine.
#pragma once

#include "elements/element.h"
#include "expr/user_function_names.h"

namespace tessal {

class CEL_ExternalFunction final : public CEL_Element {
 public:
  explicit CEL_ExternalFunction(std::string_view caption);

  void Read(KvfNode section, ReadStatus& status) override;
  void Reset() override;
  void OnPropertyChanged(CEL_Property& changed) override;
  void UpdateLocks() override;
  void FollowValues() override;
  /// Gives the public name up.
  void Withdraw() override;

  CEL_Property publicName{ValueType::Text};
  CEL_Property dll{ValueType::Text};
  CEL_Property entryPoint{ValueType::Text};
  CEL_Property parameters{ValueType::Integer};
  CEL_Property usedAs{ValueType::Text};

 private:
  UserFunctionClaim claim;
};

}  // namespace tessal
