// The help of the editor: one page, TessalOnline.html, that lies beside the host's executable or in its
// folder of shared files, with an anchor for each topic.
#pragma once

class QWidget;

namespace tessal {

/// The anchor of a topic is its help number plus this.
inline constexpr int kFirstHelpTopic = 131072;

/// Shows the page at a topic, in one window beside the asking one; says so when there is no page.
void OpenHelp(QWidget* parent, int topic);

}  // namespace tessal
