// The numbers of the controls that more than one place names. They are the controls' object names too.
#pragma once

namespace tessal::control_id {

inline constexpr int kKeypad = 1023;
inline constexpr int kBrowse = 1021;
inline constexpr int kOnlineHelp = 1083;
inline constexpr int kDescription = 1074;
inline constexpr int kDocumentation = 1076;
inline constexpr int kNoView = 1086;
inline constexpr int kReferencedIn = 1094;
inline constexpr int kSymbol = 1097;
inline constexpr int kOverviewBox = 1102;
inline constexpr int kErrorList = 1103;
inline constexpr int kList = 1103;
inline constexpr int kListCommands = 678;
inline constexpr int kRightPane = 1119;
inline constexpr int kTitle = 1125;
inline constexpr int kTree = 1127;
inline constexpr int kView = 1129;
inline constexpr int kNavigation = 679;

}  // namespace tessal::control_id
