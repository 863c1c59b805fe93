// While a line is typed its document is mostly no template: a keyword without a value, a section without its
// end. What is left out here makes one of it again, and all other places stay where they are.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "cli/lsp/loaded_document.h"

namespace tessal::cli {

/// Lines that are left out of a text.
struct LeftOut {
  std::size_t start = 0;     ///< of the first line
  std::size_t end = 0;       ///< of the last one, before what ends it
  bool endsSection = false;  ///< `EndSect` follows at the end, and moves what comes after it
};

/// What to leave out of a document that can not be read, to be tried in this order: the line that is typed at
/// a place, and the lines at which the reading stopped.
std::vector<LeftOut> LeftOutAt(const LoadedDocument& unread, std::size_t place);
/// The same for a place that matters itself: nothing but the lines at which the reading stopped.
std::vector<LeftOut> LeftOutAtFault(const LoadedDocument& unread);

/// The text of a document without that.
std::string WithLeftOut(const LoadedDocument& unread, const LeftOut& leftOut);

/// The expression that is typed at a place where no whole one was read: `KEYWORD = '"a + b`.
std::optional<ExpressionPlace> UnfinishedExpression(const LoadedDocument& document, std::size_t offset);

/// The line of the client's text up to a place.
std::string_view LineBefore(const LoadedDocument& document, std::size_t offset);

/// The keyword that a line gives a value to; empty for any other line.
std::string_view KeywordOfLine(std::string_view line);

}  // namespace tessal::cli
