// The help of the editor: one page, TessalOnline.html, that lies beside the host's executable or in its
// folder of shared files, with an anchor for each topic.
#pragma once

#include <QString>

class QWidget;

namespace tessal {

/// Topics stand in the page under their help number plus this.
inline constexpr int kFirstHelpTopic = 131072;

/// The path of the page, or of the first place where it was looked for when it lies nowhere.
QString HelpPagePath();

/// Shows the page at a topic, in one window beside the asking one; tells the user when there is no page.
void OpenHelp(QWidget* parent, int topic);

}  // namespace tessal
