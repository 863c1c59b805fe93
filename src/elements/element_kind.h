// What an element is: the numbers that the symbol table, the tree and the change hints share.
#pragma once

#include <cstdint>
#include <string_view>

namespace tessal {

namespace kind {
inline constexpr std::int32_t kNone = 0;
inline constexpr std::int32_t kStateVariable = 1;
inline constexpr std::int32_t kConstant = 2;
inline constexpr std::int32_t kForcing = 3;
inline constexpr std::int32_t kAuxiliary = 4;
inline constexpr std::int32_t kProcess = 5;
inline constexpr std::int32_t kDerivedOutput = 6;
inline constexpr std::int32_t kSpecie = 7;
inline constexpr std::int32_t kSpecieStateVariable = 8;
inline constexpr std::int32_t kSpecieConstant = 9;
inline constexpr std::int32_t kSpecieForcing = 10;
inline constexpr std::int32_t kSpatialFunction = 11;
inline constexpr std::int32_t kArithmeticExpression = 12;
inline constexpr std::int32_t kHorizontalVector = 13;
inline constexpr std::int32_t kVerticalEquation = 14;
inline constexpr std::int32_t kMiscellaneous = 15;
inline constexpr std::int32_t kExternalFunction = 16;
inline constexpr std::int32_t kVisibility = 17;
inline constexpr std::int32_t kVisibilityGroup = 18;
inline constexpr std::int32_t kVisibilityGroups = 19;
inline constexpr std::int32_t kUnknown = 20;
inline constexpr std::int32_t kRoot = 21;
inline constexpr std::int32_t kStateVariableList = 22;
inline constexpr std::int32_t kConstantList = 23;
inline constexpr std::int32_t kForcingList = 24;
inline constexpr std::int32_t kAuxiliaryList = 25;
inline constexpr std::int32_t kProcessList = 26;
inline constexpr std::int32_t kDerivedOutputList = 27;
inline constexpr std::int32_t kSpecieStateVariableList = 28;
inline constexpr std::int32_t kSpecieConstantList = 29;
inline constexpr std::int32_t kSpecieForcingList = 30;
inline constexpr std::int32_t kSpatialFunctionList = 31;
inline constexpr std::int32_t kArithmeticExpressionList = 32;
inline constexpr std::int32_t kHorizontalVectorList = 33;
inline constexpr std::int32_t kVerticalEquationList = 34;
}  // namespace kind

/// The text that lists and messages use; "unknown" for a number without a row.
std::string_view KindText(std::int32_t kind);

}  // namespace tessal
