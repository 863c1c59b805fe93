// Template files that are broken by rules: with lines left out, doubled, mistyped and swapped, with comments,
// foreign keywords and foreign sections. For fuzz targets.
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "support/choices.h"

namespace tessal::fuzz {

using Lines = std::vector<std::string>;

/// Begins each comment that is put in.
inline constexpr std::string_view kComment = "//#";

/// A file in which a template lies between other sections. Each value in it has a mark, a number of six
/// digits that nothing else in it has.
struct BrokenFile {
  std::string text;
  Lines sections;  ///< those beside the template
};

BrokenFile MakeBrokenFile(Choices& choices);

/// The marks in a text.
Lines MarksIn(std::string_view text);

/// The lines of a text, without their ends.
Lines LinesOf(std::string_view text);

/// A line without its indentation.
std::string_view Trimmed(std::string_view line);

}  // namespace tessal::fuzz
