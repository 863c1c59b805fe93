// The icons of the editor: drawings of one colour and white, whose colour comes from what they stand for or
// from the palette of the moment. A drawing is a file of `icons/`, a use of it a row of a table.
#pragma once

#include <QIcon>
#include <QString>
#include <cstdint>

#include "elements/element_kind.h"

namespace tessal {

enum class IconCommand {
  New,
  Edit,
  Delete,
  MoveUp,
  MoveDown,
  Back,
  Forward,
  History,
  Undo,
  Redo,
  Cut,
  Copy,
  Paste,
  Duplicate,
  Rename
};

/// The icon of the nodes and rows of a kind: a letter or a sign for the kind, round for what belongs to a
/// particle class; a folder in the colour of its elements for a collection.
QIcon IconOfKind(ElementKind kind);
QIcon IconOfCommand(IconCommand command);
/// The icon of a level of messages, 1 to 4; none for another number.
QIcon IconOfLevel(std::uint32_t level);

/// The word for a level, for those who do not see its icon.
QString WordOfLevel(std::uint32_t level);
/// The colour of its icon.
QColor ColourOfLevel(std::uint32_t level);

}  // namespace tessal
