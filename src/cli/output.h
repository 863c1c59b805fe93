// Where the tool's words go: results to standard output, diagnostics to standard error.
#pragma once

#include <new>
#include <optional>
#include <string>
#include <string_view>

namespace tessal::cli {

/// What every command ends with.
enum ExitCode : int {
  kFine = 0,
  kContentFault = 1,  ///< findings, differences, an expression that does not parse
  kCallFault = 2      ///< a wrong call, or a file that cannot be read or written
};

/// The worse of two.
ExitCode Worse(ExitCode left, ExitCode right);

/// Adds to the result. It is written when the command has ended, or when much has come together.
void Print(std::string_view text);
void PrintLine(std::string_view text);

/// Writes what is left of the result. False, with a diagnostic, when standard output takes no more; a closed
/// pipe is no failure.
bool FlushOutput();

/// One line on standard error, with the tool's name.
void Complain(std::string_view text);

/// The same when there is not enough memory; takes none.
void ComplainOfMemory();

/// While it lives, an allocation that fails ends the tool at once, with that line. It is for libraries that
/// lose the exception: the JSON library needs memory to release a value, and the help is cut without a word.
/// Nothing may be under way that has to be cleared up.
class EndsWithoutMemory final {
 public:
  EndsWithoutMemory();
  EndsWithoutMemory(const EndsWithoutMemory&) = delete;
  EndsWithoutMemory& operator=(const EndsWithoutMemory&) = delete;
  ~EndsWithoutMemory() { std::set_new_handler(former); }

 private:
  std::new_handler former;
};

/// The lines of standard input, one at a time: those that are there can be answered before the next is read.
class InputLines final {
 public:
  /// The next line, without its line feed; nothing at the end. Raises as `ReadStandardInput` does.
  std::optional<std::string> Next();
  /// Whether the next line is here already, at least its start: it will be answered in one go with this one.
  bool HasMore() const { return start < buffered.size(); }

 private:
  std::string buffered;
  std::size_t start = 0;
  bool ended = false;
};

/// The whole of standard input. Raises `std::system_error` when it cannot be read to its end.
std::string ReadStandardInput();

/// Whether the result goes to a terminal that wants colour.
bool WantsColour();

/// The word in the colour of its severity (1 to 4), where colour is wanted.
std::string Coloured(std::string_view word, unsigned level);

/// A text made to fit on one line: control characters, line feeds and tabs among them, become blanks.
std::string OnOneLine(std::string_view text);

/// A text as a terminal may have it: control characters but line ends and tabs become blanks, those of ISO
/// 6429 as single bytes and in UTF-8 among them. The same text where standard output is no terminal.
std::string ForTerminal(std::string text);

/// A text without its trailing line feed.
std::string_view WithoutLineFeed(std::string_view text);

}  // namespace tessal::cli
