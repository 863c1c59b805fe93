// What an analysis found in a template: a row of the table of analyses, with its values filled in, and where.
// Findings are values; none goes to the list of messages.
#pragma once

#include <string>
#include <string_view>

#include "core/messages.h"
#include "elements/element_kind.h"
#include "expr/scanner.h"
#include "platform/uid.h"

namespace tessal {

class CEL_Element;

struct AnalysisFinding {
  Message message;          ///< its code, severity and remedy
  std::string text;         ///< the row's, filled in
  Uid element = Uid::None;  ///< none for a finding about the whole template
  std::string symbol{};     ///< of the element, as messages show it
  ElementKind kind = ElementKind::None;
  int line = 0;              ///< of the element's section in the file, from 1; 0 for none
  std::string_view field{};  ///< the label of the property that it is about; empty for the element itself
  LexemeSpan place{0, 0};    ///< in the field's text, the quotes stripped; empty for all of it
};

/// A finding about an element; its field and place are still to be set.
AnalysisFinding FindingAbout(const CEL_Element& element, const Finding& finding);

}  // namespace tessal
