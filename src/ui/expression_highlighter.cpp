#include "ui/expression_highlighter.h"

#include <algorithm>
#include <utility>

#include "expr/scanner.h"
#include "ui/expression_colours.h"

namespace tessal {

namespace {

/// Where the bytes of a UTF-8 text lie on the screen. A comment may hold characters of several bytes.
class ScreenPositions final {
 public:
  ScreenPositions(const std::string& bytes, const QString& text)
      : content(bytes), oneByteEach(text.size() == static_cast<qsizetype>(bytes.size())) {}

  /// For offsets that only grow.
  int At(std::int32_t offset) {
    if (oneByteEach) return offset;
    const auto end = static_cast<std::size_t>(offset);
    position += static_cast<int>(QString::fromUtf8(content.data() + reached, offset - Reached()).size());
    reached = end;
    return position;
  }

 private:
  std::int32_t Reached() const { return static_cast<std::int32_t>(reached); }

  const std::string& content;
  bool oneByteEach;
  std::size_t reached = 0;
  int position = 0;
};

QTextCharFormat LooksOf(const TokenStyle& style, const QColor& ground) {
  QTextCharFormat looks;
  looks.setFontWeight(style.bold ? QFont::Bold : QFont::Normal);
  looks.setFontItalic(style.italic);
  if (style.coloured) looks.setForeground(ReadableColour(style.colour, ground));
  if (style.link) looks.setFontUnderline(true);
  return looks;
}

}  // namespace

CExpressionHighlighter::CExpressionHighlighter(const TemplateCore& templateCore, QObject* owner)
    : QSyntaxHighlighter(owner), core(templateCore) {}

bool CExpressionHighlighter::Scan(const QString& text, const QColor& ground) {
  const std::string bytes = text.toStdString();
  std::vector<ExpressionToken> tokens;
  const ScannerRest rest;
  const bool wasClean = std::exchange(isClean, ScanExpressionTokens(bytes, tokens));
  if (!isClean) tokens.clear();
  ++revision;
  parts.clear();
  parts.reserve(tokens.size());
  ScreenPositions positions(bytes, text);
  for (const ExpressionToken& expressionToken : tokens) {
    const TokenStyle style = StyleOfToken(expressionToken, core);
    Part part;
    part.begin = positions.At(expressionToken.firstOffset);
    part.end = positions.At(expressionToken.lastOffset + 1);
    part.looks = LooksOf(style, ground);
    if (style.link) part.link = expressionToken.text;
    parts.push_back(std::move(part));
  }
  return isClean != wasClean;
}

CExpressionHighlighter::Parts::const_iterator CExpressionHighlighter::FirstAfter(int position) const {
  return std::partition_point(parts.begin(), parts.end(),
                              [position](const Part& part) { return part.end <= position; });
}

std::string CExpressionHighlighter::LinkAt(int position) const {
  const auto part = FirstAfter(position);
  return part != parts.end() && part->begin <= position ? part->link : std::string();
}

void CExpressionHighlighter::highlightBlock(const QString& text) {
  // A comment may begin or end with any edit: the lines after a changed one are looked at too.
  setCurrentBlockState(revision);
  const int start = currentBlock().position();
  const int end = start + static_cast<int>(text.size());
  for (auto part = FirstAfter(start); part != parts.end() && part->begin < end; ++part) {
    setFormat(part->begin - start, part->end - part->begin, part->looks);
  }
}

}  // namespace tessal
