// Calls back when a widget loses the keyboard focus, for widgets that have no signal for it.
#pragma once

#include <functional>

class QWidget;

namespace tessal {

void WatchFocusLoss(QWidget& widget, std::function<void()> lost);

}  // namespace tessal
