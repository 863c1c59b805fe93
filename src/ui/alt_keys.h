// The Alt keys that lead to the fields of a page.
#pragma once

#include <QStringList>

namespace tessal {

/// The labels of a page, each with an ampersand before the letter that is its key: the first letter of a word
/// where that is free, else any letter. No two have the same, none has one of the menu bar's, and a label
/// without a free letter stays without a key.
QStringList WithAltKeys(const QStringList& labels);

}  // namespace tessal
