#include "ui/expression_panel.h"

#include <QHBoxLayout>
#include <QTextBlock>
#include <QVBoxLayout>
#include <utility>

#include "ui/call_tip.h"
#include "ui/child.h"
#include "ui/expression_field.h"
#include "ui/expression_marks.h"
#include "ui/function_tips.h"
#include "ui/label.h"
#include "ui/text_bytes.h"

namespace tessal {

CExpressionPanel::CExpressionPanel(const CTessalDoc& shownDocument, ElementSource shownElement,
                                   const QString& label, QWidget* parent)
    : QWidget(parent),
      field(MakeChild<CAutoRichEditCtrl>(shownDocument, this)),
      marks(MakeChild<CExpressionMarks>(*field, shownDocument, shownElement)),
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
  MakeChild<CCallTip>(*field, shownDocument);
  field->SetTips([this](const std::string& word, int position) {
    const QString fault = marks->FaultAt(position);
    return fault.isEmpty() ? TipOfWord(word) : fault.toHtmlEscaped();
  });
  connect(marks, &CExpressionMarks::FaultChanged, this, &CExpressionPanel::ShowFault);
  connect(field, &QTextEdit::cursorPositionChanged, this, &CExpressionPanel::ReportCaret);
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
