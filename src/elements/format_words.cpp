#include "elements/format_words.h"

#include <algorithm>
#include <iterator>

#include "elements/choices.h"
#include "expr/builtin_reference.h"
#include "keyfile/keywords.h"

namespace tessal {

namespace {

struct FieldRow {
  std::string_view label;    ///< empty for a keyword that no form shows
  std::string_view keyword;  ///< empty where the file has none, or one that a row above has
  std::string_view meaning;
};

constexpr FieldRow kFields[] = {
    // All elements.
    {"Symbol", key::kSymbol,
     "The name by which expressions use the element: letters, digits and underscores. A change renames it."},
    {"Description", key::kDescription, "What the element is, in words for readers of the documentation."},
    {"Online help", key::kOnlineHelp, "An address or a text of further help, for users of the template."},
    {"Documentation", key::kDocumentation,
     "A file that documents the element, or the words that say where it is described."},
    {"Documenation", "", "A file that documents the class, or the words that say where it is described."},
    {"Referenced in", "", "The elements whose expressions use this one. A right click on a name goes to it."},
    {"Unit", key::kUnit, "The unit, as text. Where the type of unit brings one along, it is locked."},
    {"Unq type", key::kUnqType,
     "The type of the unit: what kind of quantity it measures. It brings its unit along."},
    {"Unq unit", key::kUnqUnit, "The number of the unit within its type."},
    {"Default value", key::kDefaultValue, "The value that holds as long as a run gives no other."},
    {"Minimum value", key::kMinValue, "The lower bound: the default value may not be below it."},
    {"Maximum value", key::kMaxValue, "The upper bound: the default value may not be above it."},
    {"Expression", key::kExpression,
     "What computes the value. A state variable's is its rate of change, made of processes."},
    // Where an element lives.
    {"Scope", key::kScope, "The layer of the water body in which the element lives."},
    {"Transport", key::kTransport, "Whether the water moves it."},
    {"Spatial var.", key::kSpatialVariation,
     "In which directions the value may differ from place to place. What does not vary cannot use what "
     "does."},
    // Inputs.
    {"User specified", key::kIsUserSpecified,
     "Whether the value is the user's own, or one that the simulation engine supplies."},
    {"Built in ID", key::kBuiltInId,
     "The quantity that the simulation engine supplies; it brings unit, scope and bounds along."},
    // What is computed.
    {"Output", key::kOutput, "Whether the values can be written to the results."},
    {"Process type", key::kProcessType, "What the process does with matter."},
    {"Control ID", key::kControlId,
     "A number by which the simulation engine controls the process; -1 for none."},
    {"Control value", key::kControlValue, "The value that goes with the control ID."},
    {"Format", key::kFormat, "How the output is made of the values of the time steps."},
    // Settings.
    {"Tessal version", key::kTessalVersion, "The version of the program that saved the template."},
    {"Parser version", key::kParserVersion, "The version of the expression parser that saved the template."},
    {"Template revision", key::kDocumentRevision,
     "How often the template has been saved; -1 for one that was never counted."},
    {"Rand. seed", key::kRandSeed,
     "Where the random numbers of a run start: the same seed gives the same numbers."},
    {"Debug level", key::kDebugLevel, "How much the simulation engine writes to its log."},
    {"Debug log", key::kDebugLog, "The file of the simulation engine's log."},
    {"ABM: random bearing", key::kRandomParticleDir, "Whether particles start in a random direction."},
    {"ABM: search tree", key::kBuildSpatialTree,
     "Whether the engine keeps a tree of places for searches. Searches among particles need it."},
    {"Checksum", key::kChecksum, "A checksum of the template, as text."},
    {"Optimise expressions", key::kOptimise, "Whether the engine simplifies expressions before a run."},
    {"Angle Unit", key::kTrigonometrics, "The unit of angles in the trigonometric functions of expressions."},
    // Functions of plug-ins.
    {"Public name", key::kPublicName, "The name by which expressions call the function."},
    {"Parameter count", key::kParameters, "How many arguments the function takes."},
    {"Used as", key::kUsedAs, "When the function is called."},
    {"DLL", key::kDll, "The library that holds the function."},
    {"Entry point", key::kEntryPoint, "The function's name in the library."},
    // Particles.
    {"Position projection", key::kProjectionTime,
     "The time over which the place of a particle is projected, in seconds."},
    {"Field view", key::kFieldOfView, "The angle within which a particle sees, in degrees."},
    {"Expression type", key::kExpressionType,
     "Whether state variables may use the expression: they are made of processes."},
    {"Direction", key::kExpressionHorizontalDirection,
     "Where the particle moves to, in degrees clockwise from north."},
    {"Speed", key::kExpressionHorizontalSpeed, "How fast the particle moves."},
    // Searches.
    {"Purpose", key::kPurpose, "What the search gives of what it finds."},
    {"Framework", key::kFramework, "What is searched: the grid of the water, or the particles."},
    {"Based on variable", key::kVariableId, "The variable that is looked for."},
    {"Owner", key::kSpecieId, "The class of particles that the search belongs to."},
    {"Based on property", key::kProperty, "A property of particles to look for, in the place of a variable."},
    {"Dimension", key::kDimension, "Whether the search goes over an area or through a volume."},
    {"Range/radius", key::kRadius, "How far the search goes around the particle; above 0."},
    {"Function", key::kMath, "How the values that are found become one number."},
    {"Consider", key::kLookFor, "Which particles are looked at."},
    // What no form shows.
    {"", key::kId, "The number of the element; a save numbers them all, in the order of declaration."},
    {"", key::kName, "The symbol of the particle class."},
    {"", key::kSpecie, "The number of the particle class that the member belongs to, from 1."},
    {"", key::kFunctionId, "A number that the simulation engine knows the search by."},
    {"", key::kExpressionVerticalSpeed, "How fast the particle moves downward."},
    {"", key::kGroups, "How many visibility groups follow."},
    {"", key::kGroup, "The name of the visibility group."},
    {"", key::kLevels, "How many levels of the group follow."},
    {"", key::kLevel, "The name of the level."},
    {"", key::kItemCount, "How many elements the level shows."},
    {"", key::kItems, "The elements that the level shows, by their numbers in the symbol table, from 1."},
};

struct ChoiceRow {
  std::string_view label;
  std::string_view choice;
  std::string_view meaning;
};

constexpr std::string_view kUnitType = "Unq type";
constexpr std::string_view kBuiltIn = "Built in ID";

constexpr ChoiceRow kChoices[] = {
    {"Scope", "WS", "Water surface."},
    {"Scope", "WC", "Water column."},
    {"Scope", "WB", "Water bottom."},
    {"Scope", "SED", "Sediment."},
    {"Scope", "NOT_SPECIFIED", "No layer: the whole model, or wherever the element is used."},

    {"Transport", "ADVECTION_DISPERSION", "The water carries it along and mixes it."},
    {"Transport", "FIXED", "It stays where it is."},
    {"Transport", "USER_SPECIFIED", "The movements of the particle class say where it goes."},

    {"Spatial var.", "NONE", "One value for the whole model."},
    {"Spatial var.", "HORIZONTAL", "A value for each cell of the grid, the same in all its layers."},
    {"Spatial var.", "HORIZONTAL_AND_VERTICAL", "A value for each layer of each cell of the grid."},
    {"Spatial var.", "PER_INDIVIDUAL", "A value for each particle."},
    {"Spatial var.", "PER_SPECIE", "One value for all particles of the class."},

    {"User specified", "YES", "The value is the user's own."},
    {"User specified", "NO", "The simulation engine supplies the value."},
    {kBuiltIn, kUserDefined, "No quantity of the engine: the value is the user's own."},

    {"Output", "YES", "The values can be written to the results."},
    {"Output", "NO", "The values are used only in other expressions."},
    {"Process type", "SETTLING", "Matter sinks from layer to layer."},
    {"Process type", "TRANSFORMATION", "Matter changes from one state variable to another at its place."},
    {"Process type", "BUOYANCY", "Matter rises from layer to layer."},
    {"Format", "SMOOTHING", "The values smoothed over time."},
    {"Format", "INSTANTANEOUS", "The value of the moment."},
    {"Format", "ACCUMULATED_IN_TIME", "The sum of the values over time."},
    {"Format", "SUMMARIZED_WATER_COLUMN", "The sum of the values over the water column."},

    {"Debug level", "No debug information", "The engine writes no log."},
    {"Debug level", "Debug level 1", "The shortest log."},
    {"Debug level", "Debug level 2", "More than level 1."},
    {"Debug level", "Debug level 3", "More than level 2."},
    {"Debug level", "Debug level 4", "More than level 3."},
    {"Debug level", "Debug level 5", "More than level 4."},
    {"Debug level", "Debug level 6", "The longest log."},
    {"ABM: random bearing", "YES", "Particles start in a random direction."},
    {"ABM: random bearing", "NO", "Particles start without one."},
    {"ABM: search tree", "YES", "The engine keeps a tree of places: some search is among particles."},
    {"ABM: search tree", "NO", "The engine keeps no tree: no search is among particles."},
    {"Optimise expressions", "YES", "Expressions are simplified before a run."},
    {"Optimise expressions", "NO", "Expressions are computed as they are written."},
    {"Angle Unit", "Radians", "A full turn is 2 pi."},
    {"Angle Unit", "Degree", "A full turn is 360."},

    {"Parameter count", "none", "It is called without arguments."},
    {"Parameter count", "1", "It takes one argument."},
    {"Parameter count", "2", "It takes two arguments."},
    {"Parameter count", "3", "It takes three arguments."},
    {"Parameter count", "4", "It takes four arguments."},
    {"Parameter count", "5", "It takes five arguments."},
    {"Parameter count", "6", "It takes six arguments."},
    {"Used as", "AS_MATH_FUNC", "Called by expressions, under its public name."},
    {"Used as", "ON_INITSTEP", "Called by the engine when a time step begins."},
    {"Used as", "ON_FINALISESTEP", "Called by the engine when a time step ends."},
    {"Used as", "ON_INITLOCATION", "Called by the engine when it begins with a location."},
    {"Used as", "ON_SETLOCATION", "Called by the engine when it sets a location."},
    {"Used as", "ON_SETVOLUME", "Called by the engine when it sets a volume."},
    {"Used as", "ON_SETSPECIES", "Called by the engine when it sets the particle classes."},

    {"Expression type", "Auxiliary variable", "An intermediate value, for other expressions of the class."},
    {"Expression type", "Process", "A rate, for the state variables of the class too."},

    {"Purpose", "DIRECTION", "The direction in which it lies."},
    {"Purpose", "MAGNITUDE", "The value itself."},
    {"Purpose", "DISTANCE", "How far away it is."},
    {"Purpose", "PARTICLE", "Which particle it is."},
    {"Purpose", "Oilspill(deprecated)", "Of old templates about oil; not for new ones."},
    {"Framework", "EULER", "The grid of the water: state variables, constants and forcings of the template."},
    {"Framework", "LAGRANGE", "The particles, and what each of them carries."},
    {"Based on variable", "NONE", "No variable: particles can be looked for by a property."},
    {"Based on property", "NONE", "No property: a variable is looked for."},
    {"Based on property", "XPOS", "The place of the particle along the first axis."},
    {"Based on property", "YPOS", "The place of the particle along the second axis."},
    {"Based on property", "ZPOS", "The place of the particle along the vertical axis."},
    {"Based on property", "AGE", "The age of the particle."},
    {"Based on property", "HDIR", "The direction in which the particle moves."},
    {"Based on property", "HSPEED", "The speed of the particle in the horizontal."},
    {"Based on property", "VSPEED", "The speed of the particle in the vertical."},
    {"Based on property", "DISTANCE", "The distance of the particle from the one that searches."},
    {"Dimension", "2", "Over an area, in the horizontal."},
    {"Dimension", "3", "Through a volume."},
    {"Function", "NONE", "None yet: a search needs one."},
    {"Function", "MIN", "The smallest value that is found."},
    {"Function", "MAX", "The largest value that is found."},
    {"Function", "MIN_ABSOLUTE", "The value closest to 0, whatever its sign."},
    {"Function", "MAX_ABSOLUTE", "The value farthest from 0, whatever its sign."},
    {"Function", "COUNT", "How many are found."},
    {"Function", "AVERAGE", "The mean of what is found."},
    {"Function", "SUM", "The sum of what is found."},
    {"Function", "SUM_NORM", "The sum of what is found, normalised."},
    {"Consider", "OWN SPECIE", "The particles of the search's own class."},
    {"Consider", "ANY PARTICLE", "The particles of all classes."},
};

constexpr SectionWord kSections[] = {
    {section::kTarget, "The template."},
    {section::kMisc, "The settings of the template."},
    {section::kExternalFunctions, "Functions of libraries of the user's own."},
    {section::kExternalFunctionPrefix, "One function of a library of the user's own."},
    {section::kVisibilityGroups, "Who sees which elements."},
    {section::kGroupPrefix, "One visibility group, with its levels."},
    {section::kLevelPrefix, "One level of a visibility group: some elements."},
    {section::kStateVariables, "What the simulation engine follows through time."},
    {section::kStateVariablePrefix, "One state variable; its equation is in a section of its own."},
    {section::kConstants, "Values that stay the same during a run."},
    {section::kConstantPrefix, "One constant."},
    {section::kForcings, "Inputs that vary in time or space."},
    {section::kForcingPrefix, "One forcing."},
    {section::kAuxiliaryVariables, "Values that are computed once and used in several expressions."},
    {section::kAuxiliaryVariablePrefix, "One auxiliary."},
    {section::kProcesses, "The rates that change state variables."},
    {section::kProcessPrefix, "One process."},
    {section::kDerivedOutputs, "Values that are computed only to be written to the results."},
    {section::kDerivedOutputPrefix, "One derived output."},
    {section::kStateVariableEquations, "The equations of the state variables, in their order."},
    {section::kStateVariableEquationPrefix, "The equation of one state variable, under its symbol."},
    {section::kLagrange, "The particle classes."},
    {section::kSpeciePrefix, "One particle class, with its members."},
    {section::kSpatialFunctions, "What particles find out about their surroundings."},
    {section::kSpatialFunctionPrefix, "One search of a particle class."},
    {section::kArithmeticalExpressions, "The auxiliaries and processes of a particle class."},
    {section::kArithmeticalExpressionPrefix, "One expression of a particle class."},
    {section::kLagrangeEquations,
     "The equations of the state variables of a particle class, in their order."},
    {section::kHorizontalVectors, "The movements of a particle over the horizontal; they add up."},
    {section::kHorizontalVectorPrefix, "One movement over the horizontal."},
    {section::kVerticalSpeedEquation, "The downward movement of a particle."},
};

/// The unit that a type brings along, whatever family of elements it is of.
std::string MeaningOfUnitType(std::string_view type) {
  if (type == kUserDefined) return "No type: the unit is typed by hand.";
  for (const UnitTypes* types : {&kStateVariableUnitTypes, &kInputUnitTypes, &kParticleUnitTypes}) {
    for (const UnitTypeRow& row : types->rows) {
      if (row.display == type) return "Brings the unit \"" + std::string(row.unit) + "\" along.";
    }
  }
  return {};
}

const FieldRow* RowOfKeyword(std::string_view keyword) {
  const auto* hit = std::find_if(std::begin(kFields), std::end(kFields), [keyword](const FieldRow& row) {
    return !keyword.empty() && row.keyword == keyword;
  });
  return hit == std::end(kFields) ? nullptr : &*hit;
}

}  // namespace

std::string_view MeaningOfField(std::string_view label) {
  const auto* hit = std::find_if(std::begin(kFields), std::end(kFields), [label](const FieldRow& row) {
    return !label.empty() && row.label == label;
  });
  return hit == std::end(kFields) ? std::string_view() : hit->meaning;
}

std::string_view MeaningOfKeyword(std::string_view keyword) {
  const FieldRow* row = RowOfKeyword(keyword);
  return row == nullptr ? std::string_view() : row->meaning;
}

std::string_view FieldOfKeyword(std::string_view keyword) {
  const FieldRow* row = RowOfKeyword(keyword);
  return row == nullptr ? std::string_view() : row->label;
}

std::span<const SectionWord> SectionWords() {
  return kSections;
}

const SectionWord* WordOfSection(std::string_view name) {
  const std::size_t number = name.find_last_not_of("0123456789") + 1;
  const std::string_view prefix = name.substr(0, number);
  const bool hasNumber = number < name.size();
  const auto* hit = std::find_if(std::begin(kSections), std::end(kSections), [&](const SectionWord& row) {
    return row.name == prefix && row.IsNumbered() == hasNumber;
  });
  return hit == std::end(kSections) ? nullptr : &*hit;
}

std::string MeaningOfChoice(std::string_view label, std::string_view choice) {
  const auto* hit = std::find_if(std::begin(kChoices), std::end(kChoices), [&](const ChoiceRow& row) {
    return row.label == label && row.choice == choice;
  });
  if (hit != std::end(kChoices)) return std::string(hit->meaning);
  if (label == kUnitType) return MeaningOfUnitType(choice);
  if (label != kBuiltIn) return {};
  const BuiltinReference* builtin = ReferenceOfBuiltin(choice);
  return builtin == nullptr ? std::string() : std::string(builtin->purpose);
}

}  // namespace tessal
