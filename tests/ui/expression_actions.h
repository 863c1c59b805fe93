// What a user does in the field of an expression, and what that shows.
#pragma once

#include <QString>
#include <string>

#include "ui/editor.h"

namespace tessal::test {

/// Presses keys in the field of an expression: letters, and keys between angle brackets such as "<Return>" or
/// "<Ctrl+Space>". They go where a user's would: to the list of completions while it is open.
std::string PressKeys(Editor& editor, const QString& label, const QString& keys);

/// Chooses an entry of the palette under the field, by its menu and the beginning of its caption.
std::string InsertFromPalette(Editor& editor, const QString& label, const QString& menu,
                              const QString& entry);

/// Uses an entry of the formula's menu, by the menu key, and gives what the formula says of itself and what
/// is on the clipboard then.
std::string UseFormula(Editor& editor, const QString& label, const QString& entry);

/// What the pointer's tip says over a position.
std::string TipIn(Editor& editor, const QString& label, int position);

}  // namespace tessal::test
