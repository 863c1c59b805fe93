// Where the messages of a check are in the file: at the fault in an expression, at the value of a field, or
// else at the head of the element's section.
#pragma once

namespace tessal {
class TemplateCore;
}

namespace tessal::cli {

struct TemplateMessages;

/// Fills in the places of messages that were collected from that template as its file has it. Takes time in
/// proportion to the file and the messages.
void FindPlaces(const TemplateCore& core, TemplateMessages& messages);

}  // namespace tessal::cli
