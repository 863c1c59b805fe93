#include "ui/analysis_tools.h"

#include <QAction>
#include <algorithm>
#include <string>
#include <utility>

#include "core/document.h"
#include "core/find.h"
#include "expr/scanner.h"
#include "ui/analysis_pane.h"
#include "ui/child.h"
#include "ui/element_tree.h"
#include "ui/error_list.h"
#include "ui/find_pane.h"
#include "ui/find_tools.h"
#include "ui/findings_page.h"
#include "ui/influence_page.h"
#include "ui/matrix_page.h"
#include "ui/pools_page.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

/// The place of a finding in the text of its field, in UTF-8, as searches have it.
TextMatch MatchIn(std::string_view bytes, LexemeSpan place) {
  const auto length = [](std::string_view part) { return ToScreen(part).toUtf8().size(); };
  // Places count from after the quote that an expression may have.
  const auto quote = static_cast<std::size_t>(StripExpressionQuotes(bytes).data() - bytes.data());
  const std::size_t start = std::min(bytes.size(), quote + place.start);
  if (place.length == 0) return {0, static_cast<std::size_t>(length(bytes))};
  return {static_cast<std::size_t>(length(bytes.substr(0, start))),
          static_cast<std::size_t>(length(bytes.substr(start, place.length)))};
}

}  // namespace

CAnalysisTools::CAnalysisTools(AnalysisSurroundings surroundings)
    : QObject(&surroundings.view),
      around(std::move(surroundings)),
      pane(MakeChild<CAnalysisPane>(
          around.document, [this] { return SelectedElement(); }, &around.view)) {
  pane->hide();
  // The two panes share the room under the messages.
  connect(pane, &CAnalysisPane::Opening, &around.find.Pane(), &CFindPane::hide);
  connect(&around.find.Pane(), &CFindPane::Opening, pane, &CAnalysisPane::hide);
  connect(pane, &CAnalysisPane::ElementChosen, this, &CAnalysisTools::SelectById);
  connect(pane, &CAnalysisPane::Closed, this, [this] { around.tree.setFocus(Qt::OtherFocusReason); });
  connect(&around.messages, &CErrorList::Refreshed, pane, &CAnalysisPane::NoteChange);
  connect(&pane->Findings(), &CFindingsPage::AnalysisRequested, this, [this] {
    around.commit();
    pane->Findings().Refresh();
  });
  connect(&pane->Findings(), &CFindingsPage::FindingChosen, this, &CAnalysisTools::GoToFinding);
  connect(&pane->Findings(), &CFindingsPage::ExplanationRequested, &around.find, &CFindTools::Explain);
  connect(&pane->Matrix(), &CMatrixPage::UseChosen, this, &CAnalysisTools::GoToUse);
  connect(&pane->Pools(), &CPoolsPage::Edited, this,
          [this] { around.document.UpdateAllViews(nullptr, hint::kCommit); });
  for (const Command& command : CommandRows()) {
    auto* action = MakeChild<QAction>(command.text, &around.view);
    action->setShortcut(QKeySequence(command.key));
    action->setShortcutContext(Qt::WidgetWithChildrenShortcut);
    connect(action, &QAction::triggered, this, command.run);
    around.view.addAction(action);
    commands.push_back({.menu = strings::kAnalysisMenu, .text = {}, .action = action});
  }
}

std::vector<CAnalysisTools::Command> CAnalysisTools::CommandRows() {
  const auto open = [this](CAnalysisPage& page) {
    return [this, &page] {
      around.commit();
      pane->Open(page);
    };
  };
  return {
      {strings::kCommandAnalyse, QStringLiteral("F9"), open(pane->Findings())},
      {strings::kCommandMatrix, QStringLiteral("Shift+F9"), open(pane->Matrix())},
      {strings::kCommandPools, {}, open(pane->Pools())},
      {strings::kCommandInfluences, QStringLiteral("Ctrl+F9"), open(pane->Influences())},
      {strings::kCommandUp, {}, [this] { ShowInfluences(GraphDirection::Up); }},
      {strings::kCommandDown, {}, [this] { ShowInfluences(GraphDirection::Down); }},
  };
}

bool CAnalysisTools::HasTyped() const {
  return pane->Pools().HasTyped();
}

void CAnalysisTools::CommitTyped() {
  pane->Pools().CommitTyped();
}

Uid CAnalysisTools::SelectedElement() const {
  QTreeWidgetItem* item = around.tree.currentItem();
  if (item == nullptr) return Uid::None;
  const CItemData& node = CElementTree::DataOf(*item);
  return IsElement(node.id) && around.document.Core().FindRecordByUid(node.id) != nullptr ? node.id
                                                                                          : Uid::None;
}

void CAnalysisTools::ShowInfluences(GraphDirection direction) {
  around.commit();
  pane->Influences().SetDirection(direction);
  pane->Open(pane->Influences());
}

void CAnalysisTools::SelectById(Uid uid) {
  const NumberHint element(NumberOf(uid));
  around.document.UpdateAllViews(nullptr, hint::kSelectElement, &element);
}

void CAnalysisTools::GoToFinding(const AnalysisFinding& finding) {
  around.commit();
  if (finding.element == Uid::None) return;
  if (finding.field.empty()) return SelectById(finding.element);
  FoundText found;
  found.place = {finding.element, finding.field};
  found.kind = finding.kind;
  const std::string bytes = TextsByPlace(around.document.Core()).TextAt(found.place);
  found.text = ToScreen(bytes).toStdString();
  around.find.GoTo(found, MatchIn(bytes, finding.place));
}

void CAnalysisTools::GoToUse(Uid user, const std::string& name) {
  around.commit();
  const std::vector<FoundText> uses = FindUses(around.document.Core(), name);
  const auto use = std::find_if(uses.begin(), uses.end(),
                                [user](const FoundText& text) { return text.place.element == user; });
  if (use == uses.end()) return SelectById(user);
  around.find.GoTo(*use, use->matches.front());
}

}  // namespace tessal
