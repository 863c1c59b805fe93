// The field in which expressions are edited in place: coloured by meaning, with a link on every symbol. Its
// read-only twin lists the elements that use an element.
#pragma once

#include <string>

#include "platform/uid.h"
#include "ui/plain_text_field.h"

namespace tessal {

class TemplateCore;

class CAutoRichEditCtrl final : public CPlainTextField {
  Q_OBJECT

 public:
  CAutoRichEditCtrl(const TemplateCore& templateCore, QWidget* parent);

  /// Replaces the content, and colours it when it scans cleanly. The caret is at the start.
  void SetColouredText(const std::string& text);

  /// The parser's message on the present content; empty when it parses. Leaves no trace in the scanner.
  QString ParserMessage() const;

  /// The identity of the element whose link lies at a point of the viewport, 0 for none.
  Uid LinkAt(const QPoint& point) const;
  /// What is shown while the pointer rests on an element's link: its kind and its description.
  QString TipOf(Uid uid) const;

 signals:
  /// A link was clicked with the right button, or the menu was asked for while the caret was on it.
  void LinkActivated(Uid uid);

 protected:
  bool event(QEvent* happened) override;
  void mouseMoveEvent(QMouseEvent* move) override;
  void contextMenuEvent(QContextMenuEvent* request) override;
  void changeEvent(QEvent* change) override;

 private:
  void Colour();
  Uid LinkAtCaret() const;
  /// The identity of the element with a symbol, 0 for none.
  Uid ElementNamed(const QString& name) const;

  const TemplateCore& core;
  std::string content;
};

}  // namespace tessal
