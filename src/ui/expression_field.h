// The field in which expressions are edited in place: coloured by meaning, with a link on every symbol. Its
// read-only twin lists the elements that use an element.
#pragma once

#include <functional>
#include <string>
#include <utility>

#include "platform/uid.h"
#include "ui/plain_text_field.h"

namespace tessal {

class CExpressionHighlighter;
class CTessalDoc;

/// What takes part in the keys of a field that is typed into.
class ExpressionKeys {
 public:
  virtual ~ExpressionKeys() = default;
  /// Before the field acts on a key; true when it is not to.
  virtual bool TakesKey(QKeyEvent& key) = 0;
  /// After the field has acted on it.
  virtual void FollowKey(const QKeyEvent& key) = 0;

 protected:
  ExpressionKeys() = default;
  ExpressionKeys(const ExpressionKeys&) = default;
  ExpressionKeys& operator=(const ExpressionKeys&) = default;
};

class CAutoRichEditCtrl final : public CPlainTextField {
  Q_OBJECT

 public:
  CAutoRichEditCtrl(const CTessalDoc& shownDocument, QWidget* parent);

  /// Replaces the content; the caret is at the start. The colours follow the text, for as long as it scans
  /// cleanly.
  void SetColouredText(const std::string& text);

  /// The tip for a point of the viewport, as rich text; empty for none.
  QString TipAt(const QPoint& point) const;
  /// The identity of the element that the text under a point of the viewport names, 0 for none.
  Uid LinkAt(const QPoint& point) const;
  /// The colour in which a name is shown.
  QColor ColourOf(const std::string& name) const;

  /// Where further tips come from, as rich text: by the word at a position, which may be empty, and by the
  /// position.
  using TipSource = std::function<QString(const std::string& word, int position)>;
  void SetTips(TipSource further) { tips = std::move(further); }
  /// Keys go by a helper from now on, which must live as long as the field.
  void SetKeys(ExpressionKeys& helper) { keys = &helper; }

  /// What is shown while the pointer rests on an element's link: its kind and its description.
  QString TipOf(Uid uid) const;

 signals:
  /// The text has become another, or its colours are looked up again. What Qt reports counts colours too.
  void ContentChanged();
  /// A link was clicked with the right button, or the menu was asked for while the caret was on it.
  void LinkActivated(Uid uid);

 protected:
  bool event(QEvent* happened) override;
  void keyPressEvent(QKeyEvent* key) override;
  void mouseMoveEvent(QMouseEvent* move) override;
  void contextMenuEvent(QContextMenuEvent* request) override;
  void changeEvent(QEvent* change) override;

 private:
  /// Looks the colours up when the text has changed.
  void FollowText();
  void ReportText();
  /// The position of the character under a point of the viewport; -1 for none.
  int CharacterAt(const QPoint& point) const;
  Uid LinkAtCaret() const;
  /// The identity of the element with a symbol, 0 for none.
  Uid ElementNamed(const std::string& name) const;

  const CTessalDoc& source;
  CExpressionHighlighter* highlighter;
  QString coloured;                 ///< the text that the colours belong to
  bool isStale = false;             ///< the colours may be others though the text is the same
  bool looksChangedBefore = false;  ///< before the part of the text that has changed
  bool isUnreported = false;
  ExpressionKeys* keys = nullptr;
  TipSource tips;
};

}  // namespace tessal
