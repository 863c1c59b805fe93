#include "module/exports.h"

#include <memory>

#include "core/document.h"
#include "ui/dialogs.h"
#include "ui/main_view.h"

namespace {

constexpr int kDocumentResource = 676;
constexpr const char* kDocumentText =
    "\nTessal\nTessal\nTESSAL Files (*.tessal)\n.tessal\nTessal.Document\nTessal Setup.Document";
constexpr const char* kEditorName = "Tessal";

std::unique_ptr<tessal::CDocument> MakeDocument() {
  return std::make_unique<tessal::CTessalDoc>(tessal::ScreenDialogs());
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
