#include "ui/message_bar.h"

#include <QHBoxLayout>
#include <QLineEdit>
#include <QShortcut>
#include <QToolButton>

#include "core/message_table.h"
#include "ui/child.h"
#include "ui/icons.h"
#include "ui/strings.h"

namespace tessal {

namespace {

struct GroupLook {
  ErrorLevel level;  ///< whose icon it has
  const QString& one;
  const QString& several;
};

/// In the order of the groups.
const GroupLook kLooks[kMessageGroups] = {
    {ErrorLevel::Critical, strings::kOneError, strings::kErrors},
    {ErrorLevel::Warning, strings::kOneWarning, strings::kWarnings},
    {ErrorLevel::Notice, strings::kOneNotice, strings::kNotices},
};

}  // namespace

CMessageBar::CMessageBar(CErrorList& errorList, QWidget* parent)
    : QWidget(parent), list(errorList), words(nullptr) {
  auto* layout = MakeChild<QHBoxLayout>(this);
  layout->setContentsMargins(0, 1, 0, 1);
  for (std::size_t group = 0; group < kMessageGroups; ++group) {
    auto* button = MakeChild<QToolButton>(this);
    button->setIcon(IconOfLevel(static_cast<std::uint32_t>(kLooks[group].level)));
    button->setToolButtonStyle(Qt::ToolButtonTextBesideIcon);
    button->setCheckable(true);
    button->setChecked(true);
    button->setAutoRaise(true);
    button->setFocusPolicy(Qt::StrongFocus);
    connect(button, &QToolButton::toggled, this, &CMessageBar::FilterRows);
    layout->addWidget(button);
    groups[group] = button;
  }
  words = MakeChild<QLineEdit>(this);
  words->setPlaceholderText(strings::kFilterMessages);
  words->setAccessibleName(strings::kFilterMessages);
  connect(words, &QLineEdit::textChanged, this, &CMessageBar::FilterRows);
  auto* clear = MakeChild<QShortcut>(QKeySequence(Qt::Key_Escape), words);
  clear->setContext(Qt::WidgetShortcut);
  connect(clear, &QShortcut::activated, words, &QLineEdit::clear);
  layout->addWidget(words, 1);
  // The list lies under its bar.
  QWidget::setTabOrder(words, &list);
  connect(&list, &CErrorList::Refreshed, this, &CMessageBar::ShowCounts);
  ShowCounts();
}

void CMessageBar::ShowCounts() {
  for (std::size_t group = 0; group < kMessageGroups; ++group) {
    const int count = list.CountOf(static_cast<MessageGroup>(group));
    const QString& text = count == 1 ? kLooks[group].one : kLooks[group].several;
    groups[group]->setText(text.arg(count));
    groups[group]->setAccessibleName(groups[group]->text());
  }
}

void CMessageBar::FilterRows() {
  MessageFilter filter;
  for (std::size_t group = 0; group < kMessageGroups; ++group)
    filter.shows[group] = groups[group]->isChecked();
  filter.words = words->text();
  list.Filter(filter);
}

}  // namespace tessal
