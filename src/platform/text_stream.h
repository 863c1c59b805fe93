// A stream of text in memory, for what writes to streams.
#pragma once

#include <sstream>

namespace tessal {

/// Raises `std::bad_alloc` when there is no memory for the text. The standard stream would only note it, and
/// its text would lack a piece.
class TextStream final : public std::ostringstream {
 public:
  TextStream() { exceptions(std::ios::badbit); }
};

}  // namespace tessal
