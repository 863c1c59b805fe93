// The files opened last, newest first, kept in the user's settings.
#pragma once

#include <QStringList>

namespace tessal {

inline constexpr qsizetype kMostRecentFiles = 10;

/// The list without the files that are gone.
QStringList RecentFiles();
/// Puts a file at the head of the list.
void AddRecentFile(const QString& path);
void ClearRecentFiles();
/// How lists name one of the files: its plain name, and the folder, which sets it apart from others of that
/// name.
QString RecentFileCaption(const QString& path);

}  // namespace tessal
