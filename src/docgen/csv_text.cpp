#include "docgen/csv_text.h"

namespace tessal {

std::string CsvField(std::string_view text) {
  if (text.find_first_of(",\"\r\n") == std::string_view::npos) return std::string(text);
  std::string quoted = "\"";
  for (const char character : text) {
    if (character == '"') quoted += '"';
    quoted += character;
  }
  return quoted + '"';
}

std::string CsvLine(std::span<const std::string> fields) {
  std::string line;
  for (const std::string& field : fields) line += (&field == fields.data() ? "" : ",") + CsvField(field);
  return line + "\r\n";
}

}  // namespace tessal
