#include "app/document_opening.h"

#include <QCoreApplication>
#include <QDateTime>
#include <QFile>
#include <QFileInfo>
#include <QLocale>
#include <QMessageBox>
#include <QPushButton>
#include <utility>

#include "app/comparison_dialog.h"
#include "app/document_lock.h"
#include "app/open_document.h"
#include "platform/busy_notice.h"
#include "platform/docview.h"

namespace tessal {

namespace {

QString Translated(const char* text) {
  return QCoreApplication::translate("DocumentOpening", text);
}

QString TimeOf(const QString& file) {
  return QLocale().toString(QFileInfo(file).lastModified(), QLocale::ShortFormat);
}

}  // namespace

std::unique_ptr<OpenDocument> DocumentOpening::MakeDocument() const {
  return std::make_unique<OpenDocument>(docTemplate.CreateNewDocument());
}

std::unique_ptr<OpenDocument> DocumentOpening::Open(const QString& path) const {
  // A file that is not there is reported by the load, and leaves no lock.
  if (!QFileInfo::exists(path)) return OpenFile(path, nullptr);
  TakenLock taken = LockDocument(path);
  if (!taken.holder.isEmpty()) return OpenHeld(path, taken.holder);
  const FoundWork work = FindWork(path);
  if (!work.IsThere()) return OpenFile(path, std::move(taken.lock));
  switch (DecideAboutWork(work)) {
    case WorkChoice::Recover:
      return Recover(work, std::move(taken.lock));
    case WorkChoice::Discard:
      return OpenFile(path, std::move(taken.lock));
    default:
      return nullptr;
  }
}

std::unique_ptr<OpenDocument> DocumentOpening::OpenFile(const QString& path,
                                                        std::unique_ptr<QLockFile> lock) const {
  const BusyNotice busy(window, Translated("Opening %1...").arg(path));
  auto opened = MakeDocument();
  if (!opened->Open(path)) return nullptr;
  opened->SetLock(std::move(lock));
  return opened;
}

std::unique_ptr<OpenDocument> DocumentOpening::OpenHeld(const QString& path, const QString& holder) const {
  const HeldChoice choice = AskAboutHeld(path, holder);
  if (choice == HeldChoice::Cancel) return nullptr;
  const BusyNotice busy(window, Translated("Opening %1...").arg(path));
  auto opened = MakeDocument();
  if (choice == HeldChoice::Copy) return opened->OpenCopy(path) ? std::move(opened) : nullptr;
  if (!opened->Open(path)) return nullptr;
  opened->SetReadOnly();
  return opened;
}

DocumentOpening::HeldChoice DocumentOpening::AskAboutHeld(const QString& path, const QString& holder) const {
  QMessageBox box(QMessageBox::Question, name,
                  Translated("The file '%1' is open in another editor (%2).").arg(path, holder),
                  QMessageBox::Cancel, &window);
  box.setTextFormat(Qt::PlainText);
  box.setInformativeText(Translated(
      "Read only, it can be saved under another name. A copy is a new document with its content."));
  const QPushButton* readOnly = box.addButton(Translated("Open &Read Only"), QMessageBox::AcceptRole);
  const QPushButton* copy = box.addButton(Translated("Open a &Copy"), QMessageBox::AcceptRole);
  box.exec();
  if (box.clickedButton() == readOnly) return HeldChoice::ReadOnly;
  return box.clickedButton() == copy ? HeldChoice::Copy : HeldChoice::Cancel;
}

std::unique_ptr<OpenDocument> DocumentOpening::OfferWork(const FoundWork& work) const {
  TakenLock taken;
  if (!work.path.isEmpty()) taken = LockDocument(work.path);
  if (!taken.holder.isEmpty() || DecideAboutWork(work) != WorkChoice::Recover) return nullptr;
  return Recover(work, std::move(taken.lock));
}

std::unique_ptr<OpenDocument> DocumentOpening::Recover(const FoundWork& work,
                                                       std::unique_ptr<QLockFile> lock) const {
  auto opened = MakeDocument();
  if (!opened->Recover(work)) return nullptr;
  opened->SetLock(std::move(lock));
  return opened;
}

DocumentOpening::WorkChoice DocumentOpening::DecideAboutWork(const FoundWork& work) const {
  WorkChoice choice = AskAboutWork(work);
  while (choice == WorkChoice::Compare) {
    ShowComparison(work);
    choice = AskAboutWork(work);
  }
  if (choice == WorkChoice::Discard) RecoveryFile(work).Remove();
  return choice;
}

DocumentOpening::WorkChoice DocumentOpening::AskAboutWork(const FoundWork& work) const {
  const bool hasFile = QFileInfo::exists(work.path);
  QString what = Translated("The editor ended before a new document was saved.");
  if (!work.title.isEmpty()) what = Translated("The editor ended before '%1' was saved.").arg(work.title);
  if (!work.path.isEmpty()) {
    what = Translated("The editor ended before the changes to the file '%1' were saved.").arg(work.path);
  }
  QMessageBox box(QMessageBox::Question, name, what, QMessageBox::NoButton, &window);
  box.setTextFormat(Qt::PlainText);
  QString times = Translated("The unsaved work was kept on %1.").arg(TimeOf(work.file));
  if (hasFile) times += u' ' + Translated("The file was written on %1.").arg(TimeOf(work.path));
  box.setInformativeText(times);
  const QPushButton* recover = box.addButton(Translated("&Recover"), QMessageBox::AcceptRole);
  const QPushButton* compare =
      hasFile ? box.addButton(Translated("&Compare..."), QMessageBox::ActionRole) : nullptr;
  const QPushButton* discard = box.addButton(Translated("&Discard"), QMessageBox::DestructiveRole);
  QPushButton* later = box.addButton(Translated("&Not Now"), QMessageBox::RejectRole);
  box.setEscapeButton(later);
  box.exec();
  if (box.clickedButton() == recover) return WorkChoice::Recover;
  if (box.clickedButton() == discard) return WorkChoice::Discard;
  const bool compares = compare != nullptr && box.clickedButton() == compare;
  return compares ? WorkChoice::Compare : WorkChoice::Later;
}

void DocumentOpening::ShowComparison(const FoundWork& work) const {
  const std::unique_ptr<CDocument> unsaved = docTemplate.CreateNewDocument();
  if (!unsaved->OnOpenCopy(QFile::encodeName(work.file).toStdString(), {})) return;
  const DocumentComparison comparison = unsaved->CompareWithFile(QFile::encodeName(work.path).toStdString());
  ComparisonDialog(comparison, Translated("In the file"), Translated("Unsaved work"), &window).exec();
}

}  // namespace tessal
