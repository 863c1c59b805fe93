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
    {
        "unit-sum",
        ErrorLevel::Warning,
        "'%1' adds %2 and %3",
        "Terms of a sum have different units, so the sum means nothing. A factor between the units counts "
        "too: "
        "a rate a day and a rate a second can not be added.",
        "'mu + temp', where mu is in /d and temp in degrees C.",
        "Mend the term that does not fit, or the unit of an element in it.",
    },
    {
        "unit-comparison",
        ErrorLevel::Warning,
        "'%1' compares %2 with %3",
        "The sides of a comparison have different units, so its outcome depends on the units that were "
        "chosen.",
        "'IF depth > temp THEN 1 ELSE 0', where depth is in m and temp in degrees C.",
        "Compare with a quantity of the same unit.",
    },
    {
        "unit-branches",
        ErrorLevel::Warning,
        "'%1' gives %2 or %3",
        "The branches of a condition have different units, so the unit of the whole changes with the "
        "condition.",
        "'IF temp > Topt THEN mu ELSE temp', where mu is in /d.",
        "Mend the branch that does not fit, or the unit of an element in it.",
    },
    {
        "unit-argument",
        ErrorLevel::Warning,
        "'%1' is in %2, and %3 of %4 takes %5",
        "A function asks for a unit, or for that of another argument, and is given something else.",
        "'EXP(temp)', where temp is in degrees C.",
        "Divide by what makes the argument a plain number, or convert it to the unit that the function "
        "takes.",
    },
    {
        "unit-assignment",
        ErrorLevel::Warning,
        "'%1' is in %2, and changes an element in %3",
        "A direct modification sets or changes an element by a value of another unit.",
        "'Mass ::+ food', where Mass is in kg and food in mg/l.",
        "Convert the value to the unit of the element.",
    },
    {
        "unit-result",
        ErrorLevel::Warning,
        "'%1' gives %2, and the element is declared in %3",
        "The unit that follows from an expression is not the one that its element declares.",
        "A process in mg/l/d whose expression is 'ws*AC1', with ws in m/d and AC1 in mg/l.",
        "Mend the expression, which may lack a factor, or the unit of the element.",
    },
    {
        "unit-equation",
        ErrorLevel::Warning,
        "The equation '%1' gives %2, not %3 per unit of time",
        "The equation of a state variable is its rate of change: its unit per unit of time.",
        "A state variable in mg/l whose equation has a process in g/m2/d.",
        "Mend the process that does not fit: a flux through an area is divided by the height of the layer.",
    },
    {
        "unit-time",
        ErrorLevel::Warning,
        "The equation '%1' is per %2, and most others are per %3",
        "All equations are integrated over the same time, so they have the same unit of it.",
        "A process in mg/l/s, where all others are in mg/l/d.",
        "Convert the rates of the equation to the time that the others have.",
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
