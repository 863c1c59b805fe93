#include "expr/sign_reference.h"

namespace tessal {

namespace {

constexpr SignReference kArithmetic[] = {
    {"+", "a + b", "The sum; before a value it changes nothing."},
    {"-", "a - b", "The difference; before a value, its negative."},
    {"*", "a * b", "The product."},
    {"/", "a / b", "The quotient."},
    {"(", "(a + b) * c", "Opens what is computed first, or the arguments of a call."},
    {")", "MAX(a, b)", "Closes what ( has opened."},
};

constexpr SignReference kConditions[] = {
    {"IF", "IF a > b THEN a ELSE b", "Begins a conditional. IF (a > b, a, b) says the same."},
    {"THEN", "IF a > b THEN a ELSE b", "Comes before the value where the condition holds."},
    {"ELSE", "IF a > b THEN a ELSE b", "Comes before the value where it does not; it must not be left out."},
};

constexpr SignReference kComparisons[] = {
    {"==", "IF a == b THEN 1 ELSE 0", "Equal."},
    {"!=", "IF a != b THEN 1 ELSE 0", "Not equal."},
    {">", "IF a > b THEN 1 ELSE 0", "Greater."},
    {">=", "IF a >= b THEN 1 ELSE 0", "Greater or equal."},
    {"<", "IF a < b THEN 1 ELSE 0", "Less."},
    {"<=", "IF a <= b THEN 1 ELSE 0", "Less or equal."},
    {"AND", "IF a > 0 AND b > 0 THEN 1 ELSE 0", "Both conditions hold. It binds closer than OR."},
    {"&&", "IF a > 0 && b > 0 THEN 1 ELSE 0", "The same as AND."},
    {"OR", "IF a > 0 OR b > 0 THEN 1 ELSE 0", "One of the conditions holds, or both."},
    {"||", "IF a > 0 || b > 0 THEN 1 ELSE 0", "The same as OR."},
    {"NOT", "IF NOT (a > b) THEN 1 ELSE 0", "The condition does not hold."},
    {"!", "IF !(a > b) THEN 1 ELSE 0", "The same as NOT."},
    {"EXCEEDANCE_FREQUENCY", "EXCEEDANCE_FREQUENCY(a > b)", "How often the comparison holds."},
};

constexpr SignReference kSeparators[] = {
    {",", "MIN(a, b)", "Comes between the arguments of a call."},
    {";", "MIN(a; b)", "The same as a comma."},
};

constexpr SignReference kParticles[] = {
    {"[", "[AGE] * 2", "Opens the name of a property of the particle."},
    {"]", "[AGE] * 2", "Closes it."},
    {"{", "KILL{(Fish, 1)}", "Opens what an interaction of particles acts on."},
    {"}", "KILL{(Fish, 1)}", "Closes it."},
    {"::=", "Mass ::= a", "Sets a value of the particle to that of the expression."},
    {"::+", "Mass ::+ a", "Adds the expression to a value of the particle."},
    {"::-", "Mass ::- a", "Subtracts the expression from a value of the particle."},
    {"::*", "Mass ::* a", "Multiplies a value of the particle by the expression."},
    {"::/", "Mass ::/ a", "Divides a value of the particle by the expression."},
    {"$", "$ Mass", "Comes before a name; $ Mass is read as RID_VAL(Mass)."},
};

constexpr SignGroup kGroups[] = {
    {"Arithmetic",
     "Products and quotients are computed before sums and differences, equals from the left. There is no "
     "sign "
     "for a power: POW is a function.",
     kArithmetic},
    {"Conditionals", "The three words may be written in any case.", kConditions},
    {"Comparisons",
     "They are conditions, which have a place after IF and in EXCEEDANCE_FREQUENCY, and nowhere else. The "
     "words "
     "are written in capitals.",
     kComparisons},
    {"Separators", "The decimal sign is a point.", kSeparators},
    {"Particles", "They belong in the expressions of particle classes.", kParticles},
};

}  // namespace

std::span<const SignGroup> SignGroups() {
  return kGroups;
}

}  // namespace tessal
