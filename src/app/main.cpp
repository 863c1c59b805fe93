// The host application: finds the editor's module, and opens the files of the command line in it.
#include <QApplication>
#include <QCommandLineParser>
#include <QIcon>
#include <QMessageBox>
#include <clocale>
#include <cstdio>
#include <span>

#include "app/editor_module.h"
#include "app/editor_options.h"
#include "app/host_window.h"
#include "app/session.h"
#include "platform/build_info.h"
#include "platform/docview.h"

namespace {

constexpr int kNoModule = 2;
constexpr int kCallFault = 2;

QString Words(std::string_view words) {
  return QString::fromUtf8(words.data(), static_cast<qsizetype>(words.size()));
}

void AddOptions(QCommandLineParser& line, std::span<const tessal::EditorOption> options) {
  for (const tessal::EditorOption& option : options) {
    QStringList names(Words(option.name));
    if (!option.letter.empty()) names += Words(option.letter);
    line.addOption(QCommandLineOption(names, Words(option.meaning), Words(option.value)));
  }
}

/// Reads the call. There is no application yet, which would need a screen.
bool ReadCall(QCommandLineParser& line, int count, char** arguments) {
  // The toolkit's own options are known with one hyphen.
  line.setSingleDashWordOptionMode(QCommandLineParser::ParseAsLongOptions);
  AddOptions(line, tessal::kEditorOptions);
  AddOptions(line, tessal::kToolkitOptions);
  QStringList call;
  for (int place = 0; place < count; ++place) call += QString::fromLocal8Bit(arguments[place]);
  return line.parse(call);
}

int RunHost(const QCommandLineParser& line) {
  tessal::EditorModule module;
  const QString option = Words(tessal::kModuleOption);
  const QStringList places = line.isSet(option)
                                 ? QStringList{line.value(option)}
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

/// Prints a text that was asked for, and returns how the program ends.
int Print(const std::string& text) {
  const bool isPrinted = std::fputs(text.c_str(), stdout) >= 0 && std::fflush(stdout) == 0;
  return isPrinted ? 0 : kCallFault;
}

}  // namespace

int main(int count, char** arguments) {
  QCommandLineParser line;
  const bool isRead = ReadCall(line, count, arguments);
  if (isRead && line.isSet(Words(tessal::kHelpOption))) return Print(tessal::EditorHelp());
  if (isRead && line.isSet(Words(tessal::kVersionOption))) {
    return Print(tessal::BuildText("tessal-editor") + "\n");
  }
  if (!isRead) {
    std::fprintf(stderr, "tessal-editor: %s\n", qPrintable(line.errorText()));
    return kCallFault;
  }
  QApplication application(count, arguments);
  // The application sets the user's locale; the numbers of templates are read and written without it.
  std::setlocale(LC_NUMERIC, "C");
  QApplication::setOrganizationName(QStringLiteral("Tessal"));
  QApplication::setApplicationName(QStringLiteral("tessal-editor"));
  QApplication::setApplicationVersion(Words(tessal::ProgramVersion()));
  QGuiApplication::setDesktopFileName(QStringLiteral("tessal-editor"));
  QApplication::setWindowIcon(QIcon(QStringLiteral(":/tessal.png")));
  return RunHost(line);
}
