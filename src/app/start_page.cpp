#include "app/start_page.h"

#include <QCommandLinkButton>
#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>
#include <QLabel>
#include <QScrollArea>
#include <QToolButton>
#include <QVBoxLayout>
#include <array>
#include <memory>

#include "app/recent_files.h"

namespace tessal {

namespace {

/// Seen from the folder of the program: where an installation puts the examples, and where a build finds
/// them.
constexpr std::array<const char*, 2> kExampleFolders = {"../share/tessal/examples", "../../../examples"};
constexpr int kWidth = 520;
constexpr int kGap = 12;

template <class Object, class... Arguments>
Object* Make(Arguments&&... arguments) {
  return std::make_unique<Object>(std::forward<Arguments>(arguments)...).release();
}

QStringList Examples() {
  for (const char* place : kExampleFolders) {
    const QDir folder(QDir(QCoreApplication::applicationDirPath()).filePath(QString::fromLatin1(place)));
    const QFileInfoList files = folder.entryInfoList({QStringLiteral("*.tessal")}, QDir::Files, QDir::Name);
    QStringList paths;
    for (const QFileInfo& file : files) paths.append(QDir::cleanPath(file.absoluteFilePath()));
    if (!paths.isEmpty()) return paths;
  }
  return {};
}

void Empty(QLayout& layout) {
  while (const std::unique_ptr<QLayoutItem> item{layout.takeAt(0)}) {
    if (item->widget() == nullptr) continue;  // a space
    // It may be the button that was pressed just now.
    item->widget()->hide();
    item->widget()->deleteLater();
  }
}

}  // namespace

StartPage::StartPage(QWidget* parent) : QWidget(parent) {
  auto* column = Make<QWidget>();
  column->setMaximumWidth(kWidth);
  auto* rows = Make<QVBoxLayout>(column);
  auto* create = Make<QCommandLinkButton>(tr("&New template"), tr("Begin with an empty template."), column);
  auto* open = Make<QCommandLinkButton>(tr("&Open..."), tr("Open a template from a file."), column);
  for (auto* button : {create, open}) button->setAccessibleName(button->text().remove(u'&'));
  rows->addWidget(create);
  rows->addWidget(open);
  lists = Make<QVBoxLayout>();
  rows->addLayout(lists);
  rows->addStretch(1);

  auto* middle = Make<QWidget>();
  auto* across = Make<QHBoxLayout>(middle);
  across->addStretch(1);
  across->addWidget(column, 4);
  across->addStretch(1);
  auto* area = Make<QScrollArea>(this);
  area->setWidgetResizable(true);
  area->setFrameShape(QFrame::NoFrame);
  area->setWidget(middle);
  auto* layout = Make<QVBoxLayout>(this);
  layout->setContentsMargins(0, 0, 0, 0);
  layout->addWidget(area);
  connect(create, &QAbstractButton::clicked, this, &StartPage::NewRequested);
  connect(open, &QAbstractButton::clicked, this, &StartPage::OpenRequested);
}

void StartPage::Fill() {
  Empty(*lists);
  AddFiles(tr("Recent files"), RecentFiles(), RecentFileCaption);
  AddFiles(tr("Examples"), Examples(), [](const QString& path) { return QFileInfo(path).fileName(); });
}

void StartPage::AddFiles(const QString& heading, const QStringList& paths,
                         QString (*captionOf)(const QString& path)) {
  if (paths.isEmpty()) return;
  auto* title = Make<QLabel>(heading);
  QFont bold = title->font();
  bold.setBold(true);
  title->setFont(bold);
  lists->addSpacing(kGap);
  lists->addWidget(title);
  for (const QString& path : paths) {
    auto* link = Make<QToolButton>();
    link->setText(fontMetrics().elidedText(captionOf(path), Qt::ElideMiddle, kWidth - kGap));
    link->setAutoRaise(true);
    link->setAccessibleName(QFileInfo(path).fileName());
    link->setAccessibleDescription(path);
    link->setToolTip(path);
    link->setCursor(Qt::PointingHandCursor);
    connect(link, &QAbstractButton::clicked, this, [this, path] { emit FileChosen(path); });
    lists->addWidget(link);
  }
}

}  // namespace tessal
