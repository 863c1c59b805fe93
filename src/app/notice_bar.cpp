#include "app/notice_bar.h"

#include <QAccessible>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QStyle>
#include <memory>

#include "app/watched_file.h"

namespace tessal {

namespace {

template <class Object, class... Arguments>
Object* Make(Arguments&&... arguments) {
  return std::make_unique<Object>(std::forward<Arguments>(arguments)...).release();
}

}  // namespace

NoticeBar::NoticeBar(QWidget* parent) : QFrame(parent) {
  setFrameShape(QFrame::StyledPanel);
  setAccessibleName(tr("Notice about the file"));
  setBackgroundRole(QPalette::ToolTipBase);
  setForegroundRole(QPalette::ToolTipText);
  setAutoFillBackground(true);
  auto* sign = Make<QLabel>(this);
  const int size = style()->pixelMetric(QStyle::PM_SmallIconSize);
  sign->setPixmap(style()->standardIcon(QStyle::SP_MessageBoxWarning).pixmap(size));
  text = Make<QLabel>(this);
  text->setTextFormat(Qt::PlainText);
  text->setWordWrap(true);
  text->setForegroundRole(QPalette::ToolTipText);
  // Without Alt keys, which the forms need.
  reload = Make<QPushButton>(tr("Reload"), this);
  auto* keep = Make<QPushButton>(tr("Keep Mine"), this);
  compare = Make<QPushButton>(tr("Compare..."), this);
  auto* row = Make<QHBoxLayout>(this);
  row->addWidget(sign);
  row->addWidget(text, 1);
  for (QPushButton* button : {reload, keep, compare}) row->addWidget(button);
  connect(reload, &QPushButton::clicked, this, &NoticeBar::ReloadRequested);
  connect(keep, &QPushButton::clicked, this, &NoticeBar::KeepRequested);
  connect(compare, &QPushButton::clicked, this, &NoticeBar::CompareRequested);
  hide();
}

void NoticeBar::ShowState(FileState state, const QString& path) {
  const bool isGone = state == FileState::Gone;
  reload->setVisible(!isGone);
  compare->setVisible(!isGone);
  const QString said = isGone ? tr("The file '%1' was deleted or moved away.").arg(path)
                              : tr("The file '%1' was changed by another program.").arg(path);
  const bool isNews = state != FileState::AsKnown && (!isVisible() || text->text() != said);
  text->setText(said);
  setVisible(state != FileState::AsKnown);
  if (!isNews) return;
  QAccessibleEvent alert(this, QAccessible::Alert);
  QAccessible::updateAccessibility(&alert);
}

}  // namespace tessal
