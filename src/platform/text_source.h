// A text that is made part by part, so that it is never there as a whole.
#pragma once

#include <functional>
#include <string_view>

namespace tessal {

/// Takes the parts of a text, one after the other.
using TextSink = std::function<void(std::string_view part)>;

/// Makes a text. False when it cannot be made after all; what takes it then forgets the parts.
using TextSource = std::function<bool(const TextSink& write)>;

}  // namespace tessal
