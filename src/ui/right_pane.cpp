#include "ui/right_pane.h"

#include <algorithm>
#include <optional>

#include "core/document.h"
#include "core/rename.h"
#include "ui/dialogs.h"
#include "ui/offered_creation.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

/// What was not asked about counts as asked from now on.
void DeclineOffers(TemplateCore& core) {
  while (core.NextOffer()) continue;
}

Rewriting RewritingOf(Answer replaces) {
  switch (replaces) {
    case Answer::Yes:
      return Rewriting::ByLetters;
    case Answer::WholeNames:
      return Rewriting::WholeNames;
    default:
      return Rewriting::None;
  }
}

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
  {
    const EditStep step(Core().History());
    FormToItem();
  }
  const bool created = OfferUndefinedSymbols();
  dirty = false;
  committing = false;
  if (created && !loading) Load();
}

Answer CRightPaneBase::AskAbout(const CreationOffer& offer) {
  const auto& undefined = Core().UndefinedSymbols();
  const bool isLast =
      std::all_of(undefined.begin(), undefined.end(), [](const auto& each) { return each->asked; });
  const QString question = ToScreen(offer.question);
  return isLast ? Dialogs().Ask(this, question) : Dialogs().AskOneOfMany(this, question);
}

bool CRightPaneBase::OfferUndefinedSymbols() {
  bool created = false;
  while (const std::optional<CreationOffer> offer = Core().NextOffer()) {
    const Answer answer = AskAbout(*offer);
    if (answer == Answer::NoToAll) DeclineOffers(Core());
    if (answer == Answer::Yes && CreateOfferedKind(*offer, Document(), Dialogs(), this)) created = true;
  }
  return created;
}

void CRightPaneBase::NoteEdited() {
  if (!IsDeaf()) dirty = true;
}

void CRightPaneBase::NoteTyped() {
  if (!IsDeaf()) Document().SetModifiedFlag(true);
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

void CRightPaneBase::JumpTo(Uid uid) {
  const NumberHint argument(NumberOf(uid));
  Document().UpdateAllViews(nullptr, hint::kSelectElement, &argument);
}

Answer CRightPaneBase::AskToReplace(const std::string& oldSymbol, const std::string& newSymbol) {
  QString question = ToScreen("Replace all occurence of '" + oldSymbol + "' with '" + newSymbol + "'?");
  const std::vector<LostName> lost = LostByRename(Core(), oldSymbol, newSymbol);
  if (lost.empty()) return Dialogs().Ask(this, question);
  constexpr std::size_t kShown = 10;
  question += "\n\n" + strings::kLongerNames.arg(lost.size());
  for (std::size_t place = 0; place < std::min(kShown, lost.size()); ++place) {
    question += "\n" + ToScreen(LossText(Core(), lost[place]));
  }
  if (lost.size() > kShown) question += "\n" + strings::kMoreNames.arg(lost.size() - kShown);
  return Dialogs().AskToReplace(this, question);
}

bool CRightPaneBase::Rename(const std::string& newSymbol) {
  const CEL_Element* element = Element();
  const std::string oldSymbol = element->symbol.TextOf();
  std::string refusal = RenameRefusal(Core(), newSymbol);
  Answer replaces = Answer::Yes;
  if (refusal.empty()) {
    if (Core().IsReferenced(element->GetUid())) replaces = AskToReplace(oldSymbol, newSymbol);
    if (replaces == Answer::Cancelled) return false;
    if (!Core().Rename(oldSymbol, newSymbol, RewritingOf(replaces))) refusal = RenameFailure(newSymbol);
  }
  if (!refusal.empty()) Dialogs().Warn(this, ToScreen(refusal));
  return refusal.empty() && replaces != Answer::No;
}

}  // namespace tessal
