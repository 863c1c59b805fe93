// The pane that finds in the whole template, and replaces: what to look for, what was found, and a preview of
// each change before it is made.
#pragma once

#include <QFrame>

#include "core/find.h"
#include "core/replace.h"

class QCheckBox;
class QComboBox;
class QGridLayout;
class QLabel;
class QLineEdit;
class QPushButton;

namespace tessal {

class CFoundList;
class CTessalDoc;

class CFindPane final : public QFrame {
  Q_OBJECT

 public:
  CFindPane(CTessalDoc& searchedDocument, QWidget* parent);

  /// Shows the pane with the pattern's field ready to type over; a text that is given is the new pattern.
  void Begin(const QString& pattern);
  /// Shows the pane with the uses of a name.
  void ShowUses(const QString& name);
  /// Goes so many rows of what was found further.
  void GoToRow(int step);
  bool HasRows() const;

 signals:
  /// What is being entered is to be in the template from here on.
  void AboutToRead();
  void PlaceChosen(const FoundText& found, const TextMatch& match);
  /// Texts of the template have been replaced.
  void Replaced();
  /// The pane is about to be seen.
  void Opening();
  void Closed();

 protected:
  void keyPressEvent(QKeyEvent* key) override;

 private:
  void BuildFindRow(QGridLayout& grid);
  void BuildReplaceRow(QGridLayout& grid);
  void BuildOptions(QGridLayout& grid);
  QLineEdit* AddLine(QGridLayout& grid, int row, const QString& label);
  QPushButton* AddButton(QGridLayout& grid, int row, int column, const QString& text,
                         void (CFindPane::*run)());
  QCheckBox* AddOption(const QString& text);

  FindQuery Query() const;
  void Find();
  void Preview();
  void Replace();
  /// Shows the pane, in a splitter at a height that shows some rows.
  void OpenUp();
  void CloseUp();
  /// The pattern, the replacement or an option is another: a preview holds no longer.
  void DropPreview();
  void ShowRows(const QString& state);
  void UpdateReplace();
  void ChooseRow(int row);

  CTessalDoc& document;
  QLineEdit* pattern = nullptr;
  QLineEdit* replacement = nullptr;
  QComboBox* where = nullptr;
  QCheckBox* matchCase = nullptr;
  QCheckBox* wholeSymbols = nullptr;
  QCheckBox* regex = nullptr;
  QPushButton* replace = nullptr;
  QLabel* state = nullptr;
  CFoundList* list = nullptr;
};

}  // namespace tessal
