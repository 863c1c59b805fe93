// Opening what an element names as its documentation: a file, an address, or a document of the manuals.
#pragma once

#include <QString>

namespace tessal {

class UserDialogs;

/// Opens the text as it stands, then below the manuals folder, then behind the manuals address. Empty when
/// one of them opened, or when the text is empty; otherwise what the user is told.
QString OpenDocumentationFile(const QString& text, UserDialogs& dialogs);

}  // namespace tessal
