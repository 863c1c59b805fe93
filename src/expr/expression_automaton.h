// The shift-reduce parser: the automaton of the grammar over the tokens of one text. It behaves as LALR(1)
// tables with default reductions do, in what it accepts, in where it fails, and in its words.
#pragma once

namespace tessal {

class ParseState;

/// Parses the state's text. False when it is no expression; then the state has the failure.
bool RunAutomaton(ParseState& state);

}  // namespace tessal
