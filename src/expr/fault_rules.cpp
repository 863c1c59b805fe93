#include "expr/fault_rules.h"

namespace tessal {

namespace {

// NOLINTNEXTLINE(google-build-using-namespace): the rows below are made of nothing else.
using namespace sort;
namespace in = around;

constexpr std::string_view kPower = "A power is written POW(a, 2).";
constexpr std::string_view kCompares = "The condition of an IF compares two values, as in a > 0.";
constexpr std::string_view kOnlyInIf = "Comparisons may only be in the condition of an IF.";
constexpr std::string_view kJoinsOnlyInIf = "AND, OR and NOT may only be in the condition of an IF.";
constexpr std::string_view kCapitals = "AND, OR and NOT are written in capitals.";
constexpr std::string_view kMissingBefore = "A value is missing before %a.";
constexpr std::string_view kInteraction =
    "An interaction is written VERB{(class, condition), (variable, variable, 1, 0, 0, 0)}.";

// clang-format off
constexpr FaultRule kRules[] = {
    // Signs of other languages.
    {kAny, kStray, kAny, in::kBrackets, in::kParts, kPower, "^"},
    {kFactor, kFactor, kAny, in::kBrackets, in::kParts, kPower, "*", "*", Touch::Before},
    {kFactor, kFactor, kAny, in::kBrackets, in::kParts, "A comment is written /* ... */.", "/", "/", Touch::Before},
    {kAny, kStray, kRelation, in::kBrackets, in::kParts,
     "At least is written >=, at most is written <=.", "="},
    {kRelation, kStray, kAny, in::kBrackets, in::kParts, "Two values are compared with ==.", "=", "==", Touch::Before},
    {kAny, kStray, kAny, in::kBrackets, in::kCondition | in::kCompared,
     "Two values are compared with ==; a single = means nothing here.", "="},
    {kName, kStray, kAny, in::kTop, in::kNoIf,
     "Only the right side is written: leave out the symbol and the =.", "="},
    {kAny, kStray, kAny, in::kBrackets, in::kParts,
     "Two values are compared with ==, and only in the condition of an IF.", "="},
    {kAny, kStray, kAny, in::kBrackets, in::kParts, "The rest of a division is written MOD(a, b).", "%"},
    {kAny, kStray, kAny, in::kBrackets, in::kParts, "Both of two conditions are joined by AND or &&.", "&"},
    {kAny, kStray, kAny, in::kBrackets, in::kParts, "Either of two conditions is written with OR or ||.", "|"},
    {kAny, kStray, kAny, in::kBrackets, in::kParts,
     "A choice is written IF condition THEN value ELSE value.", "?"},
    {kNumber, kStray, kAny, in::kBrackets, in::kParts, "A number has one decimal point.", ".", {}, Touch::Before},
    {kAny, kStray, kNumber, in::kBrackets, in::kParts, "A number begins with a digit: 0.%n.", "."},
    {kAny, kStray, kAny, in::kBrackets, in::kParts, "A point may only be in a number.", "."},
    {kAny, kStray, kAny, in::kBrackets, in::kParts, "A modification is written ::=, ::+, ::-, ::* or ::/.", ":"},
    {kAny, kStray, kAny, in::kBrackets, in::kParts, "Expressions hold no texts between quotes.", "\""},
    {kAny, kStray, kAny, in::kBrackets, in::kParts, "Expressions hold no texts between quotes.", "'"},
    {kAny, kStray, kAny, in::kBrackets, in::kParts, "%a means nothing in an expression."},
    {kRelation, kRelation, kAny, in::kBrackets, in::kParts, "Not equal is written !=.", ">", "<"},

    // References, properties and interactions have shapes of their own.
    {kRefer, kAny, kAny, in::kBrackets, in::kParts, "A name is missing after $."},
    {kOpenSquare, kAny, kAny, in::kBrackets, in::kParts, "The name of a property is missing after [."},
    {kAny, kAny & ~kNone, kAny, in::kSquare, in::kParts, "[ ] holds the name of one property."},
    {kAny & ~kName, kOpenCurly, kAny, in::kBrackets, in::kParts,
     "An interaction begins with its verb, as in KILL{(class, condition)}."},
    {kNoValueEnd | kNumber | kClose | kCloseSquare | kCloseCurly, kModify, kAny, in::kBrackets, in::kParts,
     "Only a name can be modified, as in a ::+ 1."},
    {kAny, kAny & ~kNone, kAny, in::kCurly, in::kParts, kInteraction},

    // Words.
    {kNumber, kName, kAny, in::kBrackets, in::kParts, "An exponent has digits, as in 1e3.", "e", {}, Touch::Before},
    {kNumber, kName, kAny, in::kBrackets, in::kParts, "A product is written with a sign: %b*%a.", {}, {}, Touch::Before},
    {kAny, kName, kAny, in::kBrackets, in::kParts, kCapitals, "and"},
    {kAny, kName, kAny, in::kBrackets, in::kParts, kCapitals, "or"},
    {kName, kValueBegin, kAny, in::kBrackets, in::kParts, kCapitals, {}, "not"},

    // Commas.
    {kNumber, kComma, kNumber, in::kTop | in::kParentheses, in::kParts,
     "The decimal sign is a point: %b.%n.", ",", {}, Touch::BothSides},
    {kNoValueEnd, kComma, kAny, in::kBrackets, in::kParts, kMissingBefore},
    {kAny, kComma, kAny, in::kBrackets, in::kCondition, kCompares},
    {kAny, kComma, kAny, in::kIfCall, in::kParts, "IF takes three parts: IF(condition, value, value)."},
    {kAny, kComma, kAny, in::kTop | in::kParentheses, in::kCompared, "THEN is missing after the condition."},
    {kAny, kComma, kAny, in::kBrackets, in::kThenPart, "ELSE is missing: an IF has a value for either case."},
    {kAny, kComma, kAny, in::kBrackets, in::kParts, "Commas only separate the arguments of a call."},

    // The parts of an IF.
    {kIf, kAny, kAny, in::kBrackets, in::kParts, "A condition is missing after IF."},
    {kAny, kThen, kAny, in::kTop, in::kNoIf, "THEN comes after an IF and its condition."},
    {kAny, kElse, kAny, in::kTop, in::kNoIf, "ELSE comes after an IF and its THEN."},
    {kNoValueEnd & ~kNot, kThen | kElse, kAny, in::kBrackets, in::kParts, kMissingBefore},
    {kAny, kThen | kElse, kAny, in::kParentheses | in::kCall | in::kIfCall,
     in::kNoIf | in::kCondition | in::kCompared, "%o is not closed before %a."},
    {kAny, kThen, kAny, in::kBrackets, in::kCondition, kCompares},
    {kAny, kThen, kAny, in::kBrackets, in::kParts, "THEN comes after an IF and its condition."},
    {kAny, kElse, kAny, in::kBrackets, in::kCondition, kCompares},
    {kAny, kElse, kAny, in::kBrackets, in::kCompared, "THEN is missing after the condition."},
    {kAny, kElse, kAny, in::kBrackets, in::kParts, "ELSE comes after an IF and its THEN."},

    // Comparisons, and what joins them.
    {kNoValueEnd, kRelation, kAny, in::kBrackets, in::kParts, kMissingBefore},
    {kAny, kRelation, kAny, in::kBrackets, in::kCompared,
     "Comparisons form no chain: write a > b AND b > c."},
    {kAny, kRelation, kAny, in::kBrackets, in::kParts, kOnlyInIf},
    {kNot, kNot, kAny, in::kBrackets, in::kParts, "NOT of a NOT needs brackets: NOT (NOT a > 0)."},
    {kAny, kJoin | kNot, kAny, in::kBrackets, in::kNoIf | in::kThenPart | in::kElsePart, kJoinsOnlyInIf},
    {kValueEnd, kNot, kAny, in::kBrackets, in::kParts, "AND or OR is missing before NOT."},
    {kNoValueEnd, kJoin, kAny, in::kBrackets, in::kParts, "A comparison is missing before %a."},
    {kAny, kJoin, kAny, in::kBrackets, in::kParts, "AND and OR join comparisons, as in a > 0 AND b > 0."},

    // Closing brackets.
    {kOpen, kClose, kAny, in::kParentheses, in::kParts, "There is nothing between ( and )."},
    {kNoValueEnd, kClose | kCloseSquare | kCloseCurly, kAny, in::kBrackets, in::kParts, kMissingBefore},
    {kAny, kClose | kCloseSquare | kCloseCurly, kAny, in::kTop, in::kParts, "No bracket is open for this %a."},
    {kAny, kCloseSquare | kCloseCurly, kAny, in::kBrackets, in::kParts, "%o is closed by %c."},
    {kAny, kClose, kAny, in::kBrackets, in::kThenPart, "ELSE is missing: an IF has a value for either case."},
    {kAny, kClose, kAny, in::kIfCall, in::kParts, "IF takes three parts: IF(condition, value, value)."},
    {kAny, kClose, kAny, in::kBrackets, in::kCondition, kCompares},
    {kAny, kClose, kAny, in::kBrackets, in::kCompared, "THEN is missing after the condition."},

    // Operators without a value, and values without an operator.
    {kNoValueEnd, kSign | kFactor, kAny, in::kBrackets, in::kParts, kMissingBefore},
    {kValueEnd, kValueBegin, kAny, in::kBrackets, in::kParts, "An operator is missing between %b and %a."},

    // The end of the text.
    {kNone, kNone, kAny, in::kBrackets, in::kParts, "The expression is empty."},
    {kNot, kNone, kAny, in::kBrackets, in::kParts, "A comparison is missing after %b."},
    {kNoValueEnd, kNone, kAny, in::kBrackets, in::kParts, "A value is missing after %b."},
    {kAny, kNone, kAny, in::kTop, in::kCondition, kCompares},
    {kAny, kNone, kAny, in::kTop, in::kCompared, "THEN is missing after the condition."},
    {kAny, kNone, kAny, in::kBrackets, in::kThenPart, "ELSE is missing: an IF has a value for either case."},
    {kAny, kNone, kAny, in::kTop, in::kElsePart, "ELSE is missing: an IF has a value for either case."},
    {kAny, kNone, kAny, in::kCall, in::kParts, "The call of %f is not closed: ) is missing."},
    {kAny, kNone, kAny, in::kBrackets & ~in::kTop, in::kParts, "%o is not closed: %c is missing."},
    {kExceedance, kAny, kAny, in::kBrackets, in::kParts,
     "EXCEEDANCE_FREQUENCY takes one comparison in brackets."},

    {kAny, kAny, kAny, in::kBrackets, in::kParts, "%a does not fit here."},
};
// clang-format on

constexpr ForeignSign kForeignSigns[] = {
    {"\u00d7", "A product is written *."},
    {"\u00b7", "A product is written *."},
    {"\u22c5", "A product is written *."},
    {"\u00f7", "A quotient is written /."},
    {"\u2212", "A difference is written with the hyphen -."},
    {"\u2013", "A difference is written with the hyphen -."},
    {"\u00b2", "A square is written SQR(a)."},
    {"\u00b3", "A cube is written POW(a, 3)."},
    {"\u221a", "A square root is written SQRT(a)."},
    {"\u03c0", "The number pi is written PI()."},
    {"\u2264", "At most is written <=."},
    {"\u2265", "At least is written >=."},
    {"\u2260", "Not equal is written !=."},
};

}  // namespace

std::span<const FaultRule> FaultRules() {
  return kRules;
}

std::span<const ForeignSign> ForeignSigns() {
  return kForeignSigns;
}

}  // namespace tessal
