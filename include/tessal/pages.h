// Documents that are made from a template.
#pragma once

#include <string>
#include <string_view>

#include "tessal/export.h"

namespace tessal {
inline namespace v1 {

class Template;

/// The HTML documentation. Markup in texts of the template takes no effect; equations are MathML.
TESSAL_API std::string HtmlPage(const Template& model);

/// The table of all elements as aligned text.
TESSAL_API std::string OverviewTable(const Template& model);

/// An expression as LaTeX, and as a MathML block; the right side of an equation where a symbol is given.
/// Empty when it does not parse.
TESSAL_API std::string ExpressionAsLatex(std::string_view expression, std::string_view symbol = {});
TESSAL_API std::string ExpressionAsMathml(std::string_view expression, std::string_view symbol = {});

}  // namespace v1
}  // namespace tessal
