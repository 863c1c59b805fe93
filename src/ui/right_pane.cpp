#include "ui/right_pane.h"

#include "core/document.h"
#include "core/rename.h"
#include "ui/create_hint.h"
#include "ui/dialogs.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

/// The questions about undefined symbols, asked over a form.
class FormQuestions final : public CreationQuestions {
 public:
  FormQuestions(QWidget& formWidget, UserDialogs& userDialogs, CTessalDoc& owningDocument)
      : form(formWidget), dialogs(userDialogs), document(owningDocument) {}

  bool AskYesNo(const std::string& question) override { return dialogs.Ask(&form, ToScreen(question)); }

  int ChooseKind(const std::string& symbol, std::uint32_t mask) override {
    return dialogs.ChooseKind(&form, ToScreen(symbol), mask);
  }

  void Create(const CreateRequest& request) override {
    const CreateHint argument(request);
    document.UpdateAllViews(nullptr, hint::kCreateElement, &argument);
  }

 private:
  QWidget& form;
  UserDialogs& dialogs;
  CTessalDoc& document;
};

}  // namespace

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
  FormQuestions questions(*this, where.dialogs, where.document);
  const bool created = Core().OfferUndefinedSymbols(questions);
  dirty = false;
  committing = false;
  if (created && !loading) Load();
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

bool CRightPaneBase::Rename(const std::string& newSymbol) {
  const CEL_Element* element = Element();
  const std::string oldSymbol = element->symbol.Text();
  std::string refusal = RenameRefusal(Core(), newSymbol);
  if (refusal.empty()) {
    const bool rewrite = Core().IsReferenced(element->GetUid()) &&
                         Dialogs().Ask(this, ToScreen("Replace all occurence of '" + oldSymbol + "' with '" +
                                                      newSymbol + "'?"));
    if (!Core().RenameSymbol(oldSymbol, newSymbol, rewrite)) refusal = RenameFailure(newSymbol);
  }
  if (refusal.empty()) return true;
  Dialogs().Warn(this, ToScreen(refusal));
  return false;
}

}  // namespace tessal
