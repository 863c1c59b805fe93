// Answers the questions of the editor as a user does: by its buttons.
#pragma once

#include <QObject>
#include <QSet>
#include <QStringList>
#include <QTimer>
#include <functional>

class QDialog;

namespace tessal::pictures {

struct QuestionAnswer {
  QStringList buttons;         ///< pressed one after the other
  std::function<void()> look;  ///< called while the question is on the screen; may be empty
};

class QuestionAnswers final : public QObject {
  Q_OBJECT

 public:
  QuestionAnswers();

  void Add(QuestionAnswer answer) { answers.append(std::move(answer)); }
  int Left() const { return static_cast<int>(answers.size()); }
  /// What went wrong: a question that nobody expected, or a button that there is not. Empty otherwise.
  QString Failure() const { return failure; }

 private:
  void Look();
  void Press(QWidget& dialog, const QStringList& buttons);

  QTimer timer;
  QList<QuestionAnswer> answers;
  QString failure;
};

}  // namespace tessal::pictures
