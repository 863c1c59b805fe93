// An expression as mathematics, while it is typed. A text that does not parse leaves the formula before it,
// greyed. Wide formulas shrink a little, then scroll.
#pragma once

#include <QAbstractScrollArea>
#include <optional>
#include <string>

#include "platform/docview.h"
#include "ui/formula_layout.h"

namespace tessal {

class TemplateCore;

class CFormulaPreview final : public QAbstractScrollArea {
  Q_OBJECT

 public:
  CFormulaPreview(const TemplateCore& templateCore, QWidget* parent);

  /// Shows a text, in UTF-8, as the right side of what it is an expression of.
  void Show(const std::string& expression, FormulaLeftSide side);

  /// The height that shows the formula whole, with its frame.
  int WantedHeight() const;
  /// The least height in which something can be seen.
  int LeastHeight() const;

 signals:
  /// Another height is wanted.
  void HeightChanged();

 protected:
  void paintEvent(QPaintEvent* paint) override;
  void resizeEvent(QResizeEvent* resize) override;
  void changeEvent(QEvent* change) override;
  void contextMenuEvent(QContextMenuEvent* request) override;
  void keyPressEvent(QKeyEvent* key) override;

 private:
  enum class State : std::uint8_t { Empty, Current, Former, TooLarge };

  FormulaStyle StyleOn(const QPalette& palette) const;
  void LayOut();
  void Describe();
  void UpdateBars();
  qreal Scale() const;
  void CopyMathML() const;
  void CopyLatex() const;
  void CopyPicture() const;

  const TemplateCore& core;
  std::string typed;  ///< the present text
  std::string shown;  ///< the text of the formula
  FormulaLeftSide left;
  State state = State::Empty;
  std::optional<FormulaLayout> formula;
};

/// Whether expressions are shown as formulas too: the user's choice, kept in the settings. A change reaches
/// all previews at once.
bool ShowsFormulas();
void ShowFormulas(bool shown);
/// The switch in the menu of views.
ViewCommand FormulasCommand();

}  // namespace tessal
