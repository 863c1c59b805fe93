// What a program was built from and with. One small file is compiled again when a revision or a setting
// changes; only programs link it.
#pragma once

#include <string>
#include <string_view>

namespace tessal {

/// "1.0.0".
std::string_view ProgramVersion();

/// Lines for `--version`: the program with its version, the revision of the checkout that it was built from,
/// where there was one, the compiler with the kind of build, and the stamps of the template format that a
/// save writes. No line feed at the end.
std::string BuildText(std::string_view program);

}  // namespace tessal
