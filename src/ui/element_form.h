// The forms of the elements: one implementation over tables of fields. A form class is its table and what is
// truly its own.
#pragma once

#include <QString>
#include <span>
#include <string>
#include <vector>

#include "ui/right_pane.h"

class QComboBox;
class QGridLayout;
class QLabel;
class QLineEdit;

namespace tessal {

class CAutoRichEditCtrl;
class CEL_Property;

enum class FieldEditor {
  Symbol,         ///< one line; a change is a rename
  Line,           ///< one line of text
  ShortLine,      ///< one line of a word or two
  Lines,          ///< several lines of text
  Documentation,  ///< one line, with buttons to browse for a file and to open it
  Number,         ///< a real
  Integer,
  Shown,          ///< a value that is shown and never stored
  SortedChoice,   ///< a combo box, its entries by caption
  OrderedChoice,  ///< a combo box, its entries in the order of the choices
  Expression,     ///< a coloured field, with the parser's message under it
  ReferencedIn    ///< the names of the users, as links
};

/// One field: the number of its control, its label, and the property that it shows.
struct FormField {
  int control;
  const char* label;
  FieldEditor editor;
  CEL_Property& (*property)(CEL_Element& element);
  /// What else the field's behaviour hangs on.
  bool onlyWhileEnabled = false;
};

/// A form: its class, its dialog and help numbers and its fields, in the order in which they are loaded.
struct FormTable {
  ElementKind kind;
  int dialog;
  int help;
  std::span<const FormField> fields;
};

class CElementForm : public CRightPaneBase {
  Q_OBJECT

 public:
  CElementForm(const FormTable& formTable, const FormContext& context, QWidget* parent);

  int HelpNumber() const override { return table.help; }
  QSize minimumSizeHint() const override;

 protected:
  void resizeEvent(QResizeEvent* resize) override;
  void ItemToForm() override;
  void FormToItem() override;

  struct Control {
    const FormField* field = nullptr;
    QWidget* editor = nullptr;
    QLabel* label = nullptr;
    QWidget* cell = nullptr;  ///< the editor with what stands beside it
    QLabel* note = nullptr;   ///< under an expression: what the parser says
    QString shown;            ///< the text that the last load gave a line
  };

  /// Whether a control may be used; the property's flag, unless the form knows better.
  virtual bool IsEnabled(const FormField& field, const CEL_Property& property) const;
  /// Writes the fields behind the symbol; true when any has changed.
  virtual bool StoreFields(CEL_Element& element);
  bool Store(const Control& control, CEL_Element& element);
  const std::vector<Control>& Controls() const { return controls; }

 private:
  void AddField(const FormField& field);
  /// Lays the fields out; short ones share a row when there are two columns.
  void Arrange(int columnCount);
  /// Makes the editor of a field. The cell that it stands in may hold more beside it.
  QWidget* MakeEditor(const FormField& field, Control& control);
  QLineEdit* MakeLine(const FormField& field, QWidget* parent);
  QWidget* MakeLines();
  QWidget* MakeCombo();
  QWidget* MakeReferences();
  QWidget* MakeDocumentation(const FormField& field, Control& control);
  QWidget* MakeExpression(const FormField& field, Control& control);

  void Show(Control& control, CEL_Element& element);
  static void FillCombo(QComboBox& combo, FieldEditor editor, const CEL_Property& property, bool enabled);
  std::string ReferrerText(const CEL_Element& element) const;
  void JumpTo(Uid uid);
  static bool IsEdited(const Control& control);
  static bool StoreText(const QString& text, CEL_Property& property);
  static bool StoreNumber(const QString& text, CEL_Property& property);
  static bool StoreChoice(const QComboBox& combo, CEL_Property& property);

  void BrowseDocumentation(QLineEdit& line);
  void OpenDocumentation(const QString& text);

  const FormTable& table;
  std::vector<Control> controls;
  QGridLayout* layout;
  int columns = 0;
  int narrowWidth = 0;  ///< what one column needs
};

}  // namespace tessal
