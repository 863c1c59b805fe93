#include "sbml_model.h"

#include <string_view>
#include <utility>

#include "generated_model.h"

namespace tessal::bench {

namespace {

constexpr Dialect kMathMl = {
    .patterns = {"<apply><plus/><apply><times/>$1<apply><exp/><apply><divide/><apply><minus/>$2</apply>"
                 "<apply><plus/>$3<cn>1</cn></apply></apply></apply></apply>$4</apply>",
                 "<piecewise><piece><apply><times/>$2$3</apply><apply><gt/>$1<cn>0.5</cn></apply></piece>"
                 "<otherwise>$4</otherwise></piecewise>",
                 "<apply><minus/>$1$2</apply>"},
    .nameStart = "<ci>",
    .nameEnd = "</ci>",
    .numberStart = "<cn>",
    .numberEnd = "</cn>"};

class SbmlWriter final {
 public:
  explicit SbmlWriter(const GeneratedModel& written) : model(written) {}

  std::string Text() {
    text =
        "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
        "<sbml xmlns=\"http://www.sbml.org/sbml/level3/version1/core\" level=\"3\" version=\"1\">\n"
        "<model id=\"generated\">\n"
        "<listOfCompartments><compartment id=\"water\" size=\"1\" constant=\"true\"/></listOfCompartments>\n";
    List("listOfSpecies", [this] {
      Variables("species", kind::kStateVariable, model.stateVariables,
                "compartment=\"water\" initialConcentration=\"0.25\" hasOnlySubstanceUnits=\"false\" "
                "boundaryCondition=\"true\" constant=\"false\"");
    });
    List("listOfParameters", [this] {
      Variables("parameter", kind::kConstant, model.constants, "value=\"0.25\" constant=\"true\"");
      Variables("parameter", kind::kForcing, model.forcings, "value=\"0.25\" constant=\"false\"");
      Variables("parameter", kind::kAuxiliary, model.auxiliaries.size(), "constant=\"false\"");
      Variables("parameter", kind::kProcess, model.processes.size(), "constant=\"false\"");
    });
    List("listOfRules", [this] {
      Rules("assignmentRule", kind::kAuxiliary, model.auxiliaries);
      Rules("assignmentRule", kind::kProcess, model.processes);
      Rules("rateRule", kind::kStateVariable, model.equations);
    });
    text += "</model>\n</sbml>\n";
    return std::move(text);
  }

 private:
  template <class WriteContent>
  void List(const std::string& name, WriteContent writeContent) {
    text += "<" + name + ">\n";
    writeContent();
    text += "</" + name + ">\n";
  }

  void Variables(const std::string& element, std::string_view kind, std::size_t count,
                 const std::string& attributes) {
    for (std::size_t place = 1; place <= count; ++place) {
      const std::string name = NameOf(kind, static_cast<int>(place));
      text += "<" + element + " id=\"" + name + "\" name=\"" + DescriptionOf(name) + "\" " + attributes;
      text += "/>\n";
    }
  }
  void Variables(const std::string& element, std::string_view kind, int count,
                 const std::string& attributes) {
    Variables(element, kind, static_cast<std::size_t>(count), attributes);
  }

  void Rules(const std::string& element, std::string_view kind,
             const std::vector<GeneratedExpression>& expressions) {
    int place = 0;
    for (const GeneratedExpression& expression : expressions) {
      text += "<" + element + " variable=\"" + NameOf(kind, ++place) + "\">";
      text += "<math xmlns=\"http://www.w3.org/1998/Math/MathML\">" + Write(expression, kMathMl) + "</math>";
      text += "</" + element + ">\n";
    }
  }

  const GeneratedModel& model;
  std::string text;
};

}  // namespace

std::string SbmlText(const GeneratedModel& model) {
  return SbmlWriter(model).Text();
}

}  // namespace tessal::bench
