// Reals as text, the same whatever the locale. Each form has its readers.
#pragma once

#include <string>

namespace tessal {

/// The shortest text that reads back to the same value, with an exponent wherever that is shorter; a whole
/// number has no point. Key-file text, logs and scripts use it.
std::string ShortestNumberText(double value);

/// The fewest digits that read back to the same value, with an exponent only where the number is very small
/// (below 0.0001) or very large (1e15 and more). Fields and their sections use it.
std::string PlainNumberText(double value);

/// As a stream with its default settings prints it: six significant digits. The symbol table uses it.
std::string SixDigitNumberText(double value);

}  // namespace tessal
