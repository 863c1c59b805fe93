// The shift-reduce parser: the automaton of the grammar over the tokens of one text.
#pragma once

namespace tessal {

class ParseState;

/// Parses the state's text. False when it is no expression; then the state has the failure.
bool RunAutomaton(ParseState& state);

}  // namespace tessal
