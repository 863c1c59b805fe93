// What a user does with the analyses, and what they show, for the lines of a file of cases.
#pragma once

#include <string>

#include "ui/editor.h"

namespace tessal::test {

/// The page in front: its title, what its labels and its fields say, the rows of its tables and the boxes of
/// its drawing.
std::string AnalysisText(Editor& editor);
/// "Pools of the template: 2" enters a row of a table by Return; "1 3" is a cell.
void EnterCell(QWidget& table, const QString& cell);
/// What the open form says beside the unit.
std::string UnitNoteText(Editor& editor);

}  // namespace tessal::test
