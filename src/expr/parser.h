// The parser of the expression language. A parse gives a value, a tree or why there is none, which may be
// held beside its text and used again.
#pragma once

#include <concepts>
#include <cstdint>
#include <memory>
#include <span>
#include <string>
#include <string_view>

#include "core/messages.h"
#include "expr/expression_node.h"
#include "expr/expression_tree.h"
#include "expr/scanner.h"

namespace tessal {

class ExpressionBuilder;

/// Why a text has no tree.
struct ParseFailure {
  Finding finding;        ///< its text is "Line L position P : ...", ends in a line feed
  std::int32_t line;      ///< line feeds scanned until then
  std::int32_t position;  ///< characters of the last line scanned until then
  LexemeSpan at{0, 0};    ///< the token at which the parse stopped; empty at the end of the text
};

/// What the parse of a text gives, in one block of memory. The result depends on the text and on where its
/// scan began, and the scan leaves a start to the next one: both are part of the value, so that its use can
/// take the place of a parse. Nodes and names are views into the text: the text lives as long as its parse.
class ParsedExpression final {
 public:
  ParsedExpression(const ParsedExpression&) = delete;
  ParsedExpression& operator=(const ParsedExpression&) = delete;
  ~ParsedExpression() = default;

  /// The tree; none when the text does not parse.
  const ExpressionNode* Tree() const { return root; }
  /// Why there is no tree; none when there is one.
  const ParseFailure* Failure() const { return failure.get(); }

  ScannerStart Began() const { return began; }
  ScannerStart Left() const { return left; }

  /// Whether the parse came to the end of the text, and so knows its identifiers.
  bool KnowsIdentifiers() const { return knowsIdentifiers; }
  /// What `ScanIdentifiers` finds in the text from the same start, with the same effect on the next one; only
  /// of a parse that knows them.
  std::span<const LexemeSpan> Identifiers() const;

  /// What lies after the object goes with it.
  static void operator delete(void* block) noexcept { ::operator delete(block); }

 private:
  friend std::unique_ptr<const ParsedExpression> ParseExpression(std::string_view text);

  ParsedExpression() = default;
  /// A block with the object, the nodes of a tree, if there is one, and the identifiers.
  static std::unique_ptr<ParsedExpression> InBlock(const ExpressionBuilder* tree,
                                                   std::span<const LexemeSpan> identifiers);

  std::unique_ptr<const ParseFailure> failure;
  const ExpressionNode* root = nullptr;  ///< the last of the nodes
  std::uint32_t identifierCount = 0;
  bool knowsIdentifiers = false;
  ScannerStart began = ScannerStart::Text;
  ScannerStart left = ScannerStart::Text;
};

/// Parses a text without its quotes. The scanner's start is the only state that lives on after the call.
std::unique_ptr<const ParsedExpression> ParseExpression(std::string_view text);

/// A text that ends with the call would leave its parse without one.
template <std::same_as<std::string> Temporary>
std::unique_ptr<const ParsedExpression> ParseExpression(Temporary&& text) = delete;

/// The parse of a text of which an earlier parse may be held: that one, with the same effect on the scanner,
/// unless the scan would begin elsewhere now; otherwise a new one, which is held from then on. The holder
/// resets `held` whenever the text changes.
const ParsedExpression& ParseOnce(std::unique_ptr<const ParsedExpression>& held, std::string_view text);

/// The same by outputs, with a tree that owns its texts. On success gives 1, the tree, line and position -1
/// and "no error". On failure gives 0, the message, line and position, and leaves the tree alone.
int ParseExpressionText(const std::string& text, ExpressionTree& tree, std::int32_t& line,
                        std::int32_t& position, std::string& message);

}  // namespace tessal
