// Expectations as text. A file of cases says what goes in and, after each call, what comes out; a listing is
// one whole text in a file of its own. Both lie below tests/, and both are written again from what the
// program does when TESSAL_BLESS is set (`./dev test --bless`): the diff of the file is then the review.
//
// A file of cases:
//
//     # What comes before the first case is a remark.
//     == The title of a case
//     input, as many lines as it has
//     > call with its words
//     what the call gives, line by line
//     > another call
//
// Where a call is a command line, the prompt is that of a shell, `$ `.
//
// Empty lines only separate. In input and output a backslash begins what a line cannot show: `\\`, `\t`,
// `\r`, `\xHH`,
// `\s` for a blank at a line's end, `\>`, `\=` and `\$` at its start; a lone backslash is an empty line, and
// `\c` ends a text that has no line feed at its end.
#pragma once

#include <functional>
#include <string>
#include <string_view>
#include <vector>

namespace tessal::test {

struct CaseCall {
  std::string prompt;
  std::string words;     ///< what follows the prompt
  std::string expected;  ///< with its line ends
  int line = 0;          ///< of the prompt in the file, from 1
};

struct Case {
  std::string title;
  std::string input;  ///< without the last line's end
  std::vector<CaseCall> calls;
  int line = 0;
};

/// Answers one call of a case.
using Answer = std::function<std::string(const CaseCall&)>;

/// Runs all calls of all cases of a file. Each case begins with a fresh answer, so that an answer may keep
/// state from call to call.
void RunCases(std::string_view file, const std::function<Answer(const Case&)>& begin);

/// One line for each line of a text: the line, an arrow, and the lines of its answer with bars between them;
/// the line alone when the answer is empty.
std::string AnswerEach(std::string_view lines, const std::function<std::string(const std::string&)>& answer);

/// Compares a page that people read with the file that holds it byte for byte.
void ExpectPage(std::string_view file, std::string_view actual);

/// Compares a text with the file that holds it.
void ExpectListing(std::string_view file, std::string_view actual);

/// Whether expectations are written instead of compared.
bool Blessing();

/// A text as case files and listings show it: escaped, each line ended.
std::string ShownText(std::string_view text);

}  // namespace tessal::test
