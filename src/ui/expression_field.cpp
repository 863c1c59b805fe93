#include "ui/expression_field.h"

#include <QAbstractTextDocumentLayout>
#include <QContextMenuEvent>
#include <QHelpEvent>
#include <QMouseEvent>
#include <QScrollBar>
#include <QToolTip>
#include <utility>

#include "core/document.h"
#include "ui/child.h"
#include "ui/expression_colours.h"
#include "ui/expression_highlighter.h"
#include "ui/text_bytes.h"

namespace tessal {

CAutoRichEditCtrl::CAutoRichEditCtrl(const CTessalDoc& shownDocument, QWidget* parent)
    : CPlainTextField(parent),
      source(shownDocument),
      highlighter(MakeChild<CExpressionHighlighter>(shownDocument.Core(), document())) {
  viewport()->setMouseTracking(true);
  // The scan comes before the formatting of what has changed.
  connect(document(), &QTextDocument::contentsChange, this, &CAutoRichEditCtrl::FollowText);
  highlighter->setDocument(document());
  connect(this, &QTextEdit::textChanged, this, &CAutoRichEditCtrl::ReportText);
}

void CAutoRichEditCtrl::SetColouredText(const std::string& text) {
  setUpdatesEnabled(false);
  isStale = true;
  ShowText(ToScreen(text));
  setUpdatesEnabled(true);
}

void CAutoRichEditCtrl::FollowText() {
  const QString text = ContentText();
  // Colours are a change too, but not one of the text.
  if (!isStale && text == coloured) return;
  isStale = false;
  coloured = text;
  isUnreported = true;
  looksChangedBefore |= highlighter->Scan(text, palette().color(QPalette::Base));
}

void CAutoRichEditCtrl::ReportText() {
  if (std::exchange(looksChangedBefore, false)) highlighter->rehighlight();
  if (std::exchange(isUnreported, false)) emit ContentChanged();
}

int CAutoRichEditCtrl::CharacterAt(const QPoint& point) const {
  const QPoint scrolled(horizontalScrollBar()->value(), verticalScrollBar()->value());
  return document()->documentLayout()->hitTest(point + scrolled, Qt::ExactHit);
}

Uid CAutoRichEditCtrl::LinkAt(const QPoint& point) const {
  return ElementNamed(highlighter->LinkAt(CharacterAt(point)));
}

QString CAutoRichEditCtrl::TipAt(const QPoint& point) const {
  const int position = CharacterAt(point);
  const Uid uid = LinkAt(point);
  QString tip = uid == Uid::None ? QString() : TipOf(uid).toHtmlEscaped();
  if (!tips || position < 0) return tip;
  QTextCursor word(document());
  word.setPosition(position);
  word.select(QTextCursor::WordUnderCursor);
  const QString further =
      tips(uid == Uid::None ? word.selectedText().toStdString() : std::string(), position);
  if (!tip.isEmpty() && !further.isEmpty()) tip += QStringLiteral("<br>");
  return tip + further;
}

Uid CAutoRichEditCtrl::LinkAtCaret() const {
  const int caret = textCursor().position();
  const Uid after = ElementNamed(highlighter->LinkAt(caret));
  return after == Uid::None ? ElementNamed(highlighter->LinkAt(caret - 1)) : after;
}

Uid CAutoRichEditCtrl::ElementNamed(const std::string& name) const {
  std::int32_t id = 0;
  ElementKind elementKind = ElementKind::None;
  if (name.empty() || !source.Core().FindElementBySymbol(name, id, elementKind)) return Uid::None;
  const CEL_Element* element = source.Core().GetElementBySequence(static_cast<std::uint32_t>(id));
  return element == nullptr ? Uid::None : element->GetUid();
}

QString CAutoRichEditCtrl::TipOf(Uid uid) const {
  const CEL_Element* element = source.Core().GetElement(uid);
  if (element == nullptr) return {};
  return ToScreen("[" + std::string(element->KindText()) + "] " + element->description.TextOf());
}

QColor CAutoRichEditCtrl::ColourOf(const std::string& name) const {
  const TokenStyle style = StyleOfName(name, source.Core());
  return ReadableColour(style.colour, palette().color(QPalette::Base));
}

bool CAutoRichEditCtrl::event(QEvent* happened) {
  // Before Tab leaves the field.
  if (keys != nullptr && happened->type() == QEvent::KeyPress &&
      keys->TakesKey(static_cast<QKeyEvent&>(*happened)))
    return true;
  if (happened->type() != QEvent::ToolTip) return CPlainTextField::event(happened);
  const auto* help = static_cast<QHelpEvent*>(happened);
  // An empty tip takes the present one away.
  QToolTip::showText(help->globalPos(), TipAt(viewport()->mapFrom(this, help->pos())), this);
  return true;
}

void CAutoRichEditCtrl::keyPressEvent(QKeyEvent* key) {
  CPlainTextField::keyPressEvent(key);
  if (keys != nullptr) keys->FollowKey(*key);
}

void CAutoRichEditCtrl::mouseMoveEvent(QMouseEvent* move) {
  CPlainTextField::mouseMoveEvent(move);
  viewport()->setCursor(LinkAt(move->pos()) == Uid::None ? Qt::IBeamCursor : Qt::PointingHandCursor);
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
  if (change->type() != QEvent::PaletteChange) return;
  // Another palette wants other colours.
  isStale = true;
  looksChangedBefore = true;
  FollowText();
  ReportText();
}

}  // namespace tessal
