// Places in a text on the screen and in its bytes as UTF-8. A comment may hold characters of several bytes.
#pragma once

#include <QString>
#include <cstddef>
#include <string>

namespace tessal {

/// The bytes before a position of the text.
std::size_t BytesBefore(const QString& text, int position);

/// The position of an offset in the bytes of a text.
int PositionAt(const std::string& bytes, std::size_t offset);

}  // namespace tessal
