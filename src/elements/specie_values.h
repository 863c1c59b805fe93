// The members of a particle class that hold values: a quantity that each particle carries, with its
// equation, and the class's inputs.
#pragma once

#include "elements/element.h"

namespace tessal {

/// What the three share: a unit and a value with its range.
class CEL_SpecieValue : public CEL_Element {
 public:
  void Reset() override;
  void OnPropertyChanged(CEL_Property& changed) override;
  void UpdateLocks() override;
  std::string RecordText() const override;

  CEL_Property unit{ValueType::Text};
  CEL_Property defaultValue{ValueType::Real};
  CEL_Property minValue{ValueType::Real};
  CEL_Property maxValue{ValueType::Real};

 protected:
  explicit CEL_SpecieValue(std::string_view caption) : CEL_Element(caption) {}

  /// Offers the unit types of particle values; a change of type brings its unit text with it.
  void OfferParticleUnits(std::string_view selected);
};

class CEL_Lagrange_StateVariable final : public CEL_SpecieValue {
 public:
  explicit CEL_Lagrange_StateVariable(std::string_view caption);

  /// Leaves the number of the class, to which it still belongs.
  void Reset() override;
  bool Check() override;

  CEL_Property specie{ValueType::Integer};  ///< the number of the owning class, from 1
  CEL_Property equation{ValueType::Expression};
};

class CEL_Lagrange_Constant final : public CEL_SpecieValue {
 public:
  explicit CEL_Lagrange_Constant(std::string_view caption);

  bool Check() override;

  CEL_Property spatialVariation{ValueType::Text};
};

class CEL_Lagrange_Forcing final : public CEL_SpecieValue {
 public:
  explicit CEL_Lagrange_Forcing(std::string_view caption);

  void Read(KvfNode section, ReadStatus& status) override;

  CEL_Property spatialVariation{ValueType::Text};
};

}  // namespace tessal
