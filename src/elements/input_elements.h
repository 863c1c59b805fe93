// The external inputs of a model. A constant holds one value through a run, a forcing may vary in time and
// space; both are either given by the modeller or bound to a quantity of the built-in catalogue, from which
// they then take their data.
#pragma once

#include "elements/element.h"

namespace tessal {

/// What differs between the twins.
struct InputKind {
  ElementKind kind;
  std::int32_t builtinKind;  ///< the kind of the catalogue rows that it may be bound to
  const std::vector<std::int32_t>& (*builtinIds)();
};

class CEL_Input : public CEL_Element {
 public:
  void Read(KvfNode section, ReadStatus& status) override;
  void Reset() override;
  bool Check() override;
  void OnPropertyChanged(CEL_Property& changed) override;
  void UpdateLocks() override;
  void FollowValues() override;
  std::string RecordText() const override;

  /// Fills the choices of the built-in id: the catalogue's rows of this kind by name, deprecated ones only
  /// when asked for or in use.
  void RebuildBuiltInChoices(bool withDeprecated);

  CEL_Property isUserSpecified{ValueType::Boolean};
  CEL_Property builtInId{ValueType::Integer};
  CEL_Property scope{ValueType::Text};
  CEL_Property spatialVariation{ValueType::Text};
  CEL_Property unit{ValueType::Text};
  CEL_Property defaultValue{ValueType::Real};
  CEL_Property minValue{ValueType::Real};
  CEL_Property maxValue{ValueType::Real};

 protected:
  CEL_Input(const InputKind& inputKind, std::string_view caption);

 private:
  void ApplyBuiltin();

  const InputKind& input;
  bool showDeprecated = false;
};

class CEL_Constant final : public CEL_Input {
 public:
  explicit CEL_Constant(std::string_view caption);
};

class CEL_Forcing final : public CEL_Input {
 public:
  explicit CEL_Forcing(std::string_view caption);
};

}  // namespace tessal
