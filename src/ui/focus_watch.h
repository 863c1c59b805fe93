// What widgets do not report by themselves, or do too eagerly.
#pragma once

#include <functional>

class QWidget;

namespace tessal {

/// Calls back when a widget loses the keyboard focus, for widgets that have no signal for it. A menu that
/// opens over the widget takes the focus for a moment only and does not count.
void WatchFocusLoss(QWidget& widget, std::function<void()> lost);

/// Lets the wheel act on a widget only while that has the keyboard focus; otherwise it scrolls what is
/// around.
void IgnoreWheelWithoutFocus(QWidget& widget);

}  // namespace tessal
