#include "module/exports.h"

#include <memory>
#include <string>

#include "core/document.h"
#include "expr/carbonate/options.h"
#include "ui/dialogs.h"
#include "ui/main_view.h"

namespace {

constexpr int kDocumentResource = 676;
constexpr const char* kDocumentText =
    "\nTessal\nTessal\nTESSAL Files (*.tessal)\n.tessal\nTessal.Document\nTessal Setup.Document";
constexpr const char* kEditorName = "Tessal";

/// The first template of the process reads the option file; what is wrong with that is reported once.
std::unique_ptr<tessal::CDocument> MakeDocument() {
  const bool wasReported = !tessal::CarbonateProblem().empty();
  auto made = std::make_unique<tessal::CTessalDoc>(tessal::ScreenDialogs());
  const std::string& problem = tessal::CarbonateProblem();
  if (!problem.empty() && !wasReported) tessal::ScreenDialogs().ShowMessage(problem);
  return made;
}

/// A host gives back the documents that it got from this module's template.
std::unique_ptr<tessal::CView> MakeView(tessal::CDocument& document) {
  return std::make_unique<tessal::CMainView>(static_cast<tessal::CTessalDoc&>(document),
                                             tessal::ScreenDialogs());
}

}  // namespace

int CvGetNumDocTemplates() {
  return 1;
}

tessal::CMultiDocTemplate* CvGetDocTemplatePtr(int index) {
  if (index != 0) return nullptr;
  return std::make_unique<tessal::CMultiDocTemplate>(kDocumentResource, kDocumentText, MakeDocument, MakeView)
      .release();
}

int CvGetEditorString(std::string* text) {
  if (text == nullptr) return 0;
  *text = kEditorName;
  return 1;
}

int CvGetBitmapId() {
  return 0;
}

int CvGetNumToolbars() {
  return 0;
}

int CvGetToolbarString() {
  return 0;
}

int CvInitToolbar() {
  return 0;
}

int CvCreateToolbar() {
  return 0;
}
