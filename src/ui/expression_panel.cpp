#include "ui/expression_panel.h"

#include <QHBoxLayout>
#include <QTextBlock>
#include <QVBoxLayout>
#include <algorithm>
#include <utility>

#include "core/document.h"
#include "ui/call_tip.h"
#include "ui/child.h"
#include "ui/expression_field.h"
#include "ui/expression_marks.h"
#include "ui/expression_palette.h"
#include "ui/formula_preview.h"
#include "ui/function_tips.h"
#include "ui/label.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

CExpressionPanel::CExpressionPanel(const CTessalDoc& shownDocument, ElementSource shownElement,
                                   const QString& label, QWidget* parent)
    : QWidget(parent),
      field(MakeChild<CAutoRichEditCtrl>(shownDocument, this)),
      marks(MakeChild<CExpressionMarks>(*field, shownDocument, shownElement)),
      note(MakeChild<CLabel>(this)),
      formula(MakeChild<CFormulaPreview>(shownDocument.Core(), this)),
      element(shownElement),
      foot(MakeChild<QHBoxLayout>()) {
  formula->setAccessibleName(strings::kFormulaOf.arg(label));
  note->setWordWrap(true);
  note->setAccessibleName(QStringLiteral("Parser message of %1").arg(label));
  foot->addWidget(note, 1);
  auto* inserter = MakeChild<CExpressionPalette>(*field, this);
  inserter->setAccessibleName(strings::kPaletteOf.arg(label));
  AddButton(*inserter);
  auto* rows = MakeChild<QVBoxLayout>(this);
  rows->setContentsMargins(0, 0, 0, 0);
  rows->addWidget(field, 1);
  rows->addWidget(formula);
  rows->addLayout(foot);
  MakeChild<CExpressionCompleter>(*field, shownDocument, std::move(shownElement));
  MakeChild<CCallTip>(*field, shownDocument);
  field->SetTips([this](const std::string& word, int position) {
    const QString fault = marks->FaultAt(position);
    return fault.isEmpty() ? TipOfWord(word) : fault.toHtmlEscaped();
  });
  connect(marks, &CExpressionMarks::FaultChanged, this, &CExpressionPanel::ShowFault);
  connect(field, &QTextEdit::cursorPositionChanged, this, &CExpressionPanel::ReportCaret);
  connect(field, &CAutoRichEditCtrl::ContentChanged, this, &CExpressionPanel::ShowFormula);
  connect(formula, &CFormulaPreview::HeightChanged, this, &CExpressionPanel::FitFormula);
}

QSize CExpressionPanel::minimumSizeHint() const {
  const QLayout& rows = *layout();
  const int height = field->minimumHeight() + rows.spacing() + foot->minimumSize().height();
  return {QWidget::minimumSizeHint().width(), height};
}

void CExpressionPanel::resizeEvent(QResizeEvent* resize) {
  QWidget::resizeEvent(resize);
  FitFormula();
}

void CExpressionPanel::ShowFormula() {
  const CEL_Element* shown = element();
  if (shown == nullptr) return;
  const bool isDerivative =
      shown->Kind() == ElementKind::StateVariable || shown->Kind() == ElementKind::SpecieStateVariable;
  formula->Show(field->ContentText().toStdString(), {shown->FullSymbol(), isDerivative});
}

void CExpressionPanel::FitFormula() {
  const int spacing = layout()->spacing();
  // The field keeps what its text needs, up to half of the height.
  const int text = qCeil(field->document()->size().height()) + 2 * field->frameWidth();
  const int kept = std::max(field->minimumHeight(), std::min(text, height() / 2));
  const int taken = kept + 2 * spacing + foot->minimumSize().height();
  const int room = height() - taken;
  const int wanted = formula->WantedHeight();
  const bool fits = ShowsFormulas() && wanted > 0 && room >= formula->LeastHeight();
  if (fits) formula->setFixedHeight(std::min(wanted, room));
  formula->setVisible(fits);
}

void CExpressionPanel::ReportCaret() {
  const QTextCursor caret = field->textCursor();
  emit CaretMoved(caret.blockNumber() + 1, caret.positionInBlock() + 1);
}

void CExpressionPanel::ShowFault() {
  const ExpressionFault* fault = marks->PresentFault();
  const QString plain = fault == nullptr ? QString() : ToScreen(fault->plain);
  QString text = plain;
  if (fault != nullptr && !fault->words.empty()) text += u'\n' + ToScreen(fault->words);
  note->setText(text);
  emit FaultChanged(plain);
}

void CExpressionPanel::AddButton(QWidget& button) {
  foot->addWidget(&button, 0, Qt::AlignTop);
}

}  // namespace tessal
