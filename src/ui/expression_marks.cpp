#include "ui/expression_marks.h"

#include <QTimer>
#include <algorithm>
#include <utility>

#include "core/document.h"
#include "expr/caret_context.h"
#include "ui/child.h"
#include "ui/expression_colours.h"
#include "ui/text_bytes.h"
#include "ui/text_places.h"

namespace tessal {

namespace {

constexpr int kPauseMilliseconds = 500;
/// More wavy lines help nobody.
constexpr std::size_t kMostFaults = 50;

QTextCharFormat LooksOfFault(const QColor& ground) {
  QTextCharFormat looks;
  looks.setUnderlineStyle(QTextCharFormat::WaveUnderline);
  looks.setUnderlineColor(ReadableColour(kFaultColour, ground));
  return looks;
}

QTextCharFormat LooksOfBracket(const QPalette& palette) {
  constexpr int kTint = 90;
  QColor ground = palette.color(QPalette::Highlight);
  ground.setAlpha(kTint);
  QTextCharFormat looks;
  looks.setBackground(ground);
  return looks;
}

}  // namespace

CExpressionMarks::CExpressionMarks(CAutoRichEditCtrl& shownField, const CTessalDoc& shownDocument,
                                   ElementSource shownElement)
    : QObject(&shownField),
      field(shownField),
      document(shownDocument),
      element(std::move(shownElement)),
      pause(MakeChild<QTimer>(this)) {
  pause->setSingleShot(true);
  pause->setInterval(kPauseMilliseconds);
  pause->setObjectName(QStringLiteral("TypingPause"));
  connect(pause, &QTimer::timeout, this, &CExpressionMarks::LookForFaults);
  connect(&field, &CAutoRichEditCtrl::ContentChanged, this, &CExpressionMarks::FollowText);
  connect(&field, &QTextEdit::cursorPositionChanged, this, &CExpressionMarks::FollowCaret);
}

const ExpressionFault* CExpressionMarks::PresentFault() const {
  if (faults.empty()) return nullptr;
  const int caret = field.textCursor().position();
  const auto hit =
      std::find_if(faults.begin(), faults.end(), [caret](const Place& place) { return place.Holds(caret); });
  return hit == faults.end() ? &faults.front().fault : &hit->fault;
}

QString CExpressionMarks::FaultAt(int position) const {
  for (const Place& place : faults) {
    if (place.begin <= position && position < place.end) return ToScreen(place.fault.plain);
  }
  return {};
}

void CExpressionMarks::FollowText() {
  if (!field.IsEdited()) {
    LookForFaults();
    return;
  }
  // What was wrong may be no more.
  const bool had = !faults.empty();
  faults.clear();
  pause->start();
  Show();
  if (had) emit FaultChanged();
}

void CExpressionMarks::FollowCaret() {
  Show();
  if (faults.size() > 1) emit FaultChanged();
}

void CExpressionMarks::LookForFaults() {
  pause->stop();
  faults.clear();
  const CEL_Element* user = element();
  if (user != nullptr) {
    const std::string text = field.ContentText().toStdString();
    for (ExpressionFault& fault : FindExpressionFaults(document.Core(), *user, text)) {
      if (faults.size() == kMostFaults) break;
      faults.push_back({PositionAt(text, fault.at.start), PositionAt(text, fault.at.start + fault.at.length),
                        std::move(fault)});
    }
  }
  Show();
  emit FaultChanged();
}

void CExpressionMarks::Show() {
  QList<QTextEdit::ExtraSelection> marks;
  AppendBrackets(marks);
  const QTextCharFormat looks = LooksOfFault(field.palette().color(QPalette::Base));
  for (const Place& place : faults) Append(marks, place.begin, place.end, looks);
  field.setExtraSelections(marks);
}

void CExpressionMarks::AppendBrackets(QList<QTextEdit::ExtraSelection>& marks) const {
  const QString text = field.ContentText();
  const std::string bytes = text.toStdString();
  const auto pair = BracketAt(bytes, BytesBefore(text, field.textCursor().position()));
  if (!pair) return;
  const auto append = [this, &marks, &bytes](LexemeSpan span, const QTextCharFormat& looks) {
    Append(marks, PositionAt(bytes, span.start), PositionAt(bytes, span.start + span.length), looks);
  };
  if (!pair->partner) {
    QTextCharFormat looks = LooksOfFault(field.palette().color(QPalette::Base));
    looks.setForeground(looks.underlineColor());
    append(pair->bracket, looks);
    return;
  }
  const QTextCharFormat looks = LooksOfBracket(field.palette());
  append(pair->bracket, looks);
  append(*pair->partner, looks);
}

void CExpressionMarks::Append(QList<QTextEdit::ExtraSelection>& marks, int begin, int end,
                              const QTextCharFormat& looks) const {
  // The caret moves before the text counts as changed, when the faults are still those of the text before.
  if (begin >= end || end >= field.document()->characterCount()) return;
  QTextEdit::ExtraSelection mark;
  mark.cursor = QTextCursor(field.document());
  mark.cursor.setPosition(begin);
  mark.cursor.setPosition(end, QTextCursor::KeepAnchor);
  mark.format = looks;
  marks.append(mark);
}

}  // namespace tessal
