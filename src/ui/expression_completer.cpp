#include "ui/expression_completer.h"

#include <QApplication>
#include <QCompleter>
#include <QHeaderView>
#include <QKeyEvent>
#include <QScreen>
#include <QScrollBar>
#include <QTreeView>
#include <algorithm>
#include <array>
#include <utility>

#include "core/document.h"
#include "expr/function_catalogue.h"
#include "ui/child.h"
#include "ui/expression_colours.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"
#include "ui/text_places.h"

namespace tessal {

namespace {

constexpr std::size_t kLettersThatOpen = 2;
/// More rows are no help to a reader.
constexpr std::size_t kMostRows = 200;

/// What comes after a completed word, with the caret between both.
struct Ending {
  CompletionGroup group;
  const char* before;
  const char* after;
};

constexpr std::array<Ending, 7> kEndings = {{
    {CompletionGroup::Symbol, "", ""},
    {CompletionGroup::Function, "(", ")"},
    {CompletionGroup::UserFunction, "(", ")"},
    {CompletionGroup::Verb, "{(", ")}"},
    {CompletionGroup::Keyword, " ", ""},
    {CompletionGroup::Builtin, "", ""},
    {CompletionGroup::Property, "]", ""},
}};

Ending EndingOf(const CCompletionModel::Row& row) {
  Ending ending = kEndings.at(static_cast<std::size_t>(row.group));
  const CatalogueFunction* function =
      row.group == CompletionGroup::Function ? FindFunction(row.text.toStdString()) : nullptr;
  // Of a call without arguments there is nothing to fill in.
  if (function != nullptr && function->argumentCount == 0) return {row.group, "()", ""};
  return ending;
}

bool IsTyped(const QKeyEvent& key) {
  const auto modifiers = key.modifiers() & (Qt::ControlModifier | Qt::AltModifier | Qt::MetaModifier);
  return modifiers == Qt::NoModifier && !key.text().isEmpty() && key.text().front().isPrint();
}

}  // namespace

void CCompletionModel::Show(std::vector<Row> shown) {
  beginResetModel();
  rows = std::move(shown);
  endResetModel();
}

int CCompletionModel::rowCount(const QModelIndex& above) const {
  return above.isValid() ? 0 : static_cast<int>(rows.size());
}

int CCompletionModel::columnCount(const QModelIndex& above) const {
  return above.isValid() ? 0 : 2;
}

QVariant CCompletionModel::data(const QModelIndex& index, int role) const {
  const auto place = static_cast<std::size_t>(index.row());
  if (!index.isValid() || place >= rows.size()) return {};
  const Row& row = rows[place];
  const bool isText = index.column() == 0;
  switch (role) {
    case Qt::DisplayRole:
    case Qt::EditRole:
      return isText ? row.text : row.detail;
    case Qt::AccessibleTextRole:
      return isText ? row.text + QStringLiteral(", ") + row.detail : row.detail;
    case Qt::ForegroundRole:
      return isText ? row.colour : QVariant();
    default:
      return {};
  }
}

CExpressionCompleter::CExpressionCompleter(CAutoRichEditCtrl& shownField, const CTessalDoc& shownDocument,
                                           ElementSource shownElement)
    : QObject(&shownField),
      field(shownField),
      document(shownDocument),
      element(std::move(shownElement)),
      model(MakeChild<CCompletionModel>(this)),
      completer(MakeChild<QCompleter>(model, this)),
      list(MakeChild<QTreeView>()) {
  list->setRootIsDecorated(false);
  list->setUniformRowHeights(true);
  list->header()->setStretchLastSection(true);
  list->setHeaderHidden(true);
  list->setAccessibleName(strings::kCompletions);
  completer->setWidget(&field);
  // The completer owns its list.
  completer->setPopup(list);
  list->setSelectionBehavior(QAbstractItemView::SelectRows);
  completer->setCompletionMode(QCompleter::UnfilteredPopupCompletion);
  connect(completer, qOverload<const QModelIndex&>(&QCompleter::activated), this,
          [this](const QModelIndex& chosen) {
            const auto place = static_cast<std::size_t>(chosen.row());
            // The rows change with the text.
            if (place < model->Rows().size()) Complete(CCompletionModel::Row(model->Rows()[place]));
          });
  field.SetKeys(*this);
}

bool CExpressionCompleter::IsOpen() const {
  return list->isVisible();
}

bool CExpressionCompleter::TakesKey(QKeyEvent& key) {
  if (key.key() == Qt::Key_Space && key.modifiers() == Qt::ControlModifier) {
    Offer(Wish::Asked);
    return true;
  }
  if (!IsOpen()) return false;
  switch (key.key()) {
    case Qt::Key_Return:
    case Qt::Key_Enter:
    case Qt::Key_Tab:
    case Qt::Key_Backtab:
    case Qt::Key_Escape:
      // The completer acts on what the field leaves to it.
      key.ignore();
      return true;
    default:
      return false;
  }
}

void CExpressionCompleter::FollowKey(const QKeyEvent& key) {
  if (IsOpen() || IsTyped(key)) Offer(Wish::Typed);
}

void CExpressionCompleter::Offer(Wish wish) {
  const CEL_Element* user = element();
  if (user == nullptr || field.isReadOnly()) return;
  const QString text = field.ContentText();
  const std::string bytes = text.toStdString();
  const std::size_t caret = BytesBefore(text, field.textCursor().position());
  const CaretContext context = ContextAt(bytes, caret);
  const std::string_view typed =
      std::string_view(bytes).substr(context.word.start, caret - context.word.start);
  const bool isProperty = context.place == CaretPlace::Property;
  const std::size_t needed = wish == Wish::Asked || isProperty ? 0 : IsOpen() ? 1 : kLettersThatOpen;
  std::vector<Completion> offered;
  if (typed.size() >= needed)
    offered = Matching(CompletionsFor(document.Core(), *user, context.place), typed);
  // A word that is typed out is done: Enter is a line's end again.
  const bool isDone = wish == Wish::Typed && !offered.empty() && offered.front().text == typed;
  if (offered.empty() || isDone) {
    list->hide();
    return;
  }
  if (offered.size() > kMostRows) offered.erase(offered.begin() + kMostRows, offered.end());
  std::vector<CCompletionModel::Row> rows;
  rows.reserve(offered.size());
  for (const Completion& completion : offered) rows.push_back(RowOf(completion));
  wordStart = PositionAt(bytes, context.word.start);
  model->Show(std::move(rows));
  Open();
}

void CExpressionCompleter::Open() {
  constexpr int kWidestText = 260;
  constexpr int kDetailWidth = 320;
  list->resizeColumnToContents(0);
  list->setColumnWidth(0, std::min(list->columnWidth(0), kWidestText));
  QTextCursor word = field.textCursor();
  word.setPosition(wordStart);
  QRect place = field.cursorRect(word).translated(field.viewport()->pos());
  const int wide = list->columnWidth(0) + kDetailWidth + list->verticalScrollBar()->sizeHint().width();
  place.setWidth(std::min(wide, field.screen()->availableSize().width()));
  completer->complete(place);
  list->setCurrentIndex(completer->completionModel()->index(0, 0));
}

CCompletionModel::Row CExpressionCompleter::RowOf(const Completion& completion) const {
  CCompletionModel::Row row;
  row.text = ToScreen(completion.text);
  row.group = completion.group;
  row.detail = completion.element == nullptr
                   ? strings::kCompletionGroups.at(static_cast<std::size_t>(completion.group))
                   : field.TipOf(completion.element->GetUid()).trimmed();
  // A built-in that no element represents would look like a fault.
  const bool isPlain =
      completion.group == CompletionGroup::Builtin || completion.group == CompletionGroup::Keyword;
  row.colour = isPlain ? field.palette().color(QPalette::Text) : field.ColourOf(std::string(completion.text));
  return row;
}

void CExpressionCompleter::Complete(const CCompletionModel::Row& row) {
  QTextCursor caret = field.textCursor();
  const int end = caret.position();
  QString after = field.ContentText().mid(end);
  caret.beginEditBlock();
  caret.setPosition(wordStart);
  caret.setPosition(end, QTextCursor::KeepAnchor);
  const QString rest = row.text.mid(end - wordStart);
  caret.insertText(row.text);
  // What lies after the caret of the same word is not written twice.
  if (!rest.isEmpty() && after.startsWith(rest, Qt::CaseInsensitive)) {
    caret.movePosition(QTextCursor::NextCharacter, QTextCursor::KeepAnchor, static_cast<int>(rest.size()));
    caret.removeSelectedText();
    after.remove(0, rest.size());
  }
  const Ending ending = EndingOf(row);
  const QString before = QString::fromLatin1(ending.before);
  if (!before.isEmpty() && after.startsWith(before.front())) {
    caret.movePosition(QTextCursor::NextCharacter);
  } else {
    caret.insertText(before);
    const int inside = caret.position();
    caret.insertText(QString::fromLatin1(ending.after));
    caret.setPosition(inside);
  }
  caret.endEditBlock();
  field.setTextCursor(caret);
}

}  // namespace tessal
