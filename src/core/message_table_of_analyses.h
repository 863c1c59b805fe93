// Every finding that an analysis of a template can give, one row each, as the table of messages has them for
// loads and checks. A template with such findings is well formed; they say what may be wrong with its
// content.
#pragma once

#include "core/message_table.h"

namespace tessal {

inline constexpr MessageRow kAnalysisMessages[] = {
    // Units.
    {
        "unit-unknown",
        ErrorLevel::Notice,
        "The unit '%1' can not be read",
        "A unit text is none that is known; what is computed from the element has no known unit either, and "
        "is not compared.",
        "UNIT = 'as above'",
        "Write the unit in symbols, such as mg/l or g/m2/d.",
    },

    // Mass balance.
    {
        "pool-open",
        ErrorLevel::Warning,
        "The pool %1 is not closed: %2",
        "What a process takes from the pool it does not give back to it, and it is no boundary process of "
        "the pool.",
        "A respiration that is subtracted from the algae and added to no nutrient.",
        "Add the missing term to an equation, or name the process as a boundary of the pool.",
    },

    // Lint.
    {
        "unused-constant",
        ErrorLevel::Notice,
        "The constant %1 is used nowhere",
        "No expression uses the constant, so its value has no effect.",
        "A constant that was left when its process was rewritten.",
        "Delete it, or use it where a number stands in its place.",
    },
};

}  // namespace tessal
