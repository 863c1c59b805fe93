#include "ui/expression_field.h"

#include <QContextMenuEvent>
#include <QHelpEvent>
#include <QMouseEvent>
#include <QSignalBlocker>
#include <QToolTip>

#include "core/template_core.h"
#include "expr/parser.h"
#include "expr/scanner.h"
#include "ui/expression_colours.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

/// Where the bytes of a text lie on the screen. A comment may hold characters of several bytes.
class ScreenPositions final {
 public:
  explicit ScreenPositions(const std::string& text)
      : content(text), oneByteEach(ToScreen(text).size() == static_cast<qsizetype>(text.size())) {}

  /// For offsets that only grow.
  int At(std::int32_t offset) {
    if (oneByteEach) return offset;
    const auto end = static_cast<std::size_t>(offset);
    position += static_cast<int>(ToScreen(std::string_view(content).substr(reached, end - reached)).size());
    reached = end;
    return position;
  }

 private:
  const std::string& content;
  bool oneByteEach;
  std::size_t reached = 0;
  int position = 0;
};

/// A comment that one text leaves open must not reach the next that is scanned for its looks.
class ScannerRest final {
 public:
  ScannerRest() { ResetExpressionScanner(); }
  ScannerRest(const ScannerRest&) = delete;
  ScannerRest& operator=(const ScannerRest&) = delete;
  ~ScannerRest() { ResetExpressionScanner(); }
};

}  // namespace

CAutoRichEditCtrl::CAutoRichEditCtrl(const TemplateCore& templateCore, QWidget* parent)
    : CPlainTextField(parent), core(templateCore) {
  viewport()->setMouseTracking(true);
}

void CAutoRichEditCtrl::SetColouredText(const std::string& text) {
  setUpdatesEnabled(false);
  content = text;
  // What was typed last must not lend its looks to the new text.
  setCurrentCharFormat(QTextCharFormat());
  ShowText(ToScreen(text));
  Colour();
  setUpdatesEnabled(true);
}

void CAutoRichEditCtrl::Colour() {
  std::vector<ExpressionToken> tokens;
  const ScannerRest rest;
  if (!ScanExpressionTokens(content, tokens) || tokens.empty()) return;
  const QSignalBlocker quiet(this);
  const QColor ground = palette().color(QPalette::Base);
  ScreenPositions positions(content);
  QTextCursor cursor(document());
  cursor.beginEditBlock();
  for (const ExpressionToken& expressionToken : tokens) {
    const TokenStyle style = StyleOfToken(expressionToken, core);
    QTextCharFormat format;
    format.setFontWeight(style.bold ? QFont::Bold : QFont::Normal);
    format.setFontItalic(style.italic);
    if (style.coloured) format.setForeground(ReadableColour(style.colour, ground));
    if (style.link) {
      format.setAnchor(true);
      format.setAnchorHref(ToScreen(expressionToken.text));
      format.setFontUnderline(true);
    }
    cursor.setPosition(positions.At(expressionToken.firstOffset));
    cursor.setPosition(positions.At(expressionToken.lastOffset + 1), QTextCursor::KeepAnchor);
    cursor.setCharFormat(format);
  }
  cursor.endEditBlock();
  document()->clearUndoRedoStacks();
  document()->setModified(false);
}

QString CAutoRichEditCtrl::ParserMessage() const {
  const ScannerRest rest;
  const ParsedExpression parsed = ParseExpression(FromScreen(ContentText(), content));
  const ParseFailure* failure = parsed.Failure();
  return failure == nullptr ? QString() : ToScreen(failure->finding.text).trimmed();
}

Uid CAutoRichEditCtrl::LinkAt(const QPoint& point) const {
  return ElementNamed(anchorAt(point));
}

Uid CAutoRichEditCtrl::LinkAtCaret() const {
  QTextCursor caret = textCursor();
  const QString before = caret.charFormat().anchorHref();
  caret.movePosition(QTextCursor::NextCharacter);
  const QString after = caret.charFormat().anchorHref();
  return ElementNamed(after.isEmpty() ? before : after);
}

Uid CAutoRichEditCtrl::ElementNamed(const QString& name) const {
  if (name.isEmpty()) return Uid::None;
  std::int32_t id = 0;
  ElementKind elementKind = ElementKind::None;
  if (!core.FindElementBySymbol(FromScreen(name, content), id, elementKind)) return Uid::None;
  const CEL_Element* element = core.GetElementBySequence(static_cast<std::uint32_t>(id));
  return element == nullptr ? Uid::None : element->GetUid();
}

QString CAutoRichEditCtrl::TipOf(Uid uid) const {
  const CEL_Element* element = core.GetElement(uid);
  if (element == nullptr) return {};
  return ToScreen("[" + std::string(element->KindText()) + "] " + element->description.Text());
}

bool CAutoRichEditCtrl::event(QEvent* happened) {
  if (happened->type() != QEvent::ToolTip) return CPlainTextField::event(happened);
  const auto* help = static_cast<QHelpEvent*>(happened);
  const Uid uid = LinkAt(viewport()->mapFrom(this, help->pos()));
  if (uid == Uid::None) {
    QToolTip::hideText();
  } else {
    QToolTip::showText(help->globalPos(), TipOf(uid).toHtmlEscaped(), this);
  }
  return true;
}

void CAutoRichEditCtrl::mouseMoveEvent(QMouseEvent* move) {
  CPlainTextField::mouseMoveEvent(move);
  viewport()->setCursor(anchorAt(move->pos()).isEmpty() ? Qt::IBeamCursor : Qt::PointingHandCursor);
}

void CAutoRichEditCtrl::contextMenuEvent(QContextMenuEvent* request) {
  const bool byKey = request->reason() == QContextMenuEvent::Keyboard;
  const Uid uid = byKey ? LinkAtCaret() : LinkAt(viewport()->mapFromGlobal(request->globalPos()));
  if (uid != Uid::None) {
    emit LinkActivated(uid);
    return;
  }
  CPlainTextField::contextMenuEvent(request);
}

void CAutoRichEditCtrl::changeEvent(QEvent* change) {
  CPlainTextField::changeEvent(change);
  // Another palette wants other colours; what the user is typing stays.
  if (change->type() == QEvent::PaletteChange && !IsEdited()) SetColouredText(content);
}

}  // namespace tessal
