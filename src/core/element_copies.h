// Elements as text, for a clipboard, and back: the text is a template file that holds them alone, so that it
// can go into a text editor, a file or another template.
#pragma once

#include <string>
#include <vector>

#include "platform/uid.h"

namespace tessal {

class CEL_Element;
class TemplateCore;

/// Whether an element can be copied: one of a collection or of a particle class, but not the one downward
/// movement of a class.
bool CanCopy(const CEL_Element& element);

struct CopiedText {
  std::string text{};     ///< empty where nothing can be copied
  std::string refusal{};  ///< why there is none, for people: the format cannot hold an element
};

/// The text of those of the elements that can be copied, in the order of the template.
CopiedText TextOfElements(const TemplateCore& core, const std::vector<Uid>& uids);

/// Where copies go.
struct CopyPlace {
  Uid after = Uid::None;   ///< copies of its kind go after this element; otherwise to the end
  Uid specie = Uid::None;  ///< the class that takes members; without one, that of the name they come from
};

struct PastedElements {
  std::vector<Uid> uids{};
  std::string refusal{};  ///< why something of the text was not made, for people; empty when all was
};

/// Makes copies of what a text holds, as one step. A symbol that is taken gets the next free number, and the
/// copies of those who use its element use the copy. A text that is no template's, and members that have no
/// class to go to, are refused, and change nothing.
PastedElements PasteElements(TemplateCore& core, const std::string& text, const CopyPlace& place);

/// Copies elements within their template, each after its original, as one step.
PastedElements DuplicateElements(TemplateCore& core, const std::vector<Uid>& uids);

}  // namespace tessal
