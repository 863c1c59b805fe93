// The help of the editor: one page, TessalOnline.html, that lies beside the host's executable or in its
// folder of shared files, with an anchor for each topic.
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

}  // namespace tessal
