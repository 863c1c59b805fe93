#include "pictures/question_answers.h"

#include <QAbstractButton>
#include <QApplication>
#include <QDialog>
#include <QLabel>
#include <utility>

namespace tessal::pictures {

QuestionAnswers::QuestionAnswers() {
  constexpr int kInterval = 10;
  connect(&timer, &QTimer::timeout, this, &QuestionAnswers::Look);
  timer.start(kInterval);
}

void QuestionAnswers::Look() {
  auto* dialog = qobject_cast<QDialog*>(QApplication::activeModalWidget());
  if (dialog == nullptr || !dialog->isVisible()) return;
  if (answers.isEmpty()) {
    failure = QStringLiteral("an unexpected question: ") + dialog->windowTitle();
    for (const QLabel* label : dialog->findChildren<QLabel*>()) failure += u' ' + label->text();
    dialog->reject();
    return;
  }
  const QuestionAnswer answer = answers.takeFirst();
  // The pictures look while the question waits.
  timer.stop();
  if (answer.look) answer.look();
  timer.start();
  Press(*dialog, answer.buttons);
}

void QuestionAnswers::Press(QWidget& dialog, const QStringList& buttons) {
  for (const QString& text : buttons) {
    bool isPressed = false;
    for (QAbstractButton* button : dialog.findChildren<QAbstractButton*>()) {
      if (isPressed || button->text().remove(u'&') != text) continue;
      isPressed = button->isEnabled();
      button->click();
    }
    if (!isPressed) {
      failure = QStringLiteral("a question has no button ") + text;
      dialog.close();
      return;
    }
  }
}

}  // namespace tessal::pictures
