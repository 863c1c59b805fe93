#include "elements/element_checks.h"

#include <algorithm>
#include <array>
#include <string>

#include "core/error_registry.h"
#include "elements/element.h"
#include "expr/parser.h"
#include "expr/semantic_checks.h"

namespace tessal {

namespace {

void Report(const CEL_Element& element, const Finding& finding) {
  Errors().ReportCheck(element.FullSymbol(), element.GetUid(), finding);
}

}  // namespace

bool CheckDefaultInRange(const CEL_Element& element, const CEL_Property& minimum, const CEL_Property& value,
                         const CEL_Property& maximum) {
  const bool below = minimum.RealValue() > value.RealValue();
  const bool above = value.RealValue() > maximum.RealValue();
  if (below) Report(element, {"value-below-minimum"});
  if (above) Report(element, {"value-above-maximum"});
  return !below && !above;
}

bool CheckRangeOrder(const CEL_Element& element, const CEL_Property& minimum, const CEL_Property& maximum) {
  if (minimum.RealValue() <= maximum.RealValue()) return true;
  Report(element, {"range-reversed"});
  return false;
}

bool CheckSymbolForm(const CEL_Element& element) {
  if (IsValidSymbol(element.symbol.Text())) return true;
  Report(element, {"illegal-symbol", {element.symbol.Text()}});
  return false;
}

bool HoldsIllegalText(const CEL_Element& element) {
  const std::array<const CEL_Property*, 3> texts = {&element.description, &element.onlineHelp,
                                                    &element.documentation};
  return std::any_of(texts.begin(), texts.end(), [](const CEL_Property* property) {
    return property->Text().find('!') != std::string::npos;
  });
}

bool CheckTextContent(const CEL_Element& element) {
  if (!HoldsIllegalText(element)) return true;
  Report(element, {"illegal-text"});
  return false;
}

bool CheckExpressions(const CEL_Element& element) {
  bool good = true;
  element.ForEachExpression([&element, &good](const PropertyRow&, const CEL_Property& expression) {
    good = CheckFunctions(element.FullSymbol(), element.GetUid(), expression.Parsed()) && good;
  });
  return good;
}

bool CheckParses(const CEL_Element& element, std::string_view caption, const CEL_Property& expression) {
  const ParseFailure* failure = expression.Parsed().Failure();
  if (failure == nullptr) return true;
  Errors().ReportCheck(caption, element.GetUid(), failure->finding);
  return false;
}

}  // namespace tessal
