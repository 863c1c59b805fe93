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
    {
        "unused-forcing",
        ErrorLevel::Notice,
        "The forcing %1 is used nowhere",
        "No expression uses the forcing, so the data that are given for it have no effect.",
        "A wind velocity that was meant for a reaeration which the template does not have.",
        "Delete it, or use it.",
    },
    {
        "unused-auxiliary",
        ErrorLevel::Notice,
        "The auxiliary %1 is used nowhere",
        "No expression uses the value, and its expression changes nothing by itself: it can only be "
        "looked at as output.",
        "A limitation fSi that is computed and in no growth rate.",
        "Use it where it was meant to be used; make it a derived output if it is only to be looked at; "
        "or delete it.",
    },
    {
        "unused-process",
        ErrorLevel::Warning,
        "The process %1 is used nowhere",
        "No equation and no other expression uses the process, so it has no effect on any state "
        "variable.",
        "A settling rate that was written and not subtracted from anything.",
        "Add it to the equations of what it takes from and gives to, or delete it.",
    },
    {
        "unused-search",
        ErrorLevel::Notice,
        "The search %1 is used nowhere",
        "No expression of the particle class uses what the search finds, which takes time in every step.",
        "A search for the nearest food that no movement turns to.",
        "Use its value, or delete it.",
    },
    {
        "process-outside-equations",
        ErrorLevel::Warning,
        "The process %1 is in no equation",
        "Others use the process, but no equation does, not even through other processes: no state "
        "variable changes by it.",
        "A grazing rate that only a derived output adds up.",
        "Add it to the equations of what it takes from and gives to; make it an auxiliary if it is no "
        "process.",
    },
    {
        "process-repeated",
        ErrorLevel::Warning,
        "The process %1 is more than once in the equation",
        "Two terms of a state variable's equation have the same process. Usually one of the two was "
        "meant to be another.",
        "growth - respiration - respiration",
        "Write the process that was meant, or one term with the sum of the factors.",
    },
    {
        "state-unchanged",
        ErrorLevel::Warning,
        "Nothing changes the state variable %1",
        "The equation is 0, water does not carry the variable, and no expression of a particle class "
        "changes it: it keeps its first value for ever.",
        "A sediment pool whose equation was never written.",
        "Write its equation, or make it a constant.",
    },
    {
        "dependency-cycle",
        ErrorLevel::Warning,
        "Each of these depends on the others: %1",
        "Values that are computed from each other at the same time have no first one, so none can be "
        "computed.",
        "a = b + 1 and b = 2*a",
        "Take one of the uses out, or make one of them a state variable.",
    },
    {
        "division-by-zero",
        ErrorLevel::Warning,
        "Division by '%1', which is 0 at the default values",
        "When all constants, forcings and state variables have their defaults, the divisor is 0, and no "
        "IF keeps the division from being computed.",
        "Zoo/Phy where the default of Phy is 0",
        "Give the divisor a default other than 0, or divide only IF it is larger than 0.",
    },
    {
        "constant-expression",
        ErrorLevel::Warning,
        "The expression '%1' is constant",
        "The expression has no names, so it has the same value always, and nobody can change it without "
        "changing the template.",
        "2*3.5",
        "Make it a constant with a unit and a source, or write what it should depend on.",
    },
    {
        "equal-branches",
        ErrorLevel::Warning,
        "Both branches of the IF are '%1'",
        "THEN and ELSE have the same expression, so the condition decides nothing.",
        "IF temp < Topt THEN kT*2 ELSE kT*2",
        "Write the branch that was meant, or leave the IF out.",
    },
    {
        "repeated-literal",
        ErrorLevel::Notice,
        "The number %1 is written in %2 expressions",
        "The same number of two and more digits is in three and more expressions. Whoever changes it has "
        "to find all of them, and it has no unit and no source.",
        "1.047 as temperature coefficient of three rates",
        "Make it a constant, and use that.",
    },
    {
        "alias",
        ErrorLevel::Notice,
        "%1 is only another name for %2",
        "The expression is one name, and nothing else uses what it names: the two could be one.",
        "a = k*x and b = a, where only b uses a",
        "Give the one the other's expression, and delete the other.",
    },
    {
        "symbols-differ-by-case",
        ErrorLevel::Notice,
        "%1 differs from %2 only by capitals and small letters",
        "Symbols that differ only by case are different names, and easily taken for each other.",
        "KP and kp",
        "Rename one of the two.",
    },
    {
        "symbols-differ-by-digit",
        ErrorLevel::Notice,
        "%1 differs from %2 only by a number at its end",
        "Two elements of one kind and unit, one with a number and one without. Numbers from a family of "
        "several, and a zero for a first or a reference value, are no such case.",
        "KN and KN1",
        "Rename one of the two after what makes them different, or number both.",
    },
    {
        "symbol-of-function",
        ErrorLevel::Notice,
        "%1 is the name of the function %2, but for capitals",
        "Functions may be written in any case, so the symbol reads as the function.",
        "A forcing day beside the function DAY",
        "Rename the symbol.",
    },
    {
        "default-at-bound",
        ErrorLevel::Notice,
        "The default is the %1, %2",
        "A constant's default lies at the edge of its own range, so it can be varied in one direction "
        "alone; often the range or the default has a slip. Defaults of 0 and 1 are no such case.",
        "DEFAULT_VALUE = 5, MAX_VALUE = 5",
        "Widen the range, or set a default within it.",
    },
    {
        "built-in-deprecated",
        ErrorLevel::Notice,
        "%1 takes its data from the deprecated built-in %2",
        "New simulation engines may no longer supply the quantity.",
        "A forcing that is bound to a built-in that only old templates use.",
        "Bind it to the built-in that has taken its place, or give its data yourself.",
    },
    {
        "no-unit",
        ErrorLevel::Notice,
        "No unit is given",
        "Without a unit nobody can say what a value means, and the check of units does not look at what "
        "is computed from it.",
        "UNIT = 'undefined'",
        "Write the unit; '-' for a plain number.",
    },
    {
        "no-description",
        ErrorLevel::Notice,
        "No description is given",
        "Forms, lists and the documentation show the symbol alone, which others have to guess at.",
        "DESCRIPTION = ''",
        "Write in a few words what it is.",
    },
    {
        "no-source",
        ErrorLevel::Notice,
        "The value has no source",
        "Documentation and online help of the constant are empty, so nobody can tell where its value "
        "comes from.",
        "A half saturation without a reference.",
        "Name the publication, the measurement or the agreement that the value comes from.",
    },
};

}  // namespace tessal
