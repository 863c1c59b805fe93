#include "platform/docview.h"

#include <gtest/gtest.h>

namespace tessal {
namespace {

class PlainDocument final : public CDocument {
 public:
  bool OnSaveDocument(const std::string& /*path*/) override { return true; }
};

class NotingView final : public CView {
 public:
  explicit NotingView(CDocument& watched) : document(watched) {}
  void OnUpdate(const CView* /*sender*/, int hint, const UpdateHint* /*argument*/) override {
    hints.push_back(hint);
    if (leaves != nullptr) document.RemoveView(*leaves);
  }
  std::vector<int> hints;
  CView* leaves = nullptr;

 private:
  CDocument& document;
};

TEST(DocView, HintsReachEveryViewButTheSender) {
  PlainDocument document;
  NotingView first(document);
  NotingView second(document);
  document.AddView(first);
  document.AddView(first);
  document.AddView(second);
  document.UpdateAllViews(&first, 4);
  document.UpdateAllViews(nullptr, 5);
  EXPECT_EQ(first.hints, (std::vector<int>{5}));
  EXPECT_EQ(second.hints, (std::vector<int>{4, 5}));
  // A view that goes while the others are notified hears no more.
  first.leaves = &second;
  document.UpdateAllViews(nullptr, 7);
  EXPECT_EQ(second.hints.size(), 2U);
}

TEST(DocView, TheTemplateNamesItsKindOfFiles) {
  const CMultiDocTemplate documents(
      676, "\nTessal\nTessal\nTESSAL Files (*.tessal)\n.tessal\nTessal.Document\nTessal Setup.Document",
      [] { return std::make_unique<PlainDocument>(); },
      [](CDocument& document) { return std::make_unique<NotingView>(document); });
  EXPECT_EQ(documents.GetDocString(CMultiDocTemplate::kWindowTitle), "");
  EXPECT_EQ(documents.GetDocString(CMultiDocTemplate::kFilterExtension), ".tessal");
  EXPECT_EQ(documents.GetDocString(CMultiDocTemplate::kFileTypeName), "Tessal Setup.Document");
  const auto document = documents.CreateNewDocument();
  const auto view = documents.CreateView(*document);
  EXPECT_EQ(document->Views().size(), 1U);
  document->SetPathName("/some/where/lake.tessal");
  EXPECT_EQ(document->Title(), "lake.tessal");
}

}  // namespace
}  // namespace tessal
