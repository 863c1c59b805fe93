// What the functions of the catalogue are for, in words: purpose, arguments, result, units and literature.
// The tool's descriptions, the pages on functions and the hints of the editor are made from it.
//
// Units are texts that a program can read (`RuleOfUnit`): a unit in the spelling of UDUNITS ("1" for a plain
// number, "degC", "umol/kg"), "any" where every unit will do, "as x" for the unit of the argument x, "as x^2"
// for a power of it (the exponent may be another argument: "as x^y"), and "unknown" where the simulation
// engine alone knows.
#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace tessal {

struct ArgumentReference {
  std::string_view name;     ///< the catalogue's, as messages show it
  std::string_view meaning;  ///< a phrase, with the range where there is one
  std::string_view unit;
};

struct FunctionReference {
  std::string_view name;     ///< in upper case
  std::string_view purpose;  ///< one or two sentences
  std::span<const ArgumentReference> arguments;
  std::string_view result;  ///< a phrase
  std::string_view resultUnit;
  std::string_view range;   ///< of the result; empty for any number
  std::string_view source;  ///< of the formula; empty where there is none
};

/// Functions of one subject.
struct FunctionGroup {
  std::string_view title;
  std::span<const FunctionReference> functions;
};

/// All functions by subject: each of the catalogue's is in one group. The catalogue's own order is that of
/// `Functions()`.
std::span<const FunctionGroup> FunctionGroups();

/// The reference of a name in any case, or none; the rows live as long as the process.
const FunctionReference* ReferenceOfFunction(std::string_view name);
/// The subject that a function belongs to.
const FunctionGroup& GroupOfFunction(const FunctionReference& function);

/// The sources of the formulae that an option function chooses from, option 1 first; empty for any other.
std::vector<std::string_view> FormulaeOf(const FunctionReference& function);

/// A call with the names of the arguments, "ARCTAN2(x, y)".
std::string CallText(const FunctionReference& function);

/// What a unit of the reference says, for a check of units.
struct UnitRule {
  enum class Kind : std::uint8_t {
    Fixed,       ///< `unit`
    OfArgument,  ///< that of an argument, raised to a power
    Any,
    Unknown
  };
  Kind kind = Kind::Unknown;
  std::string_view unit = {};  ///< with `Fixed`; "1" for a plain number
  std::size_t argument = 0;    ///< with `OfArgument`: its place, from 0
  double power = 1;            ///< with `OfArgument`
  /// The argument whose value is the power, in the place of `power`.
  std::optional<std::size_t> powerArgument = {};

  bool operator==(const UnitRule&) const = default;
};

/// The rule of a unit text of that function, of an argument's or the result's. None for a text that names no
/// argument, or a power that is no number.
std::optional<UnitRule> RuleOfUnit(const FunctionReference& function, std::string_view unit);

/// The unit in words for a reader: "the unit of x, squared"; the text itself for a fixed one.
std::string UnitInWords(const FunctionReference& function, std::string_view unit);

/// Those of the names that are most like a mistyped one, the nearest first; the letters' case does not count.
/// Empty where none is near.
std::vector<std::string_view> NearestNames(std::string_view typed, std::span<const std::string_view> names);

}  // namespace tessal
