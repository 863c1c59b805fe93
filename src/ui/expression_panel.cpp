#include "ui/expression_panel.h"

#include <QHBoxLayout>
#include <QVBoxLayout>
#include <utility>

#include "ui/child.h"
#include "ui/expression_field.h"
#include "ui/label.h"

namespace tessal {

CExpressionPanel::CExpressionPanel(const CTessalDoc& shownDocument, ElementSource shownElement,
                                   const QString& label, QWidget* parent)
    : QWidget(parent),
      field(MakeChild<CAutoRichEditCtrl>(shownDocument, this)),
      note(MakeChild<CLabel>(this)),
      foot(MakeChild<QHBoxLayout>()) {
  note->setWordWrap(true);
  note->setAccessibleName(QStringLiteral("Parser message of %1").arg(label));
  foot->addWidget(note, 1);
  auto* rows = MakeChild<QVBoxLayout>(this);
  rows->setContentsMargins(0, 0, 0, 0);
  rows->addWidget(field, 1);
  rows->addLayout(foot);
  MakeChild<CExpressionCompleter>(*field, shownDocument, std::move(shownElement));
  connect(field, &CAutoRichEditCtrl::ContentChanged, note, [this] { note->setText(field->ParserMessage()); });
}

void CExpressionPanel::AddButton(QWidget& button) {
  foot->addWidget(&button, 0, Qt::AlignTop);
}

}  // namespace tessal
