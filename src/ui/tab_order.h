// The order in which Tab walks through the parts of a window.
#pragma once

#include <QList>

class QWidget;

namespace tessal {

/// What Tab may reach in a part of a window, in its order from a widget of the window on.
QList<QWidget*> TabStopsIn(const QWidget& part, QWidget& from);

/// Has Tab walk a part of the window after a stop that lies outside of it; the last stop of the part.
QWidget& ChainAfter(QWidget& stop, const QWidget& part);

}  // namespace tessal
