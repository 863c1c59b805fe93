// Any text scans, parses, is checked and walked without harm, and the answers agree with each other.
#include <cstdint>
#include <cstdlib>
#include <memory>
#include <string>
#include <vector>

#include "core/error_registry.h"
#include "docgen/latex.h"
#include "docgen/mathml.h"
#include "expr/expression_node.h"
#include "expr/identifiers.h"
#include "expr/interaction_rewriter.h"
#include "expr/parser.h"
#include "expr/scanner.h"
#include "expr/semantic_checks.h"

namespace {

using namespace tessal;

void Require(bool holds) {
  if (!holds) std::abort();
}

void CheckTokens(const std::string& text) {
  std::vector<ExpressionToken> tokens;
  ResetExpressionScanner();
  const bool clean = ScanExpressionTokens(text, tokens);
  std::int32_t end = -1;
  std::size_t names = 0;
  for (const ExpressionToken& listed : tokens) {
    Require(listed.firstOffset > end && listed.lastOffset >= listed.firstOffset);
    end = listed.lastOffset;
    const auto length = static_cast<std::size_t>(listed.lastOffset - listed.firstOffset + 1);
    Require(text.compare(static_cast<std::size_t>(listed.firstOffset), length, listed.text) == 0);
    if (listed.code == TokenCode::Identifier) ++names;
  }
  std::vector<std::string_view> identifiers;
  ResetExpressionScanner();
  ScanIdentifiers(text, identifiers);
  Require(identifiers.size() == (clean ? names : 0));
}

void CheckParse(const std::string& text) {
  ResetExpressionScanner();
  std::unique_ptr<const ParsedExpression> held;
  const ParsedExpression& first = ParseOnce(held, text);
  const ScannerStart left = ExpressionScannerStart();
  ResetExpressionScanner();
  const ParsedExpression& used = ParseOnce(held, text);
  Require(ExpressionScannerStart() == left && left == used.Left() && &used == &first);
  if (const ParseFailure* failure = first.Failure()) {
    ResetExpressionScanner();
    const auto again = ParseExpression(text);
    Require(again->Failure() != nullptr && again->Failure()->finding.text == failure->finding.text);
    Require(failure->finding.text.starts_with("Line "));
    return;
  }
  const ExpressionNode& tree = *first.Tree();
  const ExpressionTree copy(&tree);
  int nodes = 0;
  int copied = 0;
  tree.WalkInOrder(
      nullptr, [&nodes](NodeKind, std::string_view, std::int32_t) { ++nodes; }, nullptr);
  copy.Root().WalkPostOrder(
      nullptr, [&copied](NodeKind, std::string_view, std::int32_t) { ++copied; }, nullptr);
  Require(nodes == copied);
  Require(RewriteExpressionText(tree) == RewriteExpressionText(copy.Root()));
  Require(TreeToLatex(tree, "s", true) == TreeToLatex(copy.Root(), "s", true));
  Require(!TreeToMathML(tree, "s", true).empty());
}

/// A parse that came to the end knows the names that a scan finds, and leaves the scanner as the scan does.
void CheckKnownNames(const std::string& text, ScannerStart start) {
  SetExpressionScannerStart(start);
  const auto parsed = ParseExpression(text);
  if (!parsed->KnowsIdentifiers()) return;
  std::vector<std::string_view> scanned;
  SetExpressionScannerStart(start);
  ScanIdentifiers(text, scanned);
  Require(parsed->Left() == ExpressionScannerStart() && parsed->Identifiers().size() == scanned.size());
  for (std::size_t place = 0; place < scanned.size(); ++place) {
    const LexemeSpan name = parsed->Identifiers()[place];
    Require(scanned[place].data() == text.data() + name.start && scanned[place].size() == name.length);
  }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::string text(reinterpret_cast<const char*>(data), size);
  CheckTokens(text);
  CheckParse(text);
  CheckKnownNames(text, ScannerStart::Text);
  CheckKnownNames(text, ScannerStart::Comment);
  tessal::ResetExpressionScanner();
  tessal::CheckFunctionsSpecified("fuzz", Uid{1}, text);
  tessal::IsReservedName(text);
  tessal::IsValidSymbol(text);
  tessal::Errors().Reset();
  return 0;
}
