// What changed between two states of a template, laid out for people: for a comment on a proposed change, and
// as a page of its own.
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "core/comparison.h"
#include "core/expression_difference.h"

namespace tessal {

/// Puts marks around parts of a text, and each piece through a writer of its own.
template <class Writer>
std::string MarkedText(std::string_view text, const std::vector<TextPart>& parts, std::string_view open,
                       std::string_view close, Writer write) {
  std::string marked;
  std::size_t written = 0;
  for (const TextPart& part : parts) {
    marked += write(text.substr(written, part.start - written));
    marked.append(open).append(write(text.substr(part.start, part.end - part.start))).append(close);
    written = part.end;
  }
  return marked += write(text.substr(written));
}

/// Lists under headings; in an expression what went is struck out, and what came is bold.
std::string ChangesMarkdown(const std::vector<SymbolChange>& changes, std::string_view former,
                            std::string_view later);

/// A page with a table. Texts in UTF-8, whatever the template is in.
std::string ChangesHtml(const std::vector<SymbolChange>& changes, std::string_view former,
                        std::string_view later);

}  // namespace tessal
