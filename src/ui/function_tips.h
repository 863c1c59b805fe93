// What tips say about functions and built-ins, out of their reference.
#pragma once

#include <QString>
#include <cstddef>
#include <string>

namespace tessal {

class TemplateCore;

/// What a function or built-in is for, with its arguments and units, as rich text; empty for any other name.
QString TipOfWord(const std::string& name);

/// A call with its arguments, as rich text: the one at a place, from 0, is in bold and explained. User
/// functions of the settings have numbered arguments. Empty for a name that is not called.
QString TipOfCall(const TemplateCore& core, const std::string& name, std::size_t argument);

}  // namespace tessal
