#include "platform/docview.h"

#include <algorithm>
#include <filesystem>
#include <utility>

namespace tessal {

bool CDocument::OnOpenDocument(const std::string& path) {
  return !path.empty();
}

std::optional<std::string> CDocument::Copy(std::string& reason) {
  reason = "documents of this kind have no copies";
  return std::nullopt;
}

bool CDocument::OnOpenCopy(const std::string& /*source*/, const std::string& /*path*/) {
  return false;
}

DocumentComparison CDocument::CompareWithFile(const std::string& /*path*/) const {
  return {{}, "documents of this kind can not be compared"};
}

void CDocument::SetPathName(const std::string& path) {
  pathName = path;
  title = std::filesystem::path(path).filename().string();
}

void CDocument::AddView(CView& view) {
  if (std::find(views.begin(), views.end(), &view) == views.end()) views.push_back(&view);
}

void CDocument::RemoveView(CView& view) {
  std::erase(views, &view);
}

void CDocument::UpdateAllViews(const CView* sender, int hint, const UpdateHint* argument) {
  // Over a copy: a view may go, or a new one come, while the others are notified.
  const std::vector<CView*> notified = views;
  for (CView* view : notified) {
    const bool stillThere = std::find(views.begin(), views.end(), view) != views.end();
    if (view != sender && stillThere) view->OnUpdate(sender, hint, argument);
  }
}

CMultiDocTemplate::CMultiDocTemplate(int resourceNumber, const std::string& resourceText,
                                     DocumentFactory documentFactory, ViewFactory viewFactory)
    : resource(resourceNumber), makeDocument(std::move(documentFactory)), makeView(std::move(viewFactory)) {
  std::size_t start = 0;
  while (start <= resourceText.size()) {
    const std::size_t end = std::min(resourceText.find('\n', start), resourceText.size());
    names.push_back(resourceText.substr(start, end - start));
    start = end + 1;
  }
}

std::unique_ptr<CView> CMultiDocTemplate::CreateView(CDocument& document) const {
  std::unique_ptr<CView> view = makeView(document);
  document.AddView(*view);
  return view;
}

std::string CMultiDocTemplate::GetDocString(Name name) const {
  const auto place = static_cast<std::size_t>(name);
  return place < names.size() ? names[place] : std::string();
}

}  // namespace tessal
