// All element classes with their fields, as one listing: labels, order, kinds of value, defaults, choices
// and, for each property, its type, the selected choice, and whether it may be edited and is shown.
#include <gtest/gtest.h>

#include "elements/area_search.h"
#include "elements/expression_elements.h"
#include "elements/external_function.h"
#include "elements/input_elements.h"
#include "elements/miscellaneous.h"
#include "elements/specie.h"
#include "elements/state_variable.h"
#include "elements/version_stamp.h"
#include "elements/visibility.h"
#include "support/case_file.h"

namespace tessal {
namespace {

/// Calls the visitor with each property that the class has a member for, by its name.
template <class Element, class Visitor>
void ForEachProperty(Element& element, Visitor visit) {
// The same names for all classes: a class has those that it has.
#define TESSAL_VISIT(name) \
  if constexpr (requires { element.name.Choices(); }) visit(#name, element.name)
  TESSAL_VISIT(symbol);
  TESSAL_VISIT(id);
  TESSAL_VISIT(description);
  TESSAL_VISIT(onlineHelp);
  TESSAL_VISIT(documentation);
  TESSAL_VISIT(unqType);
  TESSAL_VISIT(unqUnit);
  TESSAL_VISIT(isUserSpecified);
  TESSAL_VISIT(builtInId);
  TESSAL_VISIT(scope);
  TESSAL_VISIT(transport);
  TESSAL_VISIT(spatialVariation);
  TESSAL_VISIT(unit);
  TESSAL_VISIT(defaultValue);
  TESSAL_VISIT(minValue);
  TESSAL_VISIT(maxValue);
  TESSAL_VISIT(output);
  TESSAL_VISIT(processType);
  TESSAL_VISIT(format);
  TESSAL_VISIT(expression);
  TESSAL_VISIT(equation);
  TESSAL_VISIT(controlId);
  TESSAL_VISIT(controlValue);
  TESSAL_VISIT(functionId);
  TESSAL_VISIT(variableId);
  TESSAL_VISIT(specieId);
  TESSAL_VISIT(radius);
  TESSAL_VISIT(dimension);
  TESSAL_VISIT(purpose);
  TESSAL_VISIT(framework);
  TESSAL_VISIT(property);
  TESSAL_VISIT(math);
  TESSAL_VISIT(lookFor);
  TESSAL_VISIT(expressionType);
  TESSAL_VISIT(specie);
  TESSAL_VISIT(speed);
  TESSAL_VISIT(direction);
  TESSAL_VISIT(projectionTime);
  TESSAL_VISIT(fieldOfView);
  TESSAL_VISIT(publicName);
  TESSAL_VISIT(dll);
  TESSAL_VISIT(entryPoint);
  TESSAL_VISIT(parameters);
  TESSAL_VISIT(usedAs);
  TESSAL_VISIT(tessalVersion);
  TESSAL_VISIT(debugLevel);
  TESSAL_VISIT(randomParticleDir);
  TESSAL_VISIT(buildSpatialTree);
  TESSAL_VISIT(optimise);
  TESSAL_VISIT(trigonometrics);
#undef TESSAL_VISIT
}

std::string FieldLine(const ElementField& field) {
  std::string text = "  " + field.name + " (" + std::to_string(static_cast<int>(field.kind)) + ") = ";
  const bool isVersion = field.kind == FieldKind::Real && field.realValue == SoftwareVersion();
  text += isVersion ? "VERSION" : FieldText(field);
  for (const std::string& choice : field.choiceTexts) text += "\n    " + choice;
  return text + "\n";
}

template <class Element>
std::string Listed(Element&& element) {
  std::string text = std::string(element.KindText()) + " '" + element.symbol.TextOf() + "'" +
                     (element.Loaded() ? " loaded" : "") + "\n";
  std::vector<ElementField> fields;
  element.GetFields(fields);
  for (const ElementField& field : fields) text += FieldLine(field);
  ForEachProperty(element, [&text](const char* name, const CEL_Property& property) {
    text += std::string("  .") + name + ": type " + std::to_string(static_cast<int>(property.Type()));
    if (property.Selected() >= 0) text += ", selected " + std::to_string(property.Selected());
    if (!property.Editable()) text += ", fixed";
    if (!property.Visible()) text += ", hidden";
    if (property.ForceReal()) text += ", forced real";
    for (const CEL_Choice& choice : property.Choices()) {
      if (choice.kind == CEL_Choice::kNumber) text += " " + std::to_string(choice.intValue);
      if (choice.kind == CEL_Choice::kText) text += " '" + choice.fileText + "'";
      if (!choice.enabled) text += " (off)";
    }
    text += "\n";
  });
  return text;
}

TEST(Elements, AreListedWithAllTheirFields) {
  CEL_Lagrange_Specie specie("Fish");
  std::string text =
      Listed(CEL_StateVariable("S")) + Listed(CEL_Constant("c")) + Listed(CEL_Forcing("f")) +
      Listed(CEL_Auxilliary_Variable("a")) + Listed(CEL_Process("p")) + Listed(CEL_Derived_Output("d")) +
      Listed(specie) + Listed(CEL_Lagrange_StateVariable("s")) + Listed(CEL_Lagrange_Constant("c")) +
      Listed(CEL_Lagrange_Forcing("f")) + Listed(CEL_Lagrange_Spatial_Function("s")) +
      Listed(CEL_Lagrange_Arithmetical_Expression("e")) + Listed(CEL_Lagrange_Horizontal_Vector("h")) +
      Listed(*specie.verticalEquation) + Listed(CEL_Miscanellous()) + Listed(CEL_ExternalFunction("x")) +
      Listed(CEL_Visibility());
  for (const auto& head : specie.Heads()) text += Listed(*head);
  test::ExpectListing("elements/fresh_elements.txt", text);
}

}  // namespace
}  // namespace tessal
