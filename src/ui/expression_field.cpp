#include "ui/expression_field.h"

#include <QContextMenuEvent>
#include <QHelpEvent>
#include <QMimeData>
#include <QSignalBlocker>
#include <QToolTip>

#include "core/template_core.h"
#include "expr/expression_node.h"
#include "expr/parser.h"
#include "expr/scanner.h"
#include "ui/expression_colours.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

/// Where the bytes of a text stand on the screen. A comment may hold characters of several bytes.
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

}  // namespace

CAutoRichEditCtrl::CAutoRichEditCtrl(const TemplateCore& templateCore, QWidget* parent)
    : QTextEdit(parent), core(templateCore) {
  setAcceptRichText(false);
  setTabChangesFocus(true);
  setMouseTracking(true);
  viewport()->setMouseTracking(true);
}

void CAutoRichEditCtrl::SetColouredText(const std::string& text) {
  setUpdatesEnabled(false);
  content = text;
  setPlainText(ToScreen(text));
  Colour();
  moveCursor(QTextCursor::Start);
  document()->clearUndoRedoStacks();
  document()->setModified(false);
  setUpdatesEnabled(true);
}

void CAutoRichEditCtrl::Colour() {
  std::vector<ExpressionToken> tokens;
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
}

QString CAutoRichEditCtrl::ParserMessage() const {
  ExpressionNode tree;
  std::int32_t line = 0;
  std::int32_t position = 0;
  std::string message;
  const int parsed = ParseExpressionText(FromScreen(toPlainText(), content), tree, line, position, message);
  ResetExpressionScanner();
  return parsed != 0 ? QString() : ToScreen(message).trimmed();
}

std::uint32_t CAutoRichEditCtrl::LinkAt(const QPoint& point) const {
  const QString name = anchorAt(point);
  if (name.isEmpty()) return 0;
  std::int32_t id = 0;
  std::int32_t elementKind = 0;
  if (!core.FindElementBySymbol(name.toStdString(), id, elementKind)) return 0;
  const CEL_Element* element = core.GetElementBySequence(static_cast<std::uint32_t>(id));
  return element == nullptr ? 0 : element->GetUid();
}

QString CAutoRichEditCtrl::TipOf(std::uint32_t uid) const {
  const CEL_Element* element = core.GetElement(uid);
  if (element == nullptr) return {};
  return ToScreen("[" + std::string(element->KindText()) + "] " + element->description.Text());
}

bool CAutoRichEditCtrl::event(QEvent* happened) {
  if (happened->type() == QEvent::ToolTip) {
    const auto* help = static_cast<QHelpEvent*>(happened);
    const std::uint32_t uid = LinkAt(viewport()->mapFrom(this, help->pos()));
    if (uid != 0) {
      QToolTip::showText(help->globalPos(), TipOf(uid).toHtmlEscaped(), this);
    } else {
      QToolTip::hideText();
    }
    return true;
  }
  return QTextEdit::event(happened);
}

void CAutoRichEditCtrl::contextMenuEvent(QContextMenuEvent* request) {
  const std::uint32_t uid = LinkAt(viewport()->mapFromGlobal(request->globalPos()));
  if (uid != 0) {
    emit LinkActivated(uid);
    return;
  }
  QTextEdit::contextMenuEvent(request);
}

void CAutoRichEditCtrl::changeEvent(QEvent* change) {
  QTextEdit::changeEvent(change);
  // Another palette wants other colours; what the user is typing stays.
  if (change->type() == QEvent::PaletteChange && !document()->isModified()) SetColouredText(content);
}

void CAutoRichEditCtrl::insertFromMimeData(const QMimeData* source) {
  QString text = source->text();
  text.remove(QChar(u'\0'));
  textCursor().insertText(text, QTextCharFormat());
}

}  // namespace tessal
