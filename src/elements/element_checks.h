// Steps that the checks of several elements share. Each reports what it finds under the element's symbol and
// identity, and returns whether it found nothing.
#pragma once

#include <string_view>

namespace tessal {

class CEL_Element;
class CEL_Property;

/// The default lies within minimum and maximum. Both ends are tested and each has a message of its own.
bool CheckDefaultInRange(const CEL_Element& element, const CEL_Property& minimum, const CEL_Property& value,
                         const CEL_Property& maximum);
/// The minimum is not above the maximum.
bool CheckRangeOrder(const CEL_Element& element, const CEL_Property& minimum, const CEL_Property& maximum);
bool CheckSymbolForm(const CEL_Element& element);
/// No "!" in the descriptive texts; reported once.
bool CheckTextContent(const CEL_Element& element);
/// Calls, arguments and particle properties of all expressions. The result says only whether they parse.
bool CheckExpressions(const CEL_Element& element);

/// Whether an expression parses; if not, the parser's message is reported under the caption.
bool CheckParses(const CEL_Element& element, std::string_view caption, const CEL_Property& expression);

/// Whether the text holds a "!", which the simulation engine's files cannot carry.
bool HoldsIllegalText(const CEL_Element& element);

}  // namespace tessal
