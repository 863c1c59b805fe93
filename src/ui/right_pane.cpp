#include "ui/right_pane.h"

#include <optional>

#include "core/document.h"
#include "core/rename.h"
#include "ui/dialogs.h"
#include "ui/offered_creation.h"
#include "ui/text_bytes.h"

namespace tessal {

CRightPaneBase::CRightPaneBase(const FormContext& formContext, QWidget* parent)
    : QWidget(parent), where(formContext) {}

CRightPaneBase::~CRightPaneBase() {
  closed = true;
  // The fields go first: one that loses the focus on its way out still reports to its form.
  qDeleteAll(findChildren<QWidget*>(QString(), Qt::FindDirectChildrenOnly));
}

TemplateCore& CRightPaneBase::Core() const {
  return where.document.Core();
}

CEL_Element* CRightPaneBase::Element() const {
  if (where.item.id == folder_id::kMiscellaneous) return Core().GetMisc();
  return IsElement(where.item.id) ? Core().GetElement(where.item.id) : nullptr;
}

void CRightPaneBase::Load() {
  loading = true;
  setUpdatesEnabled(false);
  ItemToForm();
  setUpdatesEnabled(true);
  dirty = false;
  loading = false;
}

void CRightPaneBase::Commit() {
  if (committing) return;
  committing = true;
  FormToItem();
  const bool created = OfferUndefinedSymbols();
  dirty = false;
  committing = false;
  if (created && !loading) Load();
}

bool CRightPaneBase::OfferUndefinedSymbols() {
  bool created = false;
  while (const std::optional<CreationOffer> offer = Core().NextOffer()) {
    if (!Dialogs().Ask(this, ToScreen(offer->question))) continue;
    if (CreateOfferedKind(*offer, Document(), Dialogs(), this)) created = true;
  }
  return created;
}

void CRightPaneBase::NoteEdited() {
  if (!IsDeaf()) dirty = true;
}

void CRightPaneBase::NoteFocusLost() {
  if (!IsDeaf() && dirty) RequestCommit();
}

void CRightPaneBase::NoteChosen() {
  if (IsDeaf()) return;
  dirty = true;
  RequestCommit();
}

void CRightPaneBase::RequestCommit() {
  Document().UpdateAllViews(nullptr, hint::kCommit);
}

void CRightPaneBase::Rename(const std::string& newSymbol) {
  const CEL_Element* element = Element();
  const std::string oldSymbol = element->symbol.Text();
  std::string refusal = RenameRefusal(Core(), newSymbol);
  if (refusal.empty()) {
    const bool rewrite = Core().IsReferenced(element->GetUid()) &&
                         Dialogs().Ask(this, ToScreen("Replace all occurence of '" + oldSymbol + "' with '" +
                                                      newSymbol + "'?"));
    if (!Core().RenameSymbol(oldSymbol, newSymbol, rewrite)) refusal = RenameFailure(newSymbol);
  }
  if (!refusal.empty()) Dialogs().Warn(this, ToScreen(refusal));
}

}  // namespace tessal
