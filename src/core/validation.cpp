// The check pass: every element checks itself, and the rules of order and scope run over the symbol table.
// All findings go to the error registry; nothing stops at its first one.
#include "core/error_registry.h"
#include "core/template_core.h"
#include "elements/element_checks.h"

namespace tessal {

namespace {

/// Runs one check of each element of a sequence; the result of all together.
template <class Elements>
bool CheckAll(const Elements& elements) {
  bool good = true;
  for (const auto& element : elements) good = element->Check() && good;
  return good;
}

template <class Elements>
bool ParseAll(const Elements& elements) {
  bool good = true;
  for (const auto& element : elements) good = element->ParseExpression() && good;
  return good;
}

bool CheckSpecie(CEL_Lagrange_Specie& specie) {
  bool good = specie.Check();
  good = CheckAll(specie.stateVariables) && good;
  good = CheckAll(specie.constants) && good;
  good = CheckAll(specie.spatialFunctions) && good;
  good = CheckAll(specie.arithmeticExpressions) && good;
  good = CheckAll(specie.horizontalVectors) && good;
  // The forcings of a class stay unchecked, unlike those of the template.
  return specie.verticalEquation->Check() && good;
}

bool CheckRootText(const CEL_Element& root) {
  if (!HoldsIllegalText(root)) return true;
  Errors().ReportCheck("Tessal Setup", root.GetUid(), {"illegal-text"});
  return false;
}

}  // namespace

bool TemplateCore::ValidateTemplate() {
  Errors().ResetExpressionWarningCount();
  bool good = CheckAll(stateVariables);
  good = CheckAll(constants) && good;
  good = CheckAll(forcings) && good;
  good = CheckAll(auxiliaries) && good;
  good = CheckAll(processes) && good;
  good = CheckAll(derivedOutputs) && good;
  good = CheckDeclarationOrder() && good;
  for (const auto& specie : species) good = CheckSpecie(*specie) && good;
  good = (flags.strictScopeRule != 0 ? CheckScopeRule() : CheckProcessRule()) && good;
  good = CheckRootText(root) && good;
  // Also for a template without settings, on their default values.
  return misc.Check() && good;
}

bool TemplateCore::ParseAllExpressions() {
  bool good = ParseAll(auxiliaries);
  good = ParseAll(processes) && good;
  good = ParseAll(derivedOutputs) && good;
  good = ParseAll(stateVariables) && good;
  return ParseAll(species) && good;
}

}  // namespace tessal
