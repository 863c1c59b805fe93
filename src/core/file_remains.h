// What is in a template's file and was not read: notes it in the account of the load.
#pragma once

#include <string_view>

#include "platform/kvf2004.h"

namespace tessal {

class LoadAccount;
struct TemplateState;

/// Notes sections, keywords, values and comments of the template's target that no element has read, comments
/// in the head of the file, and symbols that two elements have. None for a file without the target.
void NoteWhatNobodyRead(KvfHandle file, KvfNode target, TemplateState& state);

}  // namespace tessal
