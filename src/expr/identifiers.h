// The names that an expression mentions, found without parsing it: the answer exists also for an expression
// that does not parse.
#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace tessal {

/// The identifiers of a stored expression, its quotes stripped, in text order with repeats. None when the
/// text holds something that is no token or is longer than `kLongestExpression`.
void ExtractIdentifiers(std::string_view text, std::vector<std::string>& identifiers);

/// The same over a text without quotes, as views into it.
void ScanIdentifiers(std::string_view text, std::vector<std::string_view>& identifiers);

}  // namespace tessal
