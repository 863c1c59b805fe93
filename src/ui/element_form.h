// The forms of the elements: one implementation over tables of fields. A form class is its table.
#pragma once

#include <QString>
#include <span>
#include <string>
#include <vector>

#include "ui/control_ids.h"
#include "ui/right_pane.h"

class QComboBox;
class QGridLayout;
class QGroupBox;
class QSplitter;
class QLabel;
class QLineEdit;

namespace tessal {

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
  Count,          ///< how many there are of something; in the box of the counts
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
  /// Whether the field is left unwritten while it is locked.
  bool onlyWhileEnabled = false;
  /// The control whose change brings this field's value with it: then the one shown is not stored.
  int follows = 0;
  /// Whether the field may be used in a template; without it the property says so.
  bool (*isOpen)(const TemplateCore& core) = nullptr;
  /// What a count counts.
  std::size_t (*count)(const TemplateCore& core, const CEL_Element& element) = nullptr;
  /// The button under an expression.
  int button = control_id::kKeypad;
};

constexpr FormField CountField(int control, const char* label,
                               std::size_t (*count)(const TemplateCore& core, const CEL_Element& element)) {
  FormField field{control, label, FieldEditor::Count, nullptr};
  field.count = count;
  return field;
}

/// The fields of a form, in the order in which they are loaded.
using FormTable = std::span<const FormField>;

class CElementForm : public CRightPaneBase {
  Q_OBJECT

 public:
  CElementForm(FormTable fields, const FormContext& context, QWidget* parent);

  QSize minimumSizeHint() const override;

 protected:
  void resizeEvent(QResizeEvent* resize) override;
  void ItemToForm() override;
  void FormToItem() override;

  /// Writes the fields after the symbol; true when any has changed.
  virtual bool StoreFields(CEL_Element& element);
  /// Writes the field with the number of its control; true when it has changed.
  bool StoreField(int control, CEL_Element& element);
  /// Puts a widget under the fields.
  void AddUnder(QWidget* widget);
  /// The folder in which a relative path of a documentation file is looked for first; empty for none.
  virtual QString DocumentationFolder() const { return {}; }
  virtual void OnDocumentationChosen() { NoteEdited(); }

 private:
  struct Control {
    const FormField* field = nullptr;
    QWidget* editor = nullptr;
    QLabel* label = nullptr;
    QWidget* cell = nullptr;  ///< the editor with what lies beside it
    QLabel* note = nullptr;   ///< under an expression: what the parser says
    QString shown;            ///< the text that the last load gave a line
  };

  bool IsEnabled(const FormField& field, const CEL_Property& property) const;
  bool Store(const Control& control, CEL_Element& element);
  void AddField(const FormField& field);
  /// Lays out the counts side by side in their box.
  void ArrangeCounts();
  /// Lays the fields out; short ones share a row when there are two columns.
  void Arrange(int columnCount);
  /// Makes the editor of a field. The cell that it lies in may hold more beside it.
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
  static bool IsEdited(const Control& control);
  static bool StoreText(const QString& text, CEL_Property& property);
  static bool StoreNumber(const QString& text, CEL_Property& property);
  static bool StoreChoice(const QComboBox& combo, CEL_Property& property);

  void BrowseDocumentation(QLineEdit& line);
  void OpenDocumentation(const QString& text);

  std::vector<Control> controls;
  std::vector<QWidget*> under;
  QGroupBox* counts = nullptr;       ///< holds the counts, in a form that has some
  QSplitter* expressions = nullptr;  ///< holds the expressions, in a form with more than one
  QGridLayout* layout;
  int columns = 0;
  int narrowWidth = 0;  ///< what one column needs
};

}  // namespace tessal
