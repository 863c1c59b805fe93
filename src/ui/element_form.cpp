#include "ui/element_form.h"

#include <QComboBox>
#include <QFileInfo>
#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTimer>
#include <algorithm>
#include <charconv>
#include <cmath>
#include <limits>

#include "core/document.h"
#include "core/rename.h"
#include "elements/format_words.h"
#include "elements/property_io.h"
#include "ui/alt_keys.h"
#include "ui/child.h"
#include "ui/dialogs.h"
#include "ui/documentation_link.h"
#include "ui/expression_editor_dialog.h"
#include "ui/expression_field.h"
#include "ui/expression_panel.h"
#include "ui/focus_watch.h"
#include "ui/label.h"
#include "ui/plain_tip.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"
#include "ui/unit_note.h"

namespace tessal {

namespace {

constexpr std::string_view kUnitLabel = "Unit";

/// The number at the start of a text by the rules of files, whatever the user's language; 0 without one.
double ReadNumber(const QString& text) {
  const std::string entered = text.toStdString();
  std::string_view digits = entered;
  if (!digits.empty() && digits.front() == '+') digits.remove_prefix(1);
  double value = 0.0;
  std::from_chars(digits.data(), digits.data() + digits.size(), value);
  return value;
}

QString TextIn(const QWidget& editor) {
  if (const auto* line = qobject_cast<const QLineEdit*>(&editor)) return line->text();
  if (const auto* field = qobject_cast<const CPlainTextField*>(&editor)) return field->ContentText();
  return {};
}

/// Marks a part of the text that an editor shows; one that shows a shorter text marks what there is.
void MarkIn(QWidget& editor, int start, int length) {
  if (auto* line = qobject_cast<QLineEdit*>(&editor)) {
    line->setSelection(start, length);
  } else if (auto* field = qobject_cast<CPlainTextField*>(&editor)) {
    const int end = field->document()->characterCount() - 1;
    QTextCursor cursor(field->document());
    cursor.setPosition(std::min(start, end));
    cursor.setPosition(std::min(start + length, end), QTextCursor::KeepAnchor);
    field->setTextCursor(cursor);
    field->ensureCursorVisible();
  }
}

/// Whether a commit writes the field. A symbol is renamed in a way of its own.
bool IsStored(FieldEditor editor) {
  switch (editor) {
    case FieldEditor::Symbol:
    case FieldEditor::Shown:
    case FieldEditor::Count:
    case FieldEditor::ReferencedIn:
      return false;
    default:
      return true;
  }
}

QString Meaning(const FormField& field) {
  const std::string_view meaning = MeaningOfField(field.label);
  return QString::fromUtf8(meaning.data(), static_cast<qsizetype>(meaning.size()));
}

QString MeaningOf(const FormField& field, const QString& choice) {
  return QString::fromStdString(MeaningOfChoice(field.label, choice.toStdString()));
}

/// Has a closed combo box explain its field, and in a line below the choice that it shows.
void ShowChoiceTip(QComboBox& combo, const FormField& field) {
  QStringList lines(Meaning(field));
  const QString meaning = MeaningOf(field, combo.currentText());
  if (!meaning.isEmpty()) lines.append(combo.currentText() + QStringLiteral(": ") + meaning);
  combo.setToolTip(PlainTip(lines.join(u'\n')).replace(u'\n', QStringLiteral("<br>")));
}

}  // namespace

CElementForm::CElementForm(FormTable fields, const FormContext& context, QWidget* parent)
    : CRightPaneBase(context, parent), layout(MakeChild<QGridLayout>(this)) {
  hasExpression = std::any_of(fields.begin(), fields.end(),
                              [](const FormField& field) { return field.editor == FieldEditor::Expression; });
  for (const FormField& field : fields) AddField(field);
  LabelFields();
  LayOut();
}

void CElementForm::AddField(const FormField& field) {
  Control control;
  control.field = &field;
  control.cell = MakeEditor(field, control);
  control.editor->setObjectName(QString::number(field.control));
  control.editor->setAccessibleName(QString::fromLatin1(field.label));
  controls.push_back(control);
}

void CElementForm::LabelFields() {
  QStringList labels;
  for (const Control& control : controls) labels.append(QString::fromLatin1(control.field->label));
  labels = WithAltKeys(labels);
  for (Control& control : controls) {
    control.label = MakeChild<QLabel>(labels.takeFirst(), this);
    control.label->setBuddy(control.editor);
    ExplainField(control);
  }
}

void CElementForm::ExplainField(const Control& control) {
  const QString meaning = Meaning(*control.field);
  if (meaning.isEmpty()) return;
  control.label->setToolTip(PlainTip(meaning));
  control.label->setAccessibleDescription(meaning);
  // The tip of an editor would be read out with its markup.
  control.editor->setAccessibleDescription(meaning);
  // Where a field has text of its own to point at, the tip is for that.
  if (qobject_cast<CAutoRichEditCtrl*>(control.editor) == nullptr)
    control.editor->setToolTip(PlainTip(meaning));
}

QWidget* CElementForm::MakeEditor(const FormField& field, Control& control) {
  switch (field.editor) {
    case FieldEditor::Documentation:
      return MakeDocumentation(field, control);
    case FieldEditor::Expression:
      return MakeExpression(field, control);
    case FieldEditor::Lines:
      return control.editor = MakeLines();
    case FieldEditor::SortedChoice:
    case FieldEditor::OrderedChoice:
      return control.editor = MakeCombo(field);
    case FieldEditor::ReferencedIn:
      return control.editor = MakeReferences();
    default:
      if (hasExpression && field.label == kUnitLabel) return MakeUnit(field, control);
      return control.editor = MakeLine(field, this);
  }
}

QLineEdit* CElementForm::MakeLine(const FormField& field, QWidget* parent) {
  auto* line = MakeChild<QLineEdit>(parent);
  line->setReadOnly(field.editor == FieldEditor::Shown || field.editor == FieldEditor::Count);
  connect(line, &QLineEdit::textEdited, this, [this] { NoteEdited(); });
  connect(line, &QLineEdit::editingFinished, this, [this] { NoteFocusLost(); });
  return line;
}

QWidget* CElementForm::MakeLines() {
  auto* lines = MakeChild<CPlainTextField>(this);
  connect(lines, &QTextEdit::textChanged, this, [this] { NoteEdited(); });
  WatchFocusLoss(*lines, [this] { NoteFocusLost(); });
  return lines;
}

QWidget* CElementForm::MakeCombo(const FormField& field) {
  auto* combo = MakeChild<QComboBox>(this);
  combo->setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
  // The wheel that scrolls the form must not choose on its way.
  combo->setFocusPolicy(Qt::StrongFocus);
  IgnoreWheelWithoutFocus(*combo);
  connect(combo, &QComboBox::activated, this, [this] { NoteChosen(); });
  connect(combo, &QComboBox::currentTextChanged, this, [combo, &field] { ShowChoiceTip(*combo, field); });
  return combo;
}

QWidget* CElementForm::MakeReferences() {
  auto* names = MakeChild<CAutoRichEditCtrl>(Document(), this);
  names->setReadOnly(true);
  connect(names, &CAutoRichEditCtrl::LinkActivated, this, &CElementForm::JumpTo);
  return names;
}

QWidget* CElementForm::MakeDocumentation(const FormField& field, Control& control) {
  auto* cell = MakeChild<QWidget>(this);
  auto* parts = MakeChild<QHBoxLayout>(cell);
  parts->setContentsMargins(0, 0, 0, 0);
  QLineEdit* line = MakeLine(field, cell);
  auto* browse = MakeChild<QPushButton>(strings::kBrowse, cell);
  browse->setObjectName(QString::number(control_id::kBrowse));
  browse->setAccessibleName(strings::kSelectDocumentation);
  browse->setToolTip(strings::kSelectDocumentation);
  auto* view = MakeChild<QPushButton>(strings::kView, cell);
  view->setObjectName(QString::number(control_id::kView));
  view->setAccessibleName(strings::kView);
  view->setToolTip(strings::kOpenDocumentation);
  parts->addWidget(line, 1);
  parts->addWidget(browse);
  parts->addWidget(view);
  connect(browse, &QPushButton::clicked, this, [this, line] { BrowseDocumentation(*line); });
  connect(view, &QPushButton::clicked, this, [this, line] { OpenDocumentation(line->text()); });
  control.editor = line;
  return cell;
}

QWidget* CElementForm::MakeExpression(const FormField& field, Control& control) {
  auto* cell = MakeChild<CExpressionPanel>(
      Document(), [this] { return Element(); }, QString::fromLatin1(field.label), this);
  CAutoRichEditCtrl* edit = &cell->Field();
  auto* keypad = MakeChild<QPushButton>(strings::kEdit, cell);
  keypad->setObjectName(QString::number(field.keypad));
  // In a form with several expressions each button has a name of its own.
  const bool isOnly = field.keypad == control_id::kKeypad;
  keypad->setAccessibleName(isOnly ? strings::kEdit
                                   : strings::kEdit + u' ' + QString::fromLatin1(field.label));
  keypad->setAccessibleDescription(strings::kExpressionEditor);
  cell->AddButton(*keypad);
  connect(edit, &CAutoRichEditCtrl::ContentChanged, this, [this, edit] {
    if (edit->IsEdited()) NoteTyped();
  });
  connect(edit, &CAutoRichEditCtrl::LinkActivated, this, &CElementForm::JumpTo);
  WatchFocusLoss(*edit, [this] { NoteFocusLost(); });
  connect(keypad, &QPushButton::clicked, this, [this] { CExpressionEditorDlg(this).exec(); });
  control.editor = edit;
  return cell;
}

QWidget* CElementForm::MakeUnit(const FormField& field, Control& control) {
  auto* cell = MakeChild<QWidget>(this);
  auto* parts = MakeChild<QHBoxLayout>(cell);
  parts->setContentsMargins(0, 0, 0, 0);
  QLineEdit* line = MakeLine(field, cell);
  unitNote = MakeChild<CUnitNote>(cell);
  parts->addWidget(line, 1);
  parts->addWidget(unitNote);
  control.editor = line;
  return cell;
}

void CElementForm::ShowUnitNote() {
  if (unitNote == nullptr || IsClosed()) return;
  const CEL_Element* element = Element();
  if (element != nullptr) unitNote->Show(Core(), *element);
}

bool CElementForm::IsEnabled(const FormField& field, const CEL_Property& property) const {
  return field.isOpen != nullptr ? field.isOpen(Core()) : property.Editable();
}

void CElementForm::ItemToForm() {
  CEL_Element* element = Element();
  if (element == nullptr) return;
  for (Control& control : controls) Show(control, *element);
  element->SetLoaded(true);
  // The form is seen first.
  QTimer::singleShot(0, this, &CElementForm::ShowUnitNote);
}

void CElementForm::Show(Control& control, CEL_Element& element) {
  const FormField& field = *control.field;
  if (field.editor == FieldEditor::ReferencedIn) {
    qobject_cast<CAutoRichEditCtrl*>(control.editor)->SetColouredText(ReferrerText(element));
    return;
  }
  if (field.editor == FieldEditor::Count) {
    qobject_cast<QLineEdit*>(control.editor)->setText(QString::number(field.count(element)));
    return;
  }
  const CEL_Property& property = field.property(element);
  const bool enabled = IsEnabled(field, property);
  if (auto* combo = qobject_cast<QComboBox*>(control.editor)) {
    FillCombo(*combo, field, property, enabled);
    return;
  }
  control.editor->setEnabled(enabled);
  const QString text = ToScreen(property.TextOf());
  if (auto* line = qobject_cast<QLineEdit*>(control.editor)) {
    line->setMaxLength(std::max(kMostCharacters, static_cast<int>(text.size())));
    line->setText(text);
    line->setCursorPosition(0);
    control.shown = line->text();
  } else if (auto* expression = qobject_cast<CAutoRichEditCtrl*>(control.editor)) {
    // What was typed and is not written yet stays.
    if (expression->IsEdited()) return;
    expression->SetColouredText(property.TextOf());
  } else if (auto* lines = qobject_cast<CPlainTextField*>(control.editor)) {
    lines->ShowText(text);
  }
}

std::string CElementForm::ReferrerText(const CEL_Element& element) const {
  std::vector<std::string> names;
  Core().GetReferrerSymbols(element.GetUid(), names);
  if (names.empty()) return strings::kNotUsed;
  std::string text;
  for (const std::string& name : names) {
    if (!text.empty()) text += ", ";
    text += name;
  }
  return text;
}

QWidget* CElementForm::ShowText(const TextToShow& text) {
  CEL_Element* element = Element();
  const auto shows = [&text, element](const Control& control) {
    return control.field->property != nullptr && &control.field->property(*element) == text.property;
  };
  const auto control = std::find_if(controls.begin(), controls.end(), shows);
  if (element == nullptr || text.property == nullptr || control == controls.end()) return nullptr;
  control->editor->setFocus(Qt::OtherFocusReason);
  MarkIn(*control->editor, text.start, text.length);
  return control->editor;
}

void CElementForm::FillCombo(QComboBox& combo, const FormField& field, const CEL_Property& property,
                             bool enabled) {
  combo.clear();
  combo.setEnabled(property.HasChoices() && enabled);
  QList<std::pair<QString, int>> entries;
  for (const CEL_Choice& choice : property.Choices()) {
    entries.append({ToScreen(choice.display), static_cast<int>(entries.size())});
  }
  if (field.editor == FieldEditor::SortedChoice) {
    std::stable_sort(entries.begin(), entries.end(), [](const auto& left, const auto& right) {
      return left.first.compare(right.first, Qt::CaseInsensitive) < 0;
    });
  }
  for (const auto& [caption, index] : entries) {
    combo.addItem(caption, index);
    const QString meaning = MeaningOf(field, caption);
    if (!meaning.isEmpty()) combo.setItemData(combo.count() - 1, PlainTip(meaning), Qt::ToolTipRole);
  }
  const std::int32_t present = property.PresentChoice();
  combo.setCurrentIndex(combo.findData(present < 0 ? property.Selected() : present));
}

void CElementForm::FormToItem() {
  CEL_Element* element = Element();
  if (element == nullptr) return;
  bool isStale = false;
  for (const Control& control : controls) {
    if (control.field->editor != FieldEditor::Symbol || !IsEdited(control)) continue;
    const std::string edited =
        FromScreen(TextIn(*control.editor), element->symbol.Text(), Document().Encoding());
    const std::string entered(CleanText(edited));
    // Blanks around the present symbol are dropped without a rename.
    isStale = entered == element->symbol.Text();
    if (isStale) continue;
    // The other fields are not written in this commit.
    const std::string former = element->symbol.TextOf();
    if (Rename(entered)) RenameInTyped(former, entered);
    ItemToForm();
    return;
  }
  if (StoreFields(*element) || isStale) ItemToForm();
}

void CElementForm::RenameInTyped(const std::string& former, const std::string& present) {
  for (const Control& control : controls) {
    if (control.field->editor != FieldEditor::Expression || !IsEdited(control)) continue;
    auto* expression = qobject_cast<CAutoRichEditCtrl*>(control.editor);
    const QString typed = expression->ContentText();
    const QString renamed = ToScreen(ReplaceName(typed.toStdString(), former, present));
    if (renamed != typed) expression->Retype(renamed);
  }
}

bool CElementForm::HasUnwritten() const {
  return std::any_of(controls.begin(), controls.end(), [](const Control& control) {
    return control.field->editor == FieldEditor::Expression && IsEdited(control);
  });
}

bool CElementForm::StoreFields(CEL_Element& element) {
  std::vector<int> changed;
  for (const Control& control : controls) {
    if (std::find(changed.begin(), changed.end(), control.field->follows) != changed.end()) continue;
    if (Store(control, element)) changed.push_back(control.field->control);
  }
  return !changed.empty();
}

bool CElementForm::StoreField(int control, CEL_Element& element) {
  const auto stored = std::find_if(controls.begin(), controls.end(),
                                   [control](const Control& each) { return each.field->control == control; });
  return stored != controls.end() && Store(*stored, element);
}

bool CElementForm::IsEdited(const Control& control) {
  const auto* field = qobject_cast<const CPlainTextField*>(control.editor);
  return field != nullptr ? field->IsEdited() : TextIn(*control.editor) != control.shown;
}

bool CElementForm::Store(const Control& control, CEL_Element& element) {
  const FormField& field = *control.field;
  if (!IsStored(field.editor)) return false;
  CEL_Property& property = field.property(element);
  if (const auto* combo = qobject_cast<const QComboBox*>(control.editor))
    return (!field.onlyWhileEnabled || IsEnabled(field, property)) && StoreChoice(*combo, property);
  // A text that nobody edited stays, however it looks on the screen.
  if (!IsTyped(control, property)) return false;
  const bool isStored = StoreTyped(control, property);
  if (auto* lines = qobject_cast<CPlainTextField*>(control.editor)) lines->TakeAsShown();
  return isStored;
}

bool CElementForm::IsTyped(const Control& control, const CEL_Property& property) const {
  return IsEdited(control) && (!control.field->onlyWhileEnabled || IsEnabled(*control.field, property));
}

bool CElementForm::StoreTyped(const Control& control, CEL_Property& property) const {
  const FieldEditor editor = control.field->editor;
  const QString text = TextIn(*control.editor);
  const bool isNumber = editor == FieldEditor::Number || editor == FieldEditor::Integer;
  return isNumber ? StoreNumber(text, property) : StoreText(text, property);
}

std::vector<TypedValue> CElementForm::TypedValues() const {
  std::vector<TypedValue> typed;
  CEL_Element* element = Element();
  if (element == nullptr) return typed;
  for (const Control& control : controls) {
    if (!IsStored(control.field->editor) || qobject_cast<QComboBox*>(control.editor) != nullptr) continue;
    CEL_Property& property = control.field->property(*element);
    if (!IsTyped(control, property)) continue;
    typed.push_back({[this, &control, &property] { StoreTyped(control, property); },
                     [&property, text = std::string(property.Text()), real = property.RealValue(),
                      whole = property.IntValue()] {
                       property.SetText(text);
                       property.SetReal(real);
                       property.SetInt(whole);
                     }});
  }
  return typed;
}

bool CElementForm::StoreText(const QString& text, CEL_Property& property) const {
  const std::string entered = FromScreen(text, property.Text(), Document().Encoding());
  property.SetText(CleanText(entered));
  // The form is filled again even when blanks were all that changed.
  return true;
}

bool CElementForm::StoreNumber(const QString& text, CEL_Property& property) {
  const double value = ReadNumber(text.trimmed());
  if (property.Type() == ValueType::Integer) {
    using Limits = std::numeric_limits<std::int32_t>;
    const double whole = std::isnan(value) ? 0.0 : std::clamp<double>(value, Limits::min(), Limits::max());
    property.SetInt(static_cast<std::int32_t>(whole));
  } else if (std::isfinite(value)) {
    property.SetReal(value);
  }
  // A text that reads as the present value, or as none, gives way to the value's own text.
  return true;
}

bool CElementForm::StoreChoice(const QComboBox& combo, CEL_Property& property) {
  const QVariant entry = combo.currentData();
  if (!entry.isValid() || !property.Editable()) return false;
  // Another field of the same commit may have changed what is offered: the caption decides then.
  const auto& choices = property.Choices();
  const auto isShown = [caption = combo.currentText()](const CEL_Choice& choice) {
    return ToScreen(choice.display) == caption;
  };
  auto index = static_cast<std::size_t>(entry.toInt());
  if (index >= choices.size() || !isShown(choices[index])) {
    index = static_cast<std::size_t>(std::find_if(choices.begin(), choices.end(), isShown) - choices.begin());
  }
  if (index >= choices.size()) return false;
  const std::string former = property.TextOf();
  property.SelectIndex(static_cast<std::int32_t>(index));
  property.ApplySelection();
  return property.TextOf() != former;
}

void CElementForm::BrowseDocumentation(QLineEdit& line) {
  QString chosen = Dialogs().ChooseDocumentationFile(this, line.text());
  if (chosen.isEmpty()) return;
  if (QFileInfo(chosen).suffix().isEmpty()) chosen += QStringLiteral(".pdf");
  line.setText(chosen);
  OnDocumentationChosen();
}

void CElementForm::OpenDocumentation(const QString& text) {
  const QString failure = OpenDocumentationFile(text, Dialogs(), DocumentationFolder());
  if (!failure.isEmpty()) Dialogs().ShowFailure(this, failure);
}

}  // namespace tessal
