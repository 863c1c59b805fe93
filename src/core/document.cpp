#include "core/document.h"

#include "core/error_registry.h"
#include "platform/file_replacement.h"

namespace tessal {

namespace {

constexpr std::string_view kModifiedMark = " - Modified";

std::string FailureText(std::string_view what, const std::string& path) {
  return "Failed to " + std::string(what) + " file '" + path + "'\n\n" + Errors().JoinErrors() + ".";
}

/// A file that cannot be read is reported by the load.
TextEncoding EncodingOfFile(const std::string& path) {
  std::string failure;
  return EncodingOf(ReadWholeFile(path, failure).value_or(std::string()));
}

}  // namespace

bool CTessalDoc::OnNewDocument() {
  core.SetModified(false);
  SetNotifyChanges(true);
  return true;
}

bool CTessalDoc::OnOpenDocument(const std::string& path) {
  if (!CDocument::OnOpenDocument(path)) return false;
  encoding = EncodingOfFile(path);
  const bool loaded = core.LoadWrapper(path);
  if (loaded) {
    visibilityGroup = 0;
    visibilityLevel = 0;
    visibilityRecursive = true;
  } else {
    dialogs.ShowMessage(FailureText("load", path));
  }
  // From here on changes of values reach their listeners.
  SetNotifyChanges(true);
  return loaded;
}

bool CTessalDoc::OnSaveDocument(const std::string& path) {
  constexpr std::uint32_t kAllLevels = 0;
  if (Errors().GetErrorCount(kAllLevels) > 0 &&
      !dialogs.AskYesNo("This setup contains some errors or warnings.\nProceed anyway?")) {
    return false;
  }
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

void CTessalDoc::SetModifiedFlag(bool flag) {
  if (IsModified() == flag) return;
  CDocument::SetModifiedFlag(flag);
  // The same for both values: the mark goes when a save puts the plain name back.
  if (Title().find(kModifiedMark) == std::string::npos) SetTitle(Title() + std::string(kModifiedMark));
  for (CView* view : Views()) view->UpdateFrameTitle();
}

}  // namespace tessal
