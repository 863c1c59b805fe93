// Comma-separated values after RFC 4180.
#pragma once

#include <span>
#include <string>
#include <string_view>

namespace tessal {

/// A field, between quotes where it needs them.
std::string CsvField(std::string_view text);

/// A line of fields, with its end.
std::string CsvLine(std::span<const std::string> fields);

}  // namespace tessal
