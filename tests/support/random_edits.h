// Random edits of a template of every sort, good and bad ones, and what must be true of edits whatever they
// are. For tests and fuzz targets alike.
#pragma once

#include <string>

#include "core/template_core.h"
#include "support/choices.h"

namespace tessal::test {

/// One edit that the choices pick: a creation, a deletion, a move, a rename, a field, groups, user functions,
/// answers about undefined symbols. Leaves change notifications on.
void EditAtRandom(TemplateCore& core, fuzz::Choices& choices);

/// Edits a template at random as long as there are choices, takes all steps back and does them again. What is
/// wrong then, with the step; empty when the template was the same at each step in all three passes, and its
/// table what a fresh rebuild and a load of its text, by the file of the path, give.
std::string FaultOfHistory(TemplateCore& core, fuzz::Choices& choices, int mostEdits,
                           const std::string& path);

}  // namespace tessal::test
