// A walk over the tokens of an expression that leaves no trace in the scanner.
#pragma once

#include <string_view>

#include "expr/scanner.h"

namespace tessal {

/// Calls the visitor with the code and the lexeme, a view into the expression, of each of its tokens. Scans
/// to come begin as if nobody had looked.
template <class Visitor>
void ForEachToken(std::string_view expression, Visitor visit) {
  const std::string_view text = StripExpressionQuotes(expression);
  const ScannerStart start = ExpressionScannerStart();
  ResetExpressionScanner();
  {
    ExpressionScan scan(text);
    for (TokenCode code = scan.Next(); code != TokenCode::End; code = scan.Next()) {
      const std::size_t length = scan.Lexeme().size();
      visit(code, text.substr(scan.Consumed() - length, length));
    }
  }
  SetExpressionScannerStart(start);
}

}  // namespace tessal
