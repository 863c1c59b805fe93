#include "ui/account_strip.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>

#include "elements/load_account.h"
#include "ui/child.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

/// "3 values of this file could not be read. 2 more would be changed or lost by a save."
QString Summary(const LoadAccount& account) {
  const auto unread = account.Count(AccountKind::Unread);
  const auto others = account.Count(AccountKind::Changed) + account.Count(AccountKind::Dropped);
  QString text;
  if (unread > 0) text = (unread == 1 ? strings::kOneUnread : strings::kUnread).arg(unread);
  if (others == 0) return text;
  if (!text.isEmpty()) text += u' ';
  return text + (others == 1 ? strings::kOneNotKept : strings::kNotKept).arg(others);
}

}  // namespace

CAccountStrip::CAccountStrip(QWidget* parent)
    : QFrame(parent),
      text(MakeChild<QLabel>(this)),
      details(MakeChild<QPushButton>(strings::kDetails, this)),
      read(MakeChild<QPushButton>(strings::kReadThem, this)) {
  setFrameShape(QFrame::StyledPanel);
  setAutoFillBackground(true);
  setBackgroundRole(QPalette::ToolTipBase);
  text->setForegroundRole(QPalette::ToolTipText);
  text->setWordWrap(true);
  auto* layout = MakeChild<QHBoxLayout>(this);
  constexpr int kMargin = 4;
  layout->setContentsMargins(kMargin, kMargin, kMargin, kMargin);
  layout->addWidget(text, 1);
  layout->addWidget(read);
  layout->addWidget(details);
  connect(details, &QPushButton::clicked, this, &CAccountStrip::DetailsRequested);
  connect(read, &QPushButton::clicked, this, &CAccountStrip::ReadRequested);
  hide();
}

void CAccountStrip::Show(const LoadAccount& account) {
  setVisible(account.Loses());
  if (!account.Loses()) return;
  text->setText(Summary(account));
  read->setVisible(account.HasPassedOver());
}

QString AccountDetails(const LoadAccount& account) {
  QStringList lines;
  for (const AccountEntry& entry : account.Entries()) {
    QString line = ToScreen(entry.text).simplified();
    if (entry.line > 0) line = strings::kAtLine.arg(entry.line).arg(line);
    lines.append(line);
  }
  return lines.join(u'\n');
}

}  // namespace tessal
