// A restricted area search: around a particle, within a radius, the model looks at a grid variable or at
// other particles and reduces what it finds to one number. Its choices are linked: the framework decides
// which purposes exist, the purpose which mathematics apply.
#pragma once

#include <string>

#include "elements/element.h"

namespace tessal {

class CEL_Lagrange_Spatial_Function final : public CEL_Element {
 public:
  /// Values of `lookFor` that mean no class by its number.
  static constexpr std::int32_t kOwnSpecie = -1;
  static constexpr std::int32_t kAnyParticle = -2;

  explicit CEL_Lagrange_Spatial_Function(std::string_view caption);

  void Read(KvfNode section, ReadStatus& status) override;
  void Reset() override;
  bool Check() override;
  void OnPropertyChanged(CEL_Property& changed) override;
  std::string RecordText() const override { return variableName; }
  void FollowValues() override;

  /// Fills the choices of purpose and mathematics from the framework and the purpose.
  void RebuildChoices();
  /// Selects the present texts among the choices; a text that is no choice gives way to the first one.
  void RestoreSelections();
  /// Whether it looks at particles and so needs the spatial tree: framework "LAGRANGE", or an oil spill.
  bool SearchesParticles() const;
  /// Whether it looks at the values of the grid.
  bool SearchesGrid() const;

  /// The name of the element that `variableId` means. It carries the link through a renumbering, see the
  /// symbol references.
  const std::string& VariableName() const { return variableName; }
  void SetVariableName(std::string_view name) { variableName = name; }

  CEL_Property functionId{ValueType::Integer};
  CEL_Property variableId{ValueType::Integer};
  CEL_Property specieId{ValueType::Integer};
  CEL_Property radius{ValueType::Real};
  CEL_Property dimension{ValueType::Integer};
  CEL_Property spatialVariation{ValueType::Text};
  CEL_Property purpose{ValueType::Text};
  CEL_Property framework{ValueType::Text};
  CEL_Property property{ValueType::Text};
  CEL_Property math{ValueType::Text};
  CEL_Property lookFor{ValueType::Integer};

 private:
  void OnFrameworkChanged();

  std::string variableName;
};

/// The first choices of what a search looks for; the particle classes come after them.
std::vector<CEL_Choice> FirstLookForChoices();

}  // namespace tessal
