// What a user does on the list pages, on the pages of the root and in the tables of a visibility group.
#pragma once

#include <string>

#include "ui/editor.h"

namespace tessal::test {

/// Carries out a call such as "row Constants: 2"; false for a verb that is none of these.
bool ActOnPage(Editor& editor, const std::string& verb, const QString& what, const QString& value);

/// The commands of a list page that can be given.
std::string CommandsText(Editor& editor);

}  // namespace tessal::test
