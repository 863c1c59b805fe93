// The host application: finds the editor's module, and opens the files of the command line in it.
#include <QApplication>
#include <QCommandLineParser>
#include <QIcon>
#include <QMessageBox>
#include <clocale>
#include <cstdio>

#include "app/editor_module.h"
#include "app/host_window.h"
#include "app/session.h"
#include "platform/docview.h"

namespace {

constexpr int kNoModule = 2;

int RunHost(QApplication& application) {
  QCommandLineParser line;
  line.setApplicationDescription(QStringLiteral("Edits templates of aquatic process models."));
  line.addHelpOption();
  line.addVersionOption();
  const QCommandLineOption moduleOption(
      QStringLiteral("module"), QStringLiteral("The file of the editor's module."), QStringLiteral("file"));
  line.addOption(moduleOption);
  line.addPositionalArgument(QStringLiteral("files"), QStringLiteral("Templates to open."),
                             QStringLiteral("[files...]"));
  line.process(application);

  tessal::EditorModule module;
  const QStringList places = line.isSet(moduleOption)
                                 ? QStringList{line.value(moduleOption)}
                                 : tessal::EditorModule::UsualPlaces(QApplication::applicationDirPath());
  if (!module.Load(places)) {
    std::fprintf(stderr, "%s\n", qPrintable(module.Failure()));
    QMessageBox::critical(nullptr, QStringLiteral("Tessal"), module.Failure());
    return kNoModule;
  }
  tessal::HostWindow window(module.MakeDocTemplate(), module.EditorName());
  window.show();
  window.OpenFiles(line.positionalArguments());
  if (line.positionalArguments().isEmpty() && tessal::RestoresSession()) window.RestoreSession();
  window.OfferLeftWork(line.positionalArguments());
  if (window.DocumentCount() == 0 && line.positionalArguments().isEmpty()) window.NewDocument();
  return QApplication::exec();
}

}  // namespace

int main(int count, char** arguments) {
  QApplication application(count, arguments);
  // The application sets the user's locale; the numbers of templates are read and written without it.
  std::setlocale(LC_NUMERIC, "C");
  QApplication::setOrganizationName(QStringLiteral("Tessal"));
  QApplication::setApplicationName(QStringLiteral("tessal-editor"));
  QApplication::setApplicationVersion(QStringLiteral(TESSAL_VERSION));
  QGuiApplication::setDesktopFileName(QStringLiteral("tessal-editor"));
  QApplication::setWindowIcon(QIcon(QStringLiteral(":/tessal.png")));
  return RunHost(application);
}
