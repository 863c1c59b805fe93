#include "ui/element_form.h"

#include <QComboBox>
#include <QFileInfo>
#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QStandardItemModel>
#include <algorithm>
#include <charconv>
#include <cmath>

#include "core/document.h"
#include "elements/property_io.h"
#include "ui/dialogs.h"
#include "ui/documentation_link.h"
#include "ui/expression_editor_dialog.h"
#include "ui/expression_field.h"
#include "ui/focus_watch.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

/// The most characters that a text field takes.
constexpr int kMostCharacters = 4096;
constexpr int kLinesHeight = 3;

bool IsTall(FieldEditor editor) {
  return editor == FieldEditor::Expression;
}

/// The number at the start of a text by the rules of files, whatever the user's language; 0 without one.
double ReadNumber(const QString& text) {
  std::string digits = text.toStdString();
  if (!digits.empty() && digits.front() == '+') digits.erase(0, 1);
  double value = 0.0;
  std::from_chars(digits.data(), digits.data() + digits.size(), value);
  return value;
}

QString TextIn(const QWidget& editor) {
  if (const auto* line = qobject_cast<const QLineEdit*>(&editor)) return line->text();
  if (const auto* lines = qobject_cast<const QPlainTextEdit*>(&editor)) return lines->toPlainText();
  if (const auto* field = qobject_cast<const CAutoRichEditCtrl*>(&editor)) return field->toPlainText();
  return {};
}

}  // namespace

CElementForm::CElementForm(const FormTable& formTable, const FormContext& context, QWidget* parent)
    : CRightPaneBase(context, parent), table(formTable) {
  auto* layout = new QGridLayout(this);
  layout->setColumnStretch(1, 1);
  int row = 0;
  bool grows = false;
  for (const FormField& field : table.fields) {
    AddField(field, *layout, row);
    if (IsTall(field.editor)) {
      layout->setRowStretch(row, 1);
      grows = true;
    }
    ++row;
  }
  if (!grows) layout->setRowStretch(row, 1);
}

void CElementForm::AddField(const FormField& field, QGridLayout& layout, int row) {
  QWidget* cell = nullptr;
  QLabel* note = nullptr;
  QWidget* editor = MakeEditor(field, cell, note);
  editor->setObjectName(QString::number(field.control));
  editor->setAccessibleName(QString::fromLatin1(field.label));
  auto* label = new QLabel(QString::fromLatin1(field.label), this);
  label->setBuddy(editor);
  layout.addWidget(label, row, 0, Qt::AlignTop);
  layout.addWidget(cell, row, 1);
  controls.push_back({&field, editor, label, note});
}

QWidget* CElementForm::MakeEditor(const FormField& field, QWidget*& cell, QLabel*& note) {
  switch (field.editor) {
    case FieldEditor::Lines:
      return cell = MakeLines();
    case FieldEditor::Documentation: {
      QLineEdit* line = nullptr;
      cell = MakeDocumentation(line);
      return line;
    }
    case FieldEditor::SortedChoice:
    case FieldEditor::OrderedChoice:
      return cell = MakeCombo(field);
    case FieldEditor::Expression: {
      CAutoRichEditCtrl* edit = nullptr;
      cell = MakeExpression(field, edit, note);
      return edit;
    }
    case FieldEditor::ReferencedIn: {
      auto* names = new CAutoRichEditCtrl(Core(), this);
      names->setReadOnly(true);
      names->setMaximumHeight(names->fontMetrics().lineSpacing() * (kLinesHeight + 1));
      connect(names, &CAutoRichEditCtrl::LinkActivated, this, [this](std::uint32_t uid) {
        const NumberHint argument(static_cast<std::int32_t>(uid));
        Document().UpdateAllViews(nullptr, hint::kSelectElement, &argument);
      });
      return cell = names;
    }
    default:
      return cell = MakeLine(field);
  }
}

QWidget* CElementForm::MakeLine(const FormField& field) {
  auto* line = new QLineEdit(this);
  line->setMaxLength(kMostCharacters);
  line->setReadOnly(field.editor == FieldEditor::Shown);
  connect(line, &QLineEdit::textEdited, this, [this] { NoteEdited(); });
  connect(line, &QLineEdit::editingFinished, this, [this] { NoteFocusLost(); });
  return line;
}

QWidget* CElementForm::MakeLines() {
  auto* lines = new QPlainTextEdit(this);
  lines->setTabChangesFocus(true);
  lines->setMaximumHeight(lines->fontMetrics().lineSpacing() * (kLinesHeight + 1));
  connect(lines, &QPlainTextEdit::textChanged, this, [this] { NoteEdited(); });
  WatchFocusLoss(*lines, [this] { NoteFocusLost(); });
  return lines;
}

QWidget* CElementForm::MakeCombo(const FormField& /*field*/) {
  auto* combo = new QComboBox(this);
  combo->setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
  connect(combo, &QComboBox::activated, this, [this] { NoteChosen(); });
  return combo;
}

QWidget* CElementForm::MakeDocumentation(QLineEdit*& line) {
  auto* cell = new QWidget(this);
  auto* layout = new QHBoxLayout(cell);
  layout->setContentsMargins(0, 0, 0, 0);
  line = qobject_cast<QLineEdit*>(MakeLine({0, "", FieldEditor::Documentation, nullptr}));
  auto* browse = new QPushButton(strings::kBrowse, cell);
  browse->setAccessibleName(strings::kSelectDocumentation);
  browse->setObjectName(QStringLiteral("1021"));
  auto* view = new QPushButton(strings::kView, cell);
  view->setAccessibleName(QStringLiteral("Open documentation"));
  view->setObjectName(QStringLiteral("1129"));
  layout->addWidget(line, 1);
  layout->addWidget(browse);
  layout->addWidget(view);
  connect(browse, &QPushButton::clicked, this, [this, line] { BrowseDocumentation(*line); });
  connect(view, &QPushButton::clicked, this, [this, line] { OpenDocumentation(line->text()); });
  return cell;
}

QWidget* CElementForm::MakeExpression(const FormField& field, CAutoRichEditCtrl*& edit, QLabel*& note) {
  auto* cell = new QWidget(this);
  auto* layout = new QVBoxLayout(cell);
  layout->setContentsMargins(0, 0, 0, 0);
  edit = new CAutoRichEditCtrl(Core(), cell);
  note = new QLabel(cell);
  note->setTextFormat(Qt::PlainText);
  note->setWordWrap(true);
  note->setAccessibleName(QStringLiteral("Parser message of %1").arg(QString::fromLatin1(field.label)));
  auto* keypad = new QPushButton(strings::kEdit, cell);
  keypad->setAccessibleName(strings::kExpressionEditor);
  layout->addWidget(edit, 1);
  layout->addWidget(note);
  layout->addWidget(keypad, 0, Qt::AlignRight);
  connect(edit, &QTextEdit::textChanged, this,
          [edit = edit, note = note] { note->setText(edit->ParserMessage()); });
  connect(edit, &CAutoRichEditCtrl::LinkActivated, this, [this](std::uint32_t uid) {
    const NumberHint argument(static_cast<std::int32_t>(uid));
    Document().UpdateAllViews(nullptr, hint::kSelectElement, &argument);
  });
  connect(keypad, &QPushButton::clicked, this, [this] { CExpressionEditorDlg(this).exec(); });
  return cell;
}

const CElementForm::Control* CElementForm::FindControl(int number) const {
  const auto hit = std::find_if(controls.begin(), controls.end(), [number](const Control& control) {
    return control.field->control == number;
  });
  return hit == controls.end() ? nullptr : &*hit;
}

bool CElementForm::IsEnabled(const FormField& /*field*/, const CEL_Property& property) const {
  return property.Editable();
}

void CElementForm::ItemToForm() {
  CEL_Element* element = Element();
  if (element == nullptr) return;
  for (const Control& control : controls) Show(control, *element);
  element->SetLoaded(true);
}

void CElementForm::Show(const Control& control, CEL_Element& element) {
  const FormField& field = *control.field;
  if (field.editor == FieldEditor::ReferencedIn) {
    qobject_cast<CAutoRichEditCtrl*>(control.editor)->SetColouredText(ReferrerText(element).toStdString());
    return;
  }
  const CEL_Property& property = field.property(element);
  const bool enabled = IsEnabled(field, property);
  if (auto* combo = qobject_cast<QComboBox*>(control.editor)) {
    FillCombo(*combo, property, enabled);
    return;
  }
  control.editor->setEnabled(enabled || field.editor == FieldEditor::Shown);
  const std::string text = property.TextOf();
  if (auto* line = qobject_cast<QLineEdit*>(control.editor)) {
    line->setText(ToScreen(text));
    if (!line->hasFocus()) line->setCursorPosition(0);
  } else if (auto* lines = qobject_cast<QPlainTextEdit*>(control.editor)) {
    lines->setPlainText(ToScreen(text));
  } else if (auto* expression = qobject_cast<CAutoRichEditCtrl*>(control.editor)) {
    expression->SetColouredText(text);
    control.note->setText(expression->ParserMessage());
  }
}

QString CElementForm::ReferrerText(const CEL_Element& element) const {
  std::vector<std::string> names;
  Core().GetReferrerSymbols(element.GetUid(), names);
  if (names.empty()) return strings::kNotUsed;
  QStringList shown;
  for (const std::string& name : names) shown.append(ToScreen(name));
  return shown.join(QStringLiteral(", "));
}

void CElementForm::FillCombo(QComboBox& combo, const CEL_Property& property, bool enabled) const {
  const bool sorted = FindControl(combo.objectName().toInt())->field->editor == FieldEditor::SortedChoice;
  combo.clear();
  combo.setEnabled(property.HasChoices() && enabled);
  const auto& choices = property.Choices();
  int present = property.Selected();
  for (std::size_t index = 0; index < choices.size(); ++index) {
    combo.addItem(ToScreen(choices[index].display), static_cast<int>(index));
  }
  if (sorted) combo.model()->sort(0);
  combo.setCurrentIndex(combo.findData(present));
}

void CElementForm::FormToItem() {
  CEL_Element* element = Element();
  if (element == nullptr) return;
  for (const Control& control : controls) {
    if (control.field->editor != FieldEditor::Symbol) continue;
    const std::string entered = EnteredSymbol(control, *element);
    if (entered == element->symbol.Text()) continue;
    // The other fields are not written in this commit.
    Rename(entered);
    ItemToForm();
    return;
  }
  if (StoreFields(*element)) ItemToForm();
}

std::string CElementForm::EnteredSymbol(const Control& control, const CEL_Element& element) const {
  const std::string entered = FromScreen(TextIn(*control.editor), element.symbol.Text());
  return std::string(CleanText(entered));
}

bool CElementForm::StoreFields(CEL_Element& element) {
  bool changed = false;
  for (const Control& control : controls) changed = Store(control, element) || changed;
  return changed;
}

bool CElementForm::Store(const Control& control, CEL_Element& element) {
  const FormField& field = *control.field;
  const bool stored = field.editor != FieldEditor::Symbol && field.editor != FieldEditor::Shown &&
                      field.editor != FieldEditor::ReferencedIn;
  if (!stored) return false;
  CEL_Property& property = field.property(element);
  if (field.onlyWhileEnabled && !IsEnabled(field, property)) return false;
  if (const auto* combo = qobject_cast<const QComboBox*>(control.editor))
    return StoreChoice(*combo, property);
  const QString text = TextIn(*control.editor);
  const bool isNumber = field.editor == FieldEditor::Number || field.editor == FieldEditor::Integer;
  return isNumber ? StoreNumber(text, property) : StoreText(text, property);
}

bool CElementForm::StoreText(const QString& text, CEL_Property& property) const {
  if (text == ToScreen(property.Text())) return false;
  const std::string former = property.Text();
  const std::string entered = FromScreen(text, former);
  property.SetText(CleanText(entered));
  return property.Text() != former;
}

bool CElementForm::StoreNumber(const QString& text, CEL_Property& property) const {
  const std::string former = property.TextOf();
  if (text.toStdString() == former) return false;
  const double value = ReadNumber(text.trimmed());
  if (property.Type() == ValueType::Integer) {
    constexpr double kLimit = 2147483647.0;
    property.SetInt(static_cast<std::int32_t>(std::clamp(value, -kLimit - 1.0, kLimit)));
  } else if (std::isfinite(value)) {
    property.SetReal(value);
  }
  // A text that reads as the present value, or as none, gives way to the value's own text.
  return true;
}

bool CElementForm::StoreChoice(const QComboBox& combo, CEL_Property& property) const {
  const int index = combo.currentData().isValid() ? combo.currentData().toInt() : -1;
  if (index < 0 || !combo.isEnabled()) return false;
  const std::string former = property.TextOf();
  property.SelectIndex(index);
  property.ApplySelection();
  return property.TextOf() != former;
}

void CElementForm::BrowseDocumentation(QLineEdit& line) {
  QString chosen = Dialogs().ChooseDocumentationFile(this, line.text());
  if (chosen.isEmpty()) return;
  if (QFileInfo(chosen).suffix().isEmpty()) chosen += QStringLiteral(".pdf");
  line.setText(chosen);
  NoteEdited();
}

void CElementForm::OpenDocumentation(const QString& text) {
  const QString failure = OpenDocumentationFile(text, Dialogs());
  if (!failure.isEmpty()) Dialogs().Warn(this, failure);
}

}  // namespace tessal
