#include "ui/export_commands.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <array>
#include <filesystem>
#include <string>

#include "core/document.h"
#include "docgen/html_documentation.h"
#include "docgen/overview.h"
#include "platform/busy_notice.h"
#include "ui/dialogs.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

/// A kind of export. A row is a command of the file menu.
struct Export {
  const char* command;
  const char* title;
  const char* filter;
  std::string (*usualPath)(const std::string& templateFile);
  /// The text of a box that the user may leave unticked, or none.
  QString option;
  bool (*write)(const TemplateCore& core, const std::string& path, bool option, std::string& failure);
};

std::string UsualOverviewPath(const std::string& templateFile) {
  const std::filesystem::path file(templateFile);
  return (file.parent_path() / (file.stem().string() + "_overview.txt")).string();
}

/// Browsers show equations without a script.
bool WritePage(const TemplateCore& core, const std::string& path, bool option, std::string& failure) {
  PageOptions page;
  page.isSafe = option;
  return ExportHtmlDocumentation(core, path, page, failure);
}

bool WriteOverview(const TemplateCore& core, const std::string& path, bool /*option*/, std::string& failure) {
  return ExportOverview(core, path, failure);
}

const std::array<Export, 2> kExports = {{
    {"Export &Documentation...", "Export Documentation", "HTML pages (*.html *.htm);;All files (*)",
     UsualPagePath, strings::kSafePage, WritePage},
    {"Export O&verview...",
     "Export Overview",
     "Text files (*.txt);;All files (*)",
     UsualOverviewPath,
     {},
     WriteOverview},
}};

QString ProposalOf(const Export& what, const CTessalDoc& document) {
  const std::string& file = document.Core().TemplateFileName();
  const std::string name = file.empty() ? strings::kEditorName.toStdString() : file;
  return QFile::decodeName(QByteArray::fromStdString(what.usualPath(name)));
}

/// Empty after a success, otherwise the reason in words. The folder that was proposed may not be there yet.
QString Write(const Export& what, const CTessalDoc& document, const ExportAnswer& answer, QWidget& view) {
  const QString& path = answer.path;
  const BusyNotice busy(view, strings::kExporting.arg(path));
  const QFileInfo folder(QFileInfo(path).absolutePath());
  if (!folder.exists()) QDir().mkdir(folder.filePath());
  std::string failure;
  return what.write(document.Core(), QFile::encodeName(path).toStdString(), answer.option, failure)
             ? QString()
             : ToScreen(failure);
}

void Run(const Export& what, CTessalDoc& document, UserDialogs& dialogs, QWidget& view) {
  document.UpdateAllViews(nullptr, hint::kCommit);
  const ExportAnswer answer =
      dialogs.ChooseExportFile(&view, {QString::fromLatin1(what.title), ProposalOf(what, document),
                                       QString::fromLatin1(what.filter), what.option});
  const QString& path = answer.path;
  if (path.isEmpty()) return;
  const QString failure = Write(what, document, answer, view);
  if (!failure.isEmpty()) {
    dialogs.ShowFailure(&view, strings::kNotExported.arg(path, failure));
  } else if (dialogs.Ask(&view, strings::kExported.arg(path)) == Answer::Yes &&
             !dialogs.OpenWithSystem(path)) {
    dialogs.ShowFailure(&view, strings::kNotOpened.arg(path));
  }
}

}  // namespace

std::vector<ViewCommand> ExportCommands(CTessalDoc& document, UserDialogs& dialogs, QWidget& view) {
  std::vector<ViewCommand> commands;
  commands.reserve(kExports.size());
  for (const Export& what : kExports) {
    commands.push_back(
        {"&File", what.command, [&what, &document, &dialogs, &view] { Run(what, document, dialogs, view); }});
  }
  return commands;
}

}  // namespace tessal
