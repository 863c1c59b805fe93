// The words of the template format: keywords, and the names of sections. A name that ends in a prefix is
// followed by a number from 1.
#pragma once

#include <string_view>

namespace tessal {

namespace key {
// Shared by all elements.
inline constexpr std::string_view kSymbol = "SYMBOL";
inline constexpr std::string_view kId = "ID";
inline constexpr std::string_view kDescription = "DESCRIPTION";
inline constexpr std::string_view kOnlineHelp = "ONLINE_HELP";
inline constexpr std::string_view kDocumentation = "DOCUMENTATION";
inline constexpr std::string_view kUnqType = "UNQ_TYPE";
inline constexpr std::string_view kUnqUnit = "UNQ_UNIT";
// Values and their place in the water body.
inline constexpr std::string_view kScope = "SCOPE";
inline constexpr std::string_view kTransport = "TRANSPORT";
inline constexpr std::string_view kSpatialVariation = "SPATIAL_VARIATION";
inline constexpr std::string_view kUnit = "UNIT";
inline constexpr std::string_view kDefaultValue = "DEFAULT_VALUE";
inline constexpr std::string_view kMinValue = "MIN_VALUE";
inline constexpr std::string_view kMaxValue = "MAX_VALUE";
inline constexpr std::string_view kIsUserSpecified = "IS_USER_SPECIFIED";
inline constexpr std::string_view kBuiltInId = "BUILT_IN_ID";
// Expressions.
inline constexpr std::string_view kOutput = "OUTPUT";
inline constexpr std::string_view kProcessType = "PROCESS_TYPE";
inline constexpr std::string_view kExpression = "EXPRESSION";
inline constexpr std::string_view kControlId = "CONTROLID";
inline constexpr std::string_view kControlValue = "CONTROLVALUE";
inline constexpr std::string_view kFormat = "FORMAT";
inline constexpr std::string_view kExpressionType = "EXPRESSION_TYPE";
inline constexpr std::string_view kExpressionHorizontalSpeed = "EXPRESSION_HORIZONTAL_SPEED";
inline constexpr std::string_view kExpressionHorizontalDirection = "EXPRESSION_HORIZONTAL_DIRECTION";
inline constexpr std::string_view kExpressionVerticalSpeed = "EXPRESSION_VERTICAL_SPEED";
// Particle classes and their searches.
inline constexpr std::string_view kName = "NAME";
inline constexpr std::string_view kSpecie = "SPECIE";
inline constexpr std::string_view kProjectionTime = "PROJECTION_TIME";
inline constexpr std::string_view kFieldOfView = "FIELD_OF_VIEW";
inline constexpr std::string_view kFunctionId = "FUNCTION_ID";
inline constexpr std::string_view kVariableId = "VARIABLE_ID";
inline constexpr std::string_view kSpecieId = "SPECIE_ID";
inline constexpr std::string_view kRadius = "RADIUS";
inline constexpr std::string_view kDimension = "DIMENSION";
inline constexpr std::string_view kPurpose = "PURPOSE";
inline constexpr std::string_view kFramework = "FRAMEWORK";
inline constexpr std::string_view kProperty = "PROPERTY";
inline constexpr std::string_view kMath = "MATH";
inline constexpr std::string_view kLookFor = "LOOKFOR";
// Settings.
inline constexpr std::string_view kTessalVersion = "TESSAL_VERSION";
inline constexpr std::string_view kParserVersion = "PARSER_VERSION";
inline constexpr std::string_view kDocumentRevision = "DOCUMENT_REVISION";
inline constexpr std::string_view kRandSeed = "RANDSEED";
inline constexpr std::string_view kDebugLevel = "DEBUG_LEVEL";
inline constexpr std::string_view kDebugLog = "DEBUG_LOG";
inline constexpr std::string_view kRandomParticleDir = "RANDOM_PARTICLE_DIR";
inline constexpr std::string_view kBuildSpatialTree = "BUILD_SPATIAL_TREE";
inline constexpr std::string_view kChecksum = "CHECKSUM";
inline constexpr std::string_view kOptimise = "OPTIMISE";
inline constexpr std::string_view kTrigonometrics = "TRIGONOMETRICS";
// User functions.
inline constexpr std::string_view kPublicName = "PUBLICNAME";
inline constexpr std::string_view kParameters = "PARAMETERS";
inline constexpr std::string_view kUsedAs = "USED_AS";
inline constexpr std::string_view kDll = "DLL";
inline constexpr std::string_view kEntryPoint = "ENTRYPOINT";
// Visibility groups.
inline constexpr std::string_view kGroups = "GROUPS";
inline constexpr std::string_view kGroup = "GROUP";
inline constexpr std::string_view kLevels = "LEVELS";
inline constexpr std::string_view kLevel = "LEVEL";
inline constexpr std::string_view kItemCount = "ITEMCOUNT";
inline constexpr std::string_view kItems = "ITEMS";
}  // namespace key

namespace section {
// Top level and settings.
inline constexpr std::string_view kTarget = "TESSAL_SETUP";
inline constexpr std::string_view kMisc = "MISC";
inline constexpr std::string_view kExternalFunctions = "EXTERNAL_FUNCTIONS";
inline constexpr std::string_view kExternalFunctionPrefix = "EXTERNAL_FUNCTION_";
inline constexpr std::string_view kVisibilityGroups = "VISIBILITY_GROUPS";
inline constexpr std::string_view kGroupPrefix = "GROUP_";
inline constexpr std::string_view kLevelPrefix = "LEVEL_";
// Collections of the template.
inline constexpr std::string_view kStateVariables = "STATE_VARIABLES";
inline constexpr std::string_view kStateVariablePrefix = "STATE_VARIABLE_";
inline constexpr std::string_view kConstants = "CONSTANTS";
inline constexpr std::string_view kConstantPrefix = "CONSTANT_";
inline constexpr std::string_view kForcings = "FORCINGS";
inline constexpr std::string_view kForcingPrefix = "FORCING_";
inline constexpr std::string_view kAuxiliaryVariables = "AUXILIARY_VARIABLES";
inline constexpr std::string_view kAuxiliaryVariablePrefix = "AUXILIARY_VARIABLE_";
inline constexpr std::string_view kProcesses = "PROCESSES";
inline constexpr std::string_view kProcessPrefix = "PROCESS_";
inline constexpr std::string_view kDerivedOutputs = "DERIVED_OUTPUTS";
inline constexpr std::string_view kDerivedOutputPrefix = "DERIVED_OUTPUT_";
inline constexpr std::string_view kStateVariableEquations = "STATE_VARIABLE_EQUATIONS";
inline constexpr std::string_view kStateVariableEquationPrefix = "STATE_VARIABLE_EQUATION_";
// Particle classes.
inline constexpr std::string_view kLagrange = "LAGRANGE";
inline constexpr std::string_view kSpeciePrefix = "SPECIE_";
inline constexpr std::string_view kSpatialFunctions = "SPATIAL_FUNCTIONS";
inline constexpr std::string_view kSpatialFunctionPrefix = "SPATIAL_FUNCTION_";
inline constexpr std::string_view kArithmeticalExpressions = "ARITHMETICAL_EXPRESSIONS";
inline constexpr std::string_view kArithmeticalExpressionPrefix = "ARITHMETICAL_EXPRESSION_";
inline constexpr std::string_view kLagrangeEquations = "LAGRANGE_STATE_VARIABLE_EQUATIONS";
inline constexpr std::string_view kHorizontalVectors = "HORIZONTAL_VECTORS_SECTION";
inline constexpr std::string_view kHorizontalVectorPrefix = "HORIZONTAL_VECTOR_";
inline constexpr std::string_view kVerticalSpeedEquation = "VERTICAL_SPEED_EQUATION";
}  // namespace section

}  // namespace tessal
