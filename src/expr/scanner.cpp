#include "expr/scanner.h"

#include <algorithm>
#include <limits>

#include "expr/scanner_state.h"

namespace tessal {

namespace {

ExpressionToken MakeToken(const ExpressionScan& scan, TokenCode code) {
  const std::string_view lexeme = scan.Lexeme();
  const auto length = static_cast<std::int32_t>(lexeme.size());
  ExpressionToken listed;
  listed.text = lexeme;
  listed.code = IsPlainToken(code) ? code : TokenCode::ExceedanceFrequency;
  listed.line = static_cast<std::int32_t>(scan.Lines());
  listed.lastOffset = static_cast<std::int32_t>(scan.Consumed()) - 1;
  listed.firstOffset = listed.lastOffset - length + 1;
  listed.lastColumn = static_cast<std::int32_t>(scan.Consumed() - scan.LineStart()) - 1;
  listed.firstColumn = listed.lastColumn - length + 1;
  return listed;
}

}  // namespace

ScanPosition& ScannerCounters() {
  static ScanPosition counters;
  return counters;
}

ExpressionScan::ExpressionScan(std::string_view text) {
  constexpr auto kLongest = static_cast<std::size_t>(std::numeric_limits<std::int32_t>::max() - 2);
  constexpr std::size_t kEnd = 2;
  text = text.substr(0, std::min(text.find('\0'), kLongest));
  ScannerCounters() = {};
  scanned.reserve(text.size() + kEnd);
  scanned = text;
  BeginFlexScan(scanned);
}

ExpressionScan::~ExpressionScan() {
  EndFlexScan();
}

TokenCode ExpressionScan::Next() {
  return NextFlexToken();
}

std::string_view ExpressionScan::Lexeme() const {
  return FlexLexeme();
}

std::uint32_t ExpressionScan::Consumed() const {
  return ScannerCounters().consumed;
}

std::uint32_t ExpressionScan::Lines() const {
  return ScannerCounters().lines;
}

std::uint32_t ExpressionScan::LineStart() const {
  return ScannerCounters().lineStart;
}

bool ScanExpressionTokens(std::string_view text, std::vector<ExpressionToken>& tokens) {
  tokens.clear();
  bool clean = true;
  ExpressionScan scan(text);
  for (TokenCode code = scan.Next(); code != TokenCode::End; code = scan.Next()) {
    clean = clean && IsPlainToken(code);
    tokens.push_back(MakeToken(scan, code));
  }
  return clean;
}

std::string_view StripExpressionQuotes(std::string_view stored) {
  const std::size_t first = stored.find('"');
  if (first == std::string_view::npos) return stored;
  const std::size_t last = stored.rfind('"');
  return last == first ? stored.substr(first + 1) : stored.substr(first + 1, last - first - 1);
}

ScannerStart ExpressionScannerStart() {
  return FlexStart();
}

void SetExpressionScannerStart(ScannerStart start) {
  SetFlexStart(start);
}

void ResetExpressionScanner() {
  SetExpressionScannerStart(ScannerStart::Text);
}

}  // namespace tessal
