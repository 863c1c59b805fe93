#include "core/document.h"

#include <utility>
#include <vector>

#include "core/comparison.h"
#include "core/error_registry.h"
#include "expr/scanner.h"
#include "platform/file_replacement.h"

namespace tessal {

namespace {

constexpr std::string_view kModifiedMark = " - Modified";
constexpr std::uint32_t kAllLevels = 0;

std::string FailureText(std::string_view what, const std::string& path) {
  return "Failed to " + std::string(what) + " file '" + path + "'\n\n" + Errors().JoinErrors() + ".";
}

std::string WordOf(ChangeKind change) {
  switch (change) {
    case ChangeKind::Removed:
      return "Removed";
    case ChangeKind::Added:
      return "Added";
    case ChangeKind::Renamed:
      return "Renamed";
    case ChangeKind::Changed:
      break;
  }
  return "Changed";
}

/// A row for each field of a changed item; one for an item that was added, removed or renamed.
void AppendRows(const SymbolChange& change, std::vector<DocumentDifference>& rows) {
  const DocumentDifference item{WordOf(change.change), change.kind, ToUtf8(change.symbol), "", "", ""};
  if (change.change == ChangeKind::Renamed) {
    rows.push_back(item);
    rows.back().field = "Symbol";
    rows.back().before = ToUtf8(change.formerSymbol);
    rows.back().after = ToUtf8(change.symbol);
  } else if (change.change != ChangeKind::Changed) {
    rows.push_back(item);
  }
  for (const FieldChange& field : change.fields) {
    DocumentDifference row = item;
    row.field = field.field;
    row.before = ToUtf8(field.before);
    row.after = ToUtf8(field.after);
    rows.push_back(std::move(row));
  }
}

}  // namespace

bool CTessalDoc::OnNewDocument() {
  core.SetModified(false);
  core.History().Start();
  SetNotifyChanges(true);
  return true;
}

bool CTessalDoc::OnOpenDocument(const std::string& path) {
  return CDocument::OnOpenDocument(path) && Open(path, path);
}

bool CTessalDoc::OnOpenCopy(const std::string& source, const std::string& path) {
  return Open(source, path);
}

bool CTessalDoc::Open(const std::string& source, const std::string& path) {
  const bool loaded = core.LoadCopy(source, path);
  encoding = EncodingOf(core.SourceText());
  if (loaded && source != path && !path.empty()) NoteLossesOf(path);
  if (loaded) {
    visibilityGroup = 0;
    visibilityLevel = 0;
    visibilityRecursive = true;
  } else {
    dialogs.ShowMessage(FailureText("load", source));
  }
  core.History().Start();
  // A copy is not what the file holds.
  if (source != path) core.History().ForgetSaved();
  // From here on changes of values reach their listeners.
  SetNotifyChanges(true);
  return loaded;
}

void CTessalDoc::NoteLossesOf(const std::string& path) {
  const MessagesAside aside;
  const ScannerRest rest;
  TemplateCore file;
  if (file.LoadWrapper(path)) core.AddToAccount(file.Account());
}

bool CTessalDoc::MayLose(const std::string& path) {
  if (path != core.SaveFileName() || !core.Account().Loses()) return true;
  std::vector<std::string> losses;
  for (const AccountEntry& entry : core.Account().Entries()) {
    if (entry.kind != AccountKind::Absent) losses.push_back(entry.text);
  }
  const LossAnswer answer = dialogs.AskAboutLosses(path, losses);
  if (answer.wish != LossAnswer::Wish::SaveCopy) return answer.wish == LossAnswer::Wish::Replace;
  std::string reason;
  const std::optional<std::string> text = Copy(reason);
  if (text) reason = ReplaceFile(answer.copyPath, *text);
  if (!reason.empty()) {
    dialogs.ShowMessage("Failed to save file '" + answer.copyPath + "'\n\n" + reason + ".");
  }
  return false;
}

bool CTessalDoc::OnSaveDocument(const std::string& path) {
  if (Errors().GetErrorCount(kAllLevels) > 0 &&
      !dialogs.AskYesNo("This setup contains some errors or warnings.\nProceed anyway?")) {
    return false;
  }
  if (!MayLose(path)) return false;
  const bool hadMisc = core.GetMisc() != nullptr;
  const bool saved = core.SaveWrapper(path);
  if (saved) {
    SetModifiedFlag(false);
  } else {
    dialogs.ShowMessage(FailureText("save", path));
  }
  if (!hadMisc && core.GetMisc() != nullptr) {
    const NumberHint shown(1);
    UpdateAllViews(nullptr, hint::kShowMisc, &shown);
  }
  return saved;
}

std::optional<std::string> CTessalDoc::Copy(std::string& reason) {
  const MessagesAside aside;
  std::optional<std::string> text = core.CopyText(reason);
  if (!text && Errors().GetErrorCount(kAllLevels) > 0) reason += "\n" + Errors().JoinErrors();
  return text;
}

DocumentComparison CTessalDoc::CompareWithFile(const std::string& path) const {
  const MessagesAside aside;
  const ScannerRest rest;
  TemplateCore file;
  if (!file.LoadWrapper(path)) return {{}, FailureText("load", path)};
  DocumentComparison comparison;
  for (const SymbolChange& change : CompareBySymbol(file, core)) AppendRows(change, comparison.differences);
  return comparison;
}

std::optional<StepEffect> CTessalDoc::Undo() {
  std::optional<StepEffect> effect = core.Undo();
  if (effect) FollowMark();
  return effect;
}

std::optional<StepEffect> CTessalDoc::Redo() {
  std::optional<StepEffect> effect = core.Redo();
  if (effect) FollowMark();
  return effect;
}

void CTessalDoc::NoteOtherFile() {
  core.History().ForgetSaved();
  SetModifiedFlag(true);
}

void CTessalDoc::FollowMark() {
  if (core.Modified()) return SetModifiedFlag(true);
  CDocument::SetModifiedFlag(false);
  const std::size_t mark = Title().rfind(kModifiedMark);
  if (mark != std::string::npos) SetTitle(Title().substr(0, mark));
  for (CView* view : Views()) view->UpdateFrameTitle();
}

void CTessalDoc::SetModifiedFlag(bool flag) {
  if (IsModified() == flag) return;
  CDocument::SetModifiedFlag(flag);
  // The same for both values: the mark goes when a save puts the plain name back.
  if (Title().find(kModifiedMark) == std::string::npos) SetTitle(Title() + std::string(kModifiedMark));
  for (CView* view : Views()) view->UpdateFrameTitle();
}

}  // namespace tessal
