// What is wrong with an expression that is typed for an element: the faults of the language, and the names
// that mean nothing or may not be used there. As values, for whoever shows them; nothing here is reported.
#pragma once

#include <string_view>
#include <vector>

#include "expr/plain_language.h"

namespace tessal {

class CEL_Element;
class TemplateCore;

/// The faults in the order of the text, each name once. A text that does not parse has the one at which the
/// parse stopped. Finds in a name what the checks would find in it after a commit.
std::vector<ExpressionFault> FindExpressionFaults(const TemplateCore& core, const CEL_Element& user,
                                                  std::string_view text);

}  // namespace tessal
