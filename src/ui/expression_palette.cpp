#include "ui/expression_palette.h"

#include <QMenu>
#include <array>

#include "expr/function_catalogue.h"
#include "expr/function_reference.h"
#include "ui/child.h"
#include "ui/expression_field.h"
#include "ui/function_tips.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

struct OperatorRow {
  const char* shown;
  const char* before;
  const char* after;
};

constexpr std::array<OperatorRow, 18> kOperators = {{
    {"a + b", "", " + "},
    {"a - b", "", " - "},
    {"a * b", "", " * "},
    {"a / b", "", " / "},
    {"( a )", "(", ")"},
    {"- a", "-", ""},
    {"IF condition THEN a ELSE b", "IF ", " THEN  ELSE "},
    {"a == b", "", " == "},
    {"a != b", "", " != "},
    {"a > b", "", " > "},
    {"a >= b", "", " >= "},
    {"a < b", "", " < "},
    {"a <= b", "", " <= "},
    {"condition AND condition", "", " AND "},
    {"condition OR condition", "", " OR "},
    {"NOT condition", "NOT (", ")"},
    {"[PROPERTY]", "[", "]"},
    {"/* comment */", "/* ", " */"},
}};

}  // namespace

CExpressionPalette::CExpressionPalette(CAutoRichEditCtrl& filledField, QWidget* parent)
    : QToolButton(parent), field(filledField) {
  setText(strings::kInsert);
  setToolTip(strings::kPalette);
  setPopupMode(QToolButton::InstantPopup);
  setFocusPolicy(Qt::StrongFocus);
  auto* menu = MakeChild<QMenu>(this);
  menu->setToolTipsVisible(true);
  setMenu(menu);
  // Most forms are left without a look at it.
  connect(menu, &QMenu::aboutToShow, this, &CExpressionPalette::FillMenu);
}

void CExpressionPalette::FillMenu() {
  if (!menu()->isEmpty()) return;
  QMenu* operators = menu()->addMenu(strings::kOperators);
  for (const OperatorRow& row : kOperators) {
    operators->addAction(QString::fromLatin1(row.shown), this, [this, &row] {
      Insert({QString::fromLatin1(row.before), QString::fromLatin1(row.after), 0});
    });
  }
  for (const FunctionGroup& group : FunctionGroups()) {
    QMenu* functions = menu()->addMenu(ToScreen(group.title));
    functions->setToolTipsVisible(true);
    for (const FunctionReference& function : group.functions) AddFunction(*functions, function);
    functions->menuAction()->setVisible(!functions->isEmpty());
  }
}

void CExpressionPalette::AddFunction(QMenu& group, const FunctionReference& function) {
  const CatalogueFunction* row = FindFunction(function.name);
  if (row == nullptr || row->traits.isDeprecated) return;
  QAction* action = group.addAction(ToScreen(CallText(function)), this, [this, &function] {
    const bool hasMore = function.arguments.size() > 1 && field.textCursor().hasSelection();
    Insert({ToScreen(function.name) + u'(', hasMore ? QStringLiteral(", )") : QStringLiteral(")"),
            hasMore ? 1 : 0});
  });
  action->setToolTip(TipOfWord(std::string(function.name)));
}

void CExpressionPalette::Insert(const Insertion& insertion) {
  QTextCursor caret = field.textCursor();
  const QString selected = caret.selectedText();
  caret.beginEditBlock();
  caret.insertText(insertion.before + selected + insertion.after);
  caret.endEditBlock();
  // Between what encloses nothing yet; after an operator, whose left side is there.
  const bool encloses = selected.isEmpty() && !insertion.before.isEmpty();
  const int back = encloses ? static_cast<int>(insertion.after.size()) : insertion.back;
  caret.setPosition(caret.position() - back);
  field.setTextCursor(caret);
  field.setFocus();
}

}  // namespace tessal
