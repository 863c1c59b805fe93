// The commands of the file menu that write what a reader without the editor needs: the page and the overview.
#pragma once

#include <vector>

#include "platform/docview.h"

class QWidget;

namespace tessal {

class CTessalDoc;
class UserDialogs;

/// What a view of the document offers, in the order of the menu. Run, a command commits what is being
/// entered, asks where to, writes, and offers to open what it wrote; a failure reaches the user.
std::vector<ViewCommand> ExportCommands(CTessalDoc& document, UserDialogs& dialogs, QWidget& view);

}  // namespace tessal
