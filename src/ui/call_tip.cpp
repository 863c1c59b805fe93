#include "ui/call_tip.h"

#include <QKeyEvent>
#include <QScreen>
#include <QTextDocumentFragment>
#include <QToolTip>
#include <algorithm>

#include "core/document.h"
#include "expr/caret_context.h"
#include "ui/function_tips.h"
#include "ui/text_places.h"

namespace tessal {

CCallTip::CCallTip(CAutoRichEditCtrl& shownField, const CTessalDoc& shownDocument)
    : QLabel(&shownField, Qt::ToolTip | Qt::FramelessWindowHint | Qt::WindowDoesNotAcceptFocus),
      field(shownField),
      document(shownDocument) {
  constexpr int kMargin = 4;
  setTextFormat(Qt::RichText);
  setMargin(kMargin);
  setFrameShape(QFrame::Box);
  setPalette(QToolTip::palette());
  setBackgroundRole(QPalette::ToolTipBase);
  setForegroundRole(QPalette::ToolTipText);
  setAttribute(Qt::WA_ShowWithoutActivating);
  hide();
  connect(&field, &QTextEdit::cursorPositionChanged, this, &CCallTip::FollowCaret);
  field.installEventFilter(this);
}

bool CCallTip::eventFilter(QObject* watched, QEvent* happened) {
  const QEvent::Type type = happened->type();
  if (type == QEvent::FocusIn) FollowCaret();
  if (type == QEvent::Hide) hide();
  // The list of completions takes the focus for a while.
  if (type == QEvent::FocusOut && static_cast<QFocusEvent*>(happened)->reason() != Qt::PopupFocusReason)
    hide();
  const bool isEscape = (type == QEvent::KeyPress || type == QEvent::ShortcutOverride) &&
                        static_cast<QKeyEvent*>(happened)->key() == Qt::Key_Escape;
  if (!isEscape || !isVisible()) return QLabel::eventFilter(watched, happened);
  happened->accept();
  if (type == QEvent::KeyPress) {
    const QString text = field.ContentText();
    const std::string bytes = text.toStdString();
    const auto call = ContextAt(bytes, BytesBefore(text, field.textCursor().position())).call;
    dismissed = call ? static_cast<int>(call->name.start) : -1;
    hide();
  }
  return true;
}

void CCallTip::FollowCaret() {
  const QString text = field.ContentText();
  const std::string bytes = text.toStdString();
  const auto call = ContextAt(bytes, BytesBefore(text, field.textCursor().position())).call;
  const int start = call ? static_cast<int>(call->name.start) : -1;
  if (start != dismissed) dismissed = -1;
  QString tip;
  if (call && dismissed < 0 && !field.isReadOnly() && field.hasFocus()) {
    tip = TipOfCall(document.Core(), bytes.substr(call->name.start, call->name.length), call->argument);
  }
  // For those who do not see it.
  field.setAccessibleDescription(QTextDocumentFragment::fromHtml(tip).toPlainText());
  if (tip.isEmpty()) {
    hide();
    return;
  }
  setText(tip);
  Place();
  show();
}

void CCallTip::Place() {
  constexpr int kGap = 4;
  adjustSize();
  const QRect caret = field.cursorRect();
  QPoint corner = field.viewport()->mapToGlobal(caret.topLeft()) - QPoint(0, height() + kGap);
  const QRect screen = field.screen()->availableGeometry();
  corner.setX(std::clamp(corner.x(), screen.left(), std::max(screen.left(), screen.right() - width())));
  if (corner.y() < screen.top()) corner.setY(field.viewport()->mapToGlobal(caret.bottomLeft()).y() + kGap);
  move(corner);
}

}  // namespace tessal
