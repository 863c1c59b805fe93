// Splitters that are where the user has left them the last time.
#pragma once

class QSplitter;
class QWidget;

namespace tessal {

/// Puts a splitter, known by its object name, where it was left, and notes in the settings where the user
/// moves it from now on.
void KeepSplitter(QSplitter& splitter);

/// Shows a part of a splitter that was hidden, at this height at least; the first part gives the room.
void OpenInSplitter(QWidget& part, int usualHeight);

}  // namespace tessal
