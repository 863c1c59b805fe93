// Opening what an element names as its documentation: a file, an address, or a document of the manuals.
#pragma once

#include <QString>

namespace tessal {

class UserDialogs;

/// Opens the text as it is (a relative path in the folder first, if one is given), then below the manuals
/// folder, then below the manuals address. A template comes from anybody: documents and web addresses open,
/// programs and what can start one never do, and anything else after a question that shows the whole target.
/// Empty when one of them opened, when the user declined, or when the text is empty; otherwise the message
/// for the user.
QString OpenDocumentationFile(const QString& text, UserDialogs& dialogs, const QString& folder = {});

}  // namespace tessal
