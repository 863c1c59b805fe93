// Makes the pictures of the documents:
//
//     guide_pictures PROJECT OUTPUT
//
// carries out PROJECT/docs/pictures.txt, on copies of the examples, and writes the pictures and the templates
// that it names below OUTPUT (the project itself, to replace those that are there).
#include <QApplication>
#include <QDir>
#include <QFile>
#include <QStyle>
#include <QStyleFactory>
#include <QTemporaryDir>
#include <clocale>
#include <cstdio>
#include <exception>

#include "pictures/editor_pictures.h"

namespace {

const QString kScript = QStringLiteral("docs/pictures.txt");

/// The editor keeps files beside those that it has open.
void CopyExamples(const QString& project, const QString& folder) {
  const QDir from(QDir(project).filePath(QStringLiteral("examples")));
  for (const QString& name : from.entryList(QDir::Files))
    QFile::copy(from.filePath(name), QDir(folder).filePath(name));
}

int RunScript(const QString& project, const QString& output) {
  const QTemporaryDir folder;
  CopyExamples(project, folder.path());
  QFile script(QDir(project).filePath(kScript));
  if (!script.open(QIODevice::ReadOnly)) {
    std::fprintf(stderr, "guide_pictures: %s cannot be read\n", qPrintable(script.fileName()));
    return 2;
  }
  tessal::pictures::EditorPictures pictures(folder.path(), QDir(output).absolutePath());
  int number = 0;
  try {
    while (!script.atEnd()) {
      ++number;
      const QString line = QString::fromUtf8(script.readLine()).trimmed();
      if (!line.isEmpty() && !line.startsWith(u'#')) pictures.Do(line);
    }
    pictures.Finish();
  } catch (const std::exception& problem) {
    std::fprintf(stderr, "%s:%d: %s\n", qPrintable(kScript), number, problem.what());
    return 1;
  }
  return 0;
}

}  // namespace

int main(int count, char** arguments) {
  const QTemporaryDir settings;
  qputenv("XDG_CONFIG_HOME", settings.path().toUtf8());
  qputenv("XDG_STATE_HOME", settings.path().toUtf8());
  qputenv("QT_QPA_PLATFORM", "offscreen");
  QApplication application(count, arguments);
  std::setlocale(LC_NUMERIC, "C");
  QApplication::setOrganizationName(QStringLiteral("Tessal"));
  QApplication::setApplicationName(QStringLiteral("pictures"));
  if (application.arguments().size() != 3) {
    std::fputs("usage: guide_pictures PROJECT OUTPUT\n", stderr);
    return 2;
  }
  // The same on every desktop.
  QApplication::setStyle(QStyleFactory::create(QStringLiteral("Fusion")));
  QApplication::setPalette(QApplication::style()->standardPalette());
  constexpr int kTextSize = 9;
  QApplication::setFont(QFont(QStringLiteral("DejaVu Sans"), kTextSize));
  QApplication::setCursorFlashTime(0);
  return RunScript(application.arguments()[1], application.arguments()[2]);
}
