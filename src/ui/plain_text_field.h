// A field of several lines that holds plain text and nothing else: what is pasted loses its looks, zero bytes
// are dropped, and nothing is taken beyond the limit of a field.
#pragma once

#include <QTextEdit>

namespace tessal {

/// The most characters that a field of a form takes. A text that came longer from a file stays as it is.
inline constexpr int kMostCharacters = 4096;

class CPlainTextField : public QTextEdit {
  Q_OBJECT

 public:
  explicit CPlainTextField(QWidget* parent);

  /// Replaces the content. The caret is at the start, and nothing is left to undo.
  void ShowText(const QString& text);
  /// The content to the letter, lines separated by line feeds.
  QString ContentText() const;
  /// Whether the content is another than the one shown last.
  bool IsEdited() const { return ContentText() != shown; }
  /// From now on the present content is the one that counts as shown, and nothing is left to undo.
  void TakeAsShown();
  /// Replaces the content as the user could, with the caret where it was.
  void Retype(const QString& text);

 protected:
  void insertFromMimeData(const QMimeData* source) override;

 private:
  void TakeOutExcess();

  QString shown;
  int limit = kMostCharacters;
  int changedAt = 0;
  int changedCount = 0;
};

}  // namespace tessal
