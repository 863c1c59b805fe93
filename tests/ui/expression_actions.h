// What a user does in the field of an expression, and what that shows.
#pragma once

#include <QString>
#include <string>

#include "ui/editor.h"

namespace tessal::test {

/// Presses keys in the field of an expression: letters, and keys between angle brackets such as "<Return>" or
/// "<Ctrl+Space>". They go where a user's would: to the list of completions while it is open.
std::string PressKeys(Editor& editor, const QString& label, const QString& keys);

/// What the pointer's tip says over a position.
std::string TipIn(Editor& editor, const QString& label, int position);

}  // namespace tessal::test
