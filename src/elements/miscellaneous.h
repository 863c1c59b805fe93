// The template's settings record: versions, run settings, the plug-in user functions and the visibility
// groups. There is one per template.
#pragma once

#include <memory>
#include <vector>

#include "elements/element.h"
#include "elements/external_function.h"
#include "elements/sequence.h"
#include "elements/visibility.h"

namespace tessal {

class CEL_Miscanellous final : public CEL_Element {
 public:
  CEL_Miscanellous();

  void Read(KvfNode section, ReadStatus& status) override;
  /// Raises the document revision before it writes it, unless it is -1, the mark of a file that had none.
  void Write(KvfHandle file, int& status) override;
  void Reset() override;
  /// Versions have three decimals.
  int SetFields(const std::vector<ElementField>& fields) override;
  bool Check() override;
  void SetModifiedFlag(bool* flag) override;
  void SetOwner(ElementOwner* template_) override;
  /// Changes of settings touch no symbol.
  void OnPropertyChanged(CEL_Property& /*changed*/) override {}

  /// Makes a user function with the caption "External User Function" and its number, and appends it. This and
  /// the removal bring the symbol table up to date: the public name is in use, or no longer is.
  CEL_ExternalFunction& AddExternalFunction();
  /// Removes the function at the place (from 0) and its public name; false when there is no such place.
  bool RemoveExternalFunction(std::size_t index);
  const Sequence<CEL_ExternalFunction>& ExternalFunctions() const { return functions; }
  /// For who puts functions back where they were.
  Sequence<CEL_ExternalFunction>& ExternalFunctionList() { return functions; }
  CEL_ListHead& ExternalFunctionHead() { return functionHead; }
  const CEL_ListHead& ExternalFunctionHead() const { return functionHead; }

  CEL_Visibility& Visibilities() { return visibilities; }
  const CEL_Visibility& Visibilities() const { return visibilities; }

  CEL_Property tessalVersion{ValueType::Real};
  CEL_Property parserVersion{ValueType::Real};
  CEL_Property documentRevision{ValueType::Integer};
  CEL_Property randSeed{ValueType::Integer};
  CEL_Property debugLevel{ValueType::Integer};
  CEL_Property debugLog{ValueType::Text};
  CEL_Property randomParticleDir{ValueType::Boolean};
  CEL_Property buildSpatialTree{ValueType::Boolean};
  CEL_Property checksum{ValueType::Text};
  CEL_Property optimise{ValueType::Boolean};
  CEL_Property trigonometrics{ValueType::Text};

 private:
  /// What an old file means by the keywords that it lacks.
  void SetAbsentValues(KvfNode section);

  bool* templateModified = nullptr;
  CEL_ListHead functionHead{ElementKind::ExternalFunction, ""};
  Sequence<CEL_ExternalFunction> functions;
  CEL_Visibility visibilities;
};

}  // namespace tessal
