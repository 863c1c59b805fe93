#include "ui/plain_text_field.h"

#include <QMimeData>
#include <QSignalBlocker>
#include <algorithm>

namespace tessal {

CPlainTextField::CPlainTextField(QWidget* parent) : QTextEdit(parent) {
  setAcceptRichText(false);
  setTabChangesFocus(true);
  connect(document(), &QTextDocument::contentsChange, this, [this](int position, int /*removed*/, int added) {
    changedAt = position;
    changedCount = added;
  });
  connect(this, &QTextEdit::textChanged, this, &CPlainTextField::TakeOutExcess);
}

void CPlainTextField::ShowText(const QString& text) {
  limit = std::max(kMostCharacters, static_cast<int>(text.size()));
  {
    // Who hears of the change finds it as the one shown.
    const QSignalBlocker quiet(this);
    setPlainText(text);
    TakeAsShown();
  }
  moveCursor(QTextCursor::Start);
  emit textChanged();
}

void CPlainTextField::TakeAsShown() {
  shown = ContentText();
  // What was typed is taken back with the step that has stored it.
  document()->clearUndoRedoStacks();
}

void CPlainTextField::Retype(const QString& text) {
  QTextCursor caret = textCursor();
  const int place = caret.position();
  caret.select(QTextCursor::Document);
  caret.insertText(text);
  caret.setPosition(std::min(place, static_cast<int>(text.size())));
  setTextCursor(caret);
}

QString CPlainTextField::ContentText() const {
  QString text = document()->toRawText();
  text.replace(QChar::ParagraphSeparator, u'\n');
  text.replace(QChar::LineSeparator, u'\n');
  return text;
}

void CPlainTextField::TakeOutExcess() {
  // After the last character comes the end of the document.
  const int excess = document()->characterCount() - 1 - limit;
  if (excess <= 0) return;
  const int end = std::min(changedAt + changedCount, document()->characterCount() - 1);
  QTextCursor cursor(document());
  cursor.joinPreviousEditBlock();
  cursor.setPosition(std::max(end - excess, 0));
  cursor.setPosition(end, QTextCursor::KeepAnchor);
  cursor.removeSelectedText();
  cursor.endEditBlock();
}

void CPlainTextField::insertFromMimeData(const QMimeData* source) {
  QString text = source->text();
  text.remove(QChar(u'\0'));
  const qsizetype room = limit - (document()->characterCount() - 1) + textCursor().selectedText().size();
  textCursor().insertText(text.left(std::max<qsizetype>(room, 0)), QTextCharFormat());
  ensureCursorVisible();
}

}  // namespace tessal
