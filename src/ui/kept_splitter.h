// Splitters that are where the user has left them the last time.
#pragma once

class QSplitter;

namespace tessal {

/// Puts a splitter, known by its object name, where it was left, and notes in the settings where the user
/// moves it from now on.
void KeepSplitter(QSplitter& splitter);

}  // namespace tessal
