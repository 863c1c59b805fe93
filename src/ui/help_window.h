// The help of the editor: pages that lie beside the host's executable or in its folder of shared files.
// TessalOnline.html has an anchor for each topic; Functions.html and Builtins.html are the reference, with an
// anchor for each name; the folder guide holds the chapters of the guide.
#pragma once

#include <QString>

class QWidget;

namespace tessal {

/// The anchor of a topic is its help number plus this.
inline constexpr int kFirstHelpTopic = 131072;

/// The path of the page, for a program in that folder; empty when it lies nowhere, or the folder is not
/// known.
QString FindHelpPage(const QString& programFolder);

/// Shows the page at a topic, in one window beside the asking one; says so when there is no page.
void OpenHelp(QWidget* parent, int topic);

/// Shows the list of the guide's chapters in the same window.
void OpenGuide(QWidget* parent);

/// Shows in the same way what the reference has of a function or a built-in quantity, by its name in any
/// case; for any other text the page of functions from its start.
void OpenReference(QWidget* parent, const QString& name);

}  // namespace tessal
