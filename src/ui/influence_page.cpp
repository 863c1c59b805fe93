#include "ui/influence_page.h"

#include <QCheckBox>
#include <QComboBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QSpinBox>
#include <QSplitter>
#include <QVBoxLayout>
#include <algorithm>
#include <numeric>
#include <utility>

#include "core/document.h"
#include "ui/child.h"
#include "ui/focus_watch.h"
#include "ui/icons.h"
#include "ui/influence_view.h"
#include "ui/label.h"
#include "ui/row_table.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

constexpr int kTable = 1304;
constexpr int kMostSteps = 4;

enum Column : std::uint8_t { Element, Relation, Unit, Description };

struct Direction {
  GraphDirection direction;
  const QString& text;
};

const Direction kDirections[] = {
    {GraphDirection::Both, strings::kBothDirections},
    {GraphDirection::Up, strings::kUpwards},
    {GraphDirection::Down, strings::kDownwards},
};

/// All that can use or be used.
std::vector<ElementKind> AllGraphKinds() {
  using enum ElementKind;
  return {StateVariable,    Constant,        Forcing,         Auxiliary,
          Process,          DerivedOutput,   Specie,          SpecieStateVariable,
          SpecieConstant,   SpecieForcing,   SpatialFunction, ArithmeticExpression,
          HorizontalVector, VerticalEquation};
}

QString RelationText(int level) {
  const int count = std::abs(level);
  const QString& one = level < 0 ? strings::kInfluencesThis : strings::kInfluencedByThis;
  const QString& several = level < 0 ? strings::kInfluencesInSteps : strings::kInfluencedInSteps;
  return count == 1 ? one : several.arg(count);
}

}  // namespace

CInfluencePage::CInfluencePage(const CTessalDoc& analysedDocument, std::function<Uid()> selectedElement,
                               QWidget* parent)
    : CAnalysisPage(parent),
      document(analysedDocument),
      selected(std::move(selectedElement)),
      steps(MakeChild<QSpinBox>(this)),
      mainKinds(MakeChild<QCheckBox>(strings::kMainKinds, this)),
      state(MakeChild<CLabel>(this)),
      drawing(MakeChild<CInfluenceView>(this)),
      list(MakeChild<CRowTable>(kTable, strings::kInfluenceList, this)) {
  auto* choices = MakeChild<QHBoxLayout>();
  direction = AddChoice(*choices, strings::kInfluenceDirection);
  for (const Direction& each : kDirections) direction->addItem(each.text, static_cast<int>(each.direction));
  auto* label = MakeChild<QLabel>(strings::kInfluenceSteps + u':', this);
  label->setBuddy(steps);
  steps->setAccessibleName(strings::kInfluenceSteps);
  steps->setRange(1, kMostSteps);
  IgnoreWheelWithoutFocus(*steps);
  choices->addWidget(label);
  choices->addWidget(steps);
  choices->addWidget(mainKinds);
  // As wide as there is room, however long the symbol.
  state->setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Fixed);
  choices->addWidget(state, 1);
  auto* parts = MakeChild<QSplitter>(Qt::Horizontal, this);
  parts->setChildrenCollapsible(false);
  parts->addWidget(drawing);
  parts->addWidget(list);
  constexpr int kDrawingWidth = 600;
  constexpr int kListWidth = 400;
  parts->setSizes({kDrawingWidth, kListWidth});
  auto* rows = MakeChild<QVBoxLayout>(this);
  rows->addLayout(choices);
  rows->addWidget(parts, 1);
  QWidget* stops[] = {direction, steps, mainKinds, drawing, list};
  for (std::size_t place = 1; place < std::size(stops); ++place) setTabOrder(stops[place - 1], stops[place]);
  list->Model().ShowIcons(
      Element,
      [this](const auto& row) { return IconOfKind(graph.nodes[static_cast<std::size_t>(row.key)].kind); },
      [this](const auto& row) {
        return ToScreen(KindText(graph.nodes[static_cast<std::size_t>(row.key)].kind));
      });
  connect(direction, &QComboBox::currentIndexChanged, this, &CInfluencePage::Refresh);
  connect(steps, &QSpinBox::valueChanged, this, &CInfluencePage::Refresh);
  connect(mainKinds, &QCheckBox::toggled, this, &CInfluencePage::Refresh);
  connect(drawing, &CInfluenceView::ElementChosen, this, &CInfluencePage::ElementChosen);
  connect(list, &CRowTable::RowEntered, this,
          [this](int row) { emit ElementChosen(list->Model().Rows()[static_cast<std::size_t>(row)].uid); });
}

QWidget& CInfluencePage::FirstStop() const {
  return *drawing;
}

void CInfluencePage::SetDirection(GraphDirection wanted) {
  direction->setCurrentIndex(direction->findData(static_cast<int>(wanted)));
}

GraphQuery CInfluencePage::Query() const {
  GraphQuery query;
  query.focus = selected();
  query.depth = static_cast<std::size_t>(steps->value());
  query.direction = static_cast<GraphDirection>(direction->currentData().toInt());
  query.kinds = mainKinds->isChecked() ? UsualGraphKinds() : AllGraphKinds();
  return query;
}

void CInfluencePage::Refresh() {
  const GraphQuery query = Query();
  // Without an element it would be the graph of the whole template, which nobody has asked for.
  graph = IsElement(query.focus) ? BuildGraph(document.Core(), query) : DependencyGraph();
  FindMutual();
  ShowState(drawing->Draw(graph));
  ShowList();
}

void CInfluencePage::FindMutual() {
  mutual.assign(graph.nodes.size(), false);
  for (const GraphEdge& edge : graph.edges) {
    if (graph.nodes[edge.source].level == 0 && graph.nodes[edge.target].level == -1)
      mutual[edge.target] = true;
  }
}

void CInfluencePage::ShowState(std::size_t leftOut) {
  const GraphNode* focus = nullptr;
  int above = 0;
  int below = 0;
  for (std::size_t place = 0; place < graph.nodes.size(); ++place) {
    const GraphNode& node = graph.nodes[place];
    if (node.level == 0) focus = &node;
    if (node.level < 0) ++above;
    if (node.level > 0 || mutual[place]) ++below;
  }
  if (focus == nullptr) {
    state->setText(strings::kNoElement);
    return;
  }
  const QString text =
      strings::kInfluencesOf.arg(ToScreen(focus->symbol), QString::number(above), QString::number(below));
  state->setText(leftOut == 0 ? text : text + QStringLiteral(". ") + strings::kNotDrawn.arg(leftOut));
}

std::string CInfluencePage::ListText(std::size_t place, int column) const {
  const GraphNode& node = graph.nodes[place];
  switch (column) {
    case Element:
      return node.symbol;
    case Relation:
      if (node.level == 0) return strings::kThisElement.toStdString();
      return (RelationText(node.level) + (mutual[place] ? QStringLiteral(", ") + RelationText(1) : QString()))
          .toStdString();
    case Unit:
      return node.unit;
    default:
      return node.description;
  }
}

void CInfluencePage::ShowList() {
  // By columns of the drawing, from the left.
  std::vector<std::size_t> places(graph.nodes.size());
  std::iota(places.begin(), places.end(), std::size_t{0});
  std::stable_sort(places.begin(), places.end(), [this](std::size_t left, std::size_t right) {
    return graph.nodes[left].level < graph.nodes[right].level;
  });
  std::vector<CRowModel::Row> rows;
  rows.reserve(places.size());
  for (const std::size_t place : places)
    rows.push_back({graph.nodes[place].uid, static_cast<std::int32_t>(place), 0});
  list->Fill(
      {strings::kElementColumn, strings::kRelationColumn, strings::kUnitColumn, strings::kDescriptionColumn},
      std::move(rows), [this](const CRowModel::Row& row, int column) {
        return ListText(static_cast<std::size_t>(row.key), column);
      });
}

}  // namespace tessal
