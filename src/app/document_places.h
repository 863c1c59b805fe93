// Where the files lie that go with a document while it is open: beside its own file, or, where that cannot
// be, in the user's state folder, under names that no document has.
#pragma once

#include <QString>

namespace tessal {

/// Where the user's programs keep what they need to go on: the folder `tessal` in $XDG_STATE_HOME or in
/// ~/.local/state. It may not be there yet.
QString StateFolder();
/// Makes the state folder, for its owner only. The empty text, or the reason.
QString MakeStateFolder();

/// The file beside a document's with its name and the suffix.
QString BesideDocument(const QString& path, const QString& suffix);
/// The file in the state folder for the document at that path, however long the path is.
QString InStateFolder(const QString& path, const QString& suffix);

}  // namespace tessal
