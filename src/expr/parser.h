// The parser of the expression language. A parse gives a value, a tree or why there is none, which may be
// held beside its text and used again.
#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <variant>

#include "core/messages.h"
#include "expr/expression_node.h"
#include "expr/scanner.h"

namespace tessal {

/// Why a text has no tree.
struct ParseFailure {
  Finding finding;        ///< its text is "Line L position P : ...", ends in a line feed
  std::int32_t line;      ///< line feeds scanned until then
  std::int32_t position;  ///< characters of the last line scanned until then
};

/// What the parse of a text gives. The result depends on the text and on where its scan began, and the scan
/// leaves a start to the next one: both are part of the value, so that its use can take the place of a parse.
struct ParsedExpression {
  std::variant<ExpressionNode, ParseFailure> result;
  ScannerStart began = ScannerStart::Text;
  ScannerStart left = ScannerStart::Text;

  /// The tree; none when the text does not parse.
  const ExpressionNode* Tree() const { return std::get_if<ExpressionNode>(&result); }
  /// Why there is no tree; none when there is one.
  const ParseFailure* Failure() const { return std::get_if<ParseFailure>(&result); }
};

/// Parses a text without its quotes. The scanner's start is the only state that lives on after the call.
ParsedExpression ParseExpression(std::string_view text);

/// The parse of a text of which an earlier parse may be held: that one, with the same effect on the scanner,
/// unless the scan would begin elsewhere now; otherwise a new one, which is held from then on. The holder
/// resets `held` whenever the text changes.
const ParsedExpression& ParseOnce(std::unique_ptr<const ParsedExpression>& held, std::string_view text);

/// The same by outputs. On success gives 1, the tree, line and position -1 and "no error". On failure gives
/// 0, the message, line and position, and leaves the tree alone.
int ParseExpressionText(const std::string& text, ExpressionNode& node, std::int32_t& line,
                        std::int32_t& position, std::string& message);

}  // namespace tessal
