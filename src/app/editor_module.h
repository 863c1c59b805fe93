// The plug-in module that holds the editor: found beside the host, loaded, and asked for its document
// template.
#pragma once

#include <QLibrary>
#include <QString>
#include <QStringList>
#include <memory>

namespace tessal {

class CMultiDocTemplate;

class EditorModule final {
 public:
  /// Where the module is looked for, seen from the folder of the host's program.
  static QStringList UsualPlaces(const QString& programFolder);

  /// Loads the first of the files that is there. False, with a text for the user, when none is, or when it is
  /// no module of this kind.
  bool Load(const QStringList& places);
  const QString& Failure() const { return failure; }

  const QString& EditorName() const { return editorName; }
  /// A new document template of the loaded module.
  std::unique_ptr<CMultiDocTemplate> MakeDocTemplate();

 private:
  QLibrary library;
  QString editorName;
  QString failure;
};

}  // namespace tessal
