// The field in which expressions are edited in place: coloured by meaning, with a link on every symbol. Its
// read-only twin lists the elements that use an element.
#pragma once

#include <QTextEdit>
#include <functional>
#include <string>

namespace tessal {

class TemplateCore;

class CAutoRichEditCtrl final : public QTextEdit {
  Q_OBJECT

 public:
  CAutoRichEditCtrl(const TemplateCore& templateCore, QWidget* parent);

  /// Replaces the content, and colours it when it scans cleanly. The caret stands at the start.
  void SetColouredText(const std::string& text);

  /// The parser's message on the present content; empty when it parses. Leaves no trace in the scanner.
  QString ParserMessage() const;

 signals:
  /// A link was clicked with the right button.
  void LinkActivated(std::uint32_t uid);

 protected:
  bool event(QEvent* happened) override;
  void contextMenuEvent(QContextMenuEvent* request) override;
  void changeEvent(QEvent* change) override;
  void insertFromMimeData(const QMimeData* source) override;

 private:
  void Colour();
  /// The identity of the element whose link lies at a point of the viewport, 0 for none.
  std::uint32_t LinkAt(const QPoint& point) const;
  QString TipOf(std::uint32_t uid) const;

  const TemplateCore& core;
  std::string content;
};

}  // namespace tessal
