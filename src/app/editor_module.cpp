#include "app/editor_module.h"

#include <QDir>
#include <QFileInfo>
#include <algorithm>
#include <array>
#include <string>

#include "platform/docview.h"

namespace tessal {

namespace {

const QString kModuleFile = QStringLiteral("libtessal_editor.so");

/// Beside the program where it was built, and where an installation puts it.
constexpr std::array<const char*, 3> kFolders = {"../lib", TESSAL_MODULE_FOLDER, "."};

using CountTemplates = int (*)();
using GetTemplate = CMultiDocTemplate* (*)(int);
using GetName = int (*)(std::string*);

template <class Function>
Function Resolve(QLibrary& library, const char* name) {
  return reinterpret_cast<Function>(library.resolve(name));
}

}  // namespace

QStringList EditorModule::UsualPlaces(const QString& programFolder) {
  QStringList places;
  // A folder that is not known would be the current one, which holds whatever somebody put there.
  if (QDir::isRelativePath(programFolder)) return places;
  for (const char* folder : kFolders) {
    places.append(
        QDir::cleanPath(QDir(programFolder).filePath(QString::fromLatin1(folder) + u'/' + kModuleFile)));
  }
  return places;
}

bool EditorModule::Load(const QStringList& places) {
  const auto file = std::find_if(places.begin(), places.end(),
                                 [](const QString& place) { return QFileInfo::exists(place); });
  if (file == places.end()) {
    failure = QStringLiteral("The editor's module was not found. Looked for:\n\n%1").arg(places.join(u'\n'));
    return false;
  }
  library.setFileName(*file);
  if (!library.load()) {
    failure = QStringLiteral("The editor's module could not be loaded.\n\n%1").arg(library.errorString());
    return false;
  }
  const auto count = Resolve<CountTemplates>(library, "CvGetNumDocTemplates");
  const auto name = Resolve<GetName>(library, "CvGetEditorString");
  std::string text;
  if (count == nullptr || name == nullptr || !library.resolve("CvGetDocTemplatePtr") || count() < 1 ||
      name(&text) == 0) {
    failure = QStringLiteral("This file is not an editor module:\n\n%1").arg(*file);
    return false;
  }
  editorName = QString::fromStdString(text);
  return true;
}

std::unique_ptr<CMultiDocTemplate> EditorModule::MakeDocTemplate() {
  const auto make = Resolve<GetTemplate>(library, "CvGetDocTemplatePtr");
  return std::unique_ptr<CMultiDocTemplate>(make == nullptr ? nullptr : make(0));
}

}  // namespace tessal
