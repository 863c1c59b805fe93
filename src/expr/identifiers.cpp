#include "expr/identifiers.h"

#include "expr/scanner.h"

namespace tessal {

void ScanIdentifiers(std::string_view text, std::vector<std::string_view>& identifiers) {
  identifiers.clear();
  if (text.size() > kLongestExpression) return;
  bool clean = true;
  ExpressionScan scan(text);
  for (TokenCode code = scan.Next(); code != TokenCode::End; code = scan.Next()) {
    if (code == TokenCode::Identifier) identifiers.push_back(scan.Lexeme());
    // To the end all the same: the start state of the next scan depends on it.
    clean = clean && IsPlainToken(code);
  }
  if (!clean) identifiers.clear();
}

void ExtractIdentifiers(std::string_view text, std::vector<std::string>& identifiers) {
  std::vector<std::string_view> names;
  ScanIdentifiers(StripExpressionQuotes(text), names);
  identifiers.assign(names.begin(), names.end());
}

}  // namespace tessal
