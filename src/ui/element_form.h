// The forms of the elements: one implementation over tables of fields. A form class is its table.
#pragma once

#include <QString>
#include <cstddef>
#include <span>
#include <string>
#include <vector>

#include "ui/control_ids.h"
#include "ui/right_pane.h"

class QComboBox;
class QGridLayout;
class QGroupBox;
class QLabel;
class QLineEdit;
class QSplitter;

namespace tessal {

class CEL_Property;
class CUnitNote;

enum class FieldEditor {
  Symbol,         ///< one line; a change is a rename
  Line,           ///< one line of text
  ShortLine,      ///< one line of a word or two
  Lines,          ///< several lines of text
  Documentation,  ///< one line, with buttons to browse for a file and to open it
  Number,         ///< a real
  Integer,
  Shown,          ///< a value that is shown and never stored
  Count,          ///< a size, read-only, in the box "General overview"
  SortedChoice,   ///< a combo box, its entries by caption
  OrderedChoice,  ///< a combo box, its entries in the order of the choices
  Expression,     ///< a coloured field, with the parser's message under it; several share the form's height
  ReferencedIn    ///< the names of the users, as links
};

/// One field: the number of its control, its label, and the property that it shows; a count has none.
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
  /// The control of an expression's "Edit..." button.
  int keypad = control_id::kKeypad;
  /// What a count shows.
  std::size_t (*count)(const CEL_Element& element) = nullptr;
};

constexpr FormField CountField(int control, const char* label,
                               std::size_t (*count)(const CEL_Element& element)) {
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
  bool HasUnwritten() const override;
  std::vector<TypedValue> TypedValues() const override;
  QWidget* ShowText(const TextToShow& text) override;

 protected:
  void resizeEvent(QResizeEvent* resize) override;
  void changeEvent(QEvent* change) override;
  void ItemToForm() override;
  void FormToItem() override;
  /// Writes the fields after the symbol, in the table's order; true when any has changed. A form whose fields
  /// depend on each other writes them one by one.
  virtual bool StoreFields(CEL_Element& element);
  /// Writes the field with a control number; true when it has changed.
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
    bool isInBlock = false;   ///< lies in a block of its own under the rows
    QString shown;            ///< the text that the last load gave a line
  };

  bool IsEnabled(const FormField& field, const CEL_Property& property) const;
  /// An expression that was typed and is not written yet follows a rename of its own element.
  void RenameInTyped(const std::string& former, const std::string& present);
  /// Whether a commit would write what was typed into the control.
  bool IsTyped(const Control& control, const CEL_Property& property) const;
  bool Store(const Control& control, CEL_Element& element);
  /// Puts what was typed into the property, and leaves the control alone.
  bool StoreTyped(const Control& control, CEL_Property& property) const;
  void AddField(const FormField& field);
  /// Labels the fields, each with an Alt key of its own.
  void LabelFields();
  /// Has the label, and the editor where it has no text to point at, say what the field is for.
  static void ExplainField(const Control& control);
  void LayOut();
  /// Puts several expressions into a splitter, each with the same share of the height.
  void SplitExpressions();
  /// Puts the counts into a box of their own.
  void BoxCounts();
  /// What cannot be changed has the ground of the window.
  void FlattenReadOnlyFields();
  /// Lays the fields out; short ones share a row when there are two columns.
  void Arrange(int columnCount);
  /// Both return the last row in use.
  int ArrangeRows();
  int ArrangeBlocks(int row);
  void ArrangeNumbers(std::span<const Control> numbers, int row);
  /// Makes the editor of a field. The cell that it lies in may hold more beside it.
  QWidget* MakeEditor(const FormField& field, Control& control);
  QLineEdit* MakeLine(const FormField& field, QWidget* parent);
  QWidget* MakeLines();
  QWidget* MakeCombo(const FormField& field);
  QWidget* MakeReferences();
  QWidget* MakeDocumentation(const FormField& field, Control& control);
  QWidget* MakeExpression(const FormField& field, Control& control);
  /// The field of a unit, with what the expression says of it beside it.
  QWidget* MakeUnit(const FormField& field, Control& control);
  void ShowUnitNote();

  void Show(Control& control, CEL_Element& element);
  static void FillCombo(QComboBox& combo, const FormField& field, const CEL_Property& property, bool enabled);
  std::string ReferrerText(const CEL_Element& element) const;
  static bool IsEdited(const Control& control);
  bool StoreText(const QString& text, CEL_Property& property) const;
  static bool StoreNumber(const QString& text, CEL_Property& property);
  static bool StoreChoice(const QComboBox& combo, CEL_Property& property);

  void BrowseDocumentation(QLineEdit& line);
  void OpenDocumentation(const QString& text);

  std::vector<Control> controls;
  std::vector<QWidget*> under;
  QGridLayout* layout;
  QSplitter* split = nullptr;     ///< of a form with more than one expression
  QGroupBox* overview = nullptr;  ///< of a form with counts
  bool hasExpression = false;
  CUnitNote* unitNote = nullptr;  ///< of a form with a unit and an expression
  int columns = 0;
  int narrowWidth = 0;  ///< what one column needs
  int wideWidth = 0;    ///< what two columns need
};

}  // namespace tessal
