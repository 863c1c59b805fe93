// A text that the client has open, as it is there: a file on disk may differ.
#pragma once

#include <cstdint>
#include <nlohmann/json.hpp>
#include <string>

#include "cli/lsp/text_positions.h"

namespace tessal::cli {

using Json = nlohmann::ordered_json;

struct OpenDocument {
  std::string uri;
  std::string text;          ///< UTF-8, as JSON has it
  Json version;              ///< the client's number, null without one
  std::uint64_t change = 0;  ///< another number for each text of each document
};

/// Applies the `contentChanges` of a notification in their order: each has a range and the text in its place,
/// or the whole text. Raises the JSON library's failure for what is none.
void ApplyChanges(std::string& text, const Json& changes, ColumnUnit unit);

/// A position of the protocol. Raises the same for what is none; negative numbers are none.
TextPosition PositionFrom(const Json& position);
Json ToJson(TextPosition position);

}  // namespace tessal::cli
