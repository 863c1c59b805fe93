// What the module gives a host: eight functions with C linkage, found by name. A host asks for the document
// template and drives everything else through it.
#pragma once

#include <string>

#if defined(_WIN32)
#define TESSAL_EXPORT __declspec(dllexport)
#else
#define TESSAL_EXPORT __attribute__((visibility("default")))
#endif

namespace tessal {
class CMultiDocTemplate;
}

extern "C" {

/// The number of document templates.
TESSAL_EXPORT int CvGetNumDocTemplates();
/// A new document template, which the caller owns; none for any index but 0.
TESSAL_EXPORT tessal::CMultiDocTemplate* CvGetDocTemplatePtr(int index);
/// Fills the text with the editor's name and returns 1; 0 when no text is given.
TESSAL_EXPORT int CvGetEditorString(std::string* text);

// The module has no bitmap and no tool bars: each of these returns 0.
TESSAL_EXPORT int CvGetBitmapId();
TESSAL_EXPORT int CvGetNumToolbars();
TESSAL_EXPORT int CvGetToolbarString();
TESSAL_EXPORT int CvInitToolbar();
TESSAL_EXPORT int CvCreateToolbar();

}  // extern "C"
