// What may be typed at a place of an element's expression: the symbols that the rules of order, place and
// class let it use, and the words of the language. The editor offers them; nothing here is reported.
#pragma once

#include <cstdint>
#include <string_view>
#include <vector>

#include "expr/caret_context.h"

namespace tessal {

class CEL_Element;
class TemplateCore;

/// What is offered, in the order in which it is shown.
enum class CompletionGroup : std::uint8_t {
  Symbol,
  Function,
  UserFunction,
  Verb,
  Keyword,
  Builtin,
  Property
};

struct Completion {
  /// As it is typed. A view into the template or a table: good until either changes.
  std::string_view text;
  CompletionGroup group = CompletionGroup::Symbol;
  const CEL_Element* element = nullptr;  ///< of a symbol
};

/// Everything that may be typed at a place in an expression of an element, in the order of the groups and, in
/// each, of the template or the table. Of elements that share a symbol the first counts, as in the rules. The
/// element's own symbol is not offered. One pass over the template.
std::vector<Completion> CompletionsFor(const TemplateCore& core, const CEL_Element& user, CaretPlace place);

/// Those whose text has what was typed in it, in any case (inside of its parts from three letters on): first
/// those that begin with it, then those of which a part after an underscore does, then the others; in each by
/// group and alphabet. One that is typed out is the first.
std::vector<Completion> Matching(const std::vector<Completion>& offered, std::string_view typed);

}  // namespace tessal
