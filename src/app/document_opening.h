// From a path to an open document, with the questions on the way: what becomes of unsaved work that was left,
// and how a file is opened that another editor has open.
#pragma once

#include <QString>
#include <memory>

#include "app/recovery_file.h"

class QWidget;

namespace tessal {

class CMultiDocTemplate;
class OpenDocument;

class DocumentOpening final {
 public:
  /// The template makes the documents; the questions come up over the window.
  DocumentOpening(const CMultiDocTemplate& documents, QWidget& over, const QString& editorName)
      : docTemplate(documents), window(over), name(editorName) {}

  /// The document of the file at the full path, not shown yet; none when it did not load or the user
  /// declined.
  std::unique_ptr<OpenDocument> Open(const QString& path) const;
  /// Offers work that was left; none as well when the user gave it up.
  std::unique_ptr<OpenDocument> OfferWork(const FoundWork& work) const;

 private:
  enum class HeldChoice { ReadOnly, Copy, Cancel };
  enum class WorkChoice { Recover, Discard, Compare, Later };
  /// Ends with the work removed on Discard.
  WorkChoice DecideAboutWork(const FoundWork& work) const;

  std::unique_ptr<OpenDocument> OpenFile(const QString& path, std::unique_ptr<QLockFile> lock) const;
  std::unique_ptr<OpenDocument> OpenHeld(const QString& path, const QString& holder) const;
  std::unique_ptr<OpenDocument> Recover(const FoundWork& work, std::unique_ptr<QLockFile> lock) const;
  HeldChoice AskAboutHeld(const QString& path, const QString& holder) const;
  WorkChoice AskAboutWork(const FoundWork& work) const;
  void ShowComparison(const FoundWork& work) const;
  std::unique_ptr<OpenDocument> MakeDocument() const;

  const CMultiDocTemplate& docTemplate;
  QWidget& window;
  QString name;
};

}  // namespace tessal
