// Numbers on the command line, the same whatever the locale.
#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace tessal::cli {

/// The number that a whole text reads as, "nan" and "inf" among them; nothing for another text. One too large
/// for a double is infinite.
std::optional<double> NumberOf(std::string_view text);

/// The shortest text that reads back, for scripts; "nan" for every NaN.
std::string NumberText(double value);

/// All of them; nothing when one is no number.
std::optional<std::vector<double>> NumbersOf(const std::vector<std::string>& texts);

/// The pieces between commas; none of the empty text.
std::vector<std::string> SplitAtCommas(std::string_view text);

/// Arguments that read as negative numbers would be taken for options: this hides them from the option
/// parser, and `ShownNumber` gives the text back.
std::string HiddenNumber(const std::string& argument);
std::string ShownNumber(const std::string& argument);

}  // namespace tessal::cli
