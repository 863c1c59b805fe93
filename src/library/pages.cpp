#include "tessal/pages.h"

#include "docgen/html_documentation.h"
#include "docgen/latex.h"
#include "docgen/mathml.h"
#include "docgen/overview.h"
#include "library/template_data.h"

namespace tessal {
inline namespace v1 {

std::string HtmlPage(const Template& model) {
  PageOptions options;
  options.isSafe = true;
  return HtmlDocumentation(DataOf(model).Core(), options);
}

std::string OverviewTable(const Template& model) {
  const TemplateCore& core = DataOf(model).Core();
  return OverviewText(core, BuildOverview(core));
}

std::string ExpressionAsLatex(std::string_view expression, std::string_view symbol) {
  return ExpressionToLatex(std::string(expression), std::string(symbol), false);
}

std::string ExpressionAsMathml(std::string_view expression, std::string_view symbol) {
  return ExpressionToMathML(std::string(expression), std::string(symbol), false);
}

}  // namespace v1
}  // namespace tessal
