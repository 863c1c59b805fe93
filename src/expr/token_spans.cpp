#include "expr/token_spans.h"

namespace tessal {

std::vector<TokenSpan> TokenSpans(std::string_view text) {
  const ScannerRest rest;
  std::vector<TokenSpan> tokens;
  ExpressionScan scan(text);
  for (TokenCode code = scan.Next(); code != TokenCode::End; code = scan.Next()) {
    tokens.push_back({code, scan.Span()});
  }
  return tokens;
}

}  // namespace tessal
