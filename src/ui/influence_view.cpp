#include "ui/influence_view.h"

#include <QGraphicsScene>
#include <QGraphicsTextItem>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QPainterPath>
#include <QStyle>
#include <algorithm>
#include <cmath>
#include <numeric>
#include <unordered_map>
#include <utility>

#include "ui/child.h"
#include "ui/icons.h"
#include "ui/plain_tip.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

constexpr qreal kPadding = 5;
constexpr qreal kRowGap = 8;
constexpr qreal kColumnGap = 70;
constexpr qreal kArrow = 7;
constexpr qreal kRadius = 4;
constexpr int kMostCharacters = 28;

int IconSize(const QWidget& view) {
  return view.style()->pixelMetric(QStyle::PM_SmallIconSize);
}

/// Something between the ground and the texts, so that lines are seen on any palette and boxes lie above
/// them.
QColor LineColour(const QPalette& palette) {
  constexpr int kOpacity = 150;
  QColor colour = palette.color(QPalette::Text);
  colour.setAlpha(kOpacity);
  return colour;
}

}  // namespace

CInfluenceView::CInfluenceView(QWidget* parent) : QGraphicsView(parent) {
  setScene(MakeChild<QGraphicsScene>(this));
  setAccessibleName(strings::kInfluenceDrawing);
  // A reader meets the part within the frame.
  viewport()->setAccessibleName(strings::kInfluenceDrawing);
  setRenderHint(QPainter::Antialiasing);
  setFocusPolicy(Qt::StrongFocus);
  setBackgroundRole(QPalette::Base);
}

std::vector<std::size_t> CInfluenceView::Chosen(const DependencyGraph& graph) {
  std::vector<std::size_t> places(graph.nodes.size());
  std::iota(places.begin(), places.end(), std::size_t{0});
  const auto levelOf = [&graph](std::size_t place) { return graph.nodes[place].level; };
  if (places.size() > kMostDrawn) {
    std::stable_sort(places.begin(), places.end(), [&levelOf](std::size_t left, std::size_t right) {
      return std::abs(levelOf(left)) < std::abs(levelOf(right));
    });
    places.resize(kMostDrawn);
    std::sort(places.begin(), places.end());
  }
  std::stable_sort(places.begin(), places.end(), [&levelOf](std::size_t left, std::size_t right) {
    return levelOf(left) < levelOf(right);
  });
  return places;
}

std::size_t CInfluenceView::Draw(const DependencyGraph& graph) {
  const Uid former = current < boxes.size() ? boxes[current].node.uid : Uid::None;
  boxes.clear();
  edges.clear();
  current = 0;
  std::unordered_map<std::size_t, std::size_t> boxOfNode;
  for (const std::size_t place : Chosen(graph)) {
    boxOfNode.emplace(place, boxes.size());
    boxes.push_back({graph.nodes[place], {}});
  }
  for (const GraphEdge& edge : graph.edges) {
    const auto source = boxOfNode.find(edge.source);
    const auto target = boxOfNode.find(edge.target);
    if (source == boxOfNode.end() || target == boxOfNode.end() || source == target) continue;
    edges.push_back({source->second, target->second, edge.isDirect});
  }
  const auto isFormer = [former](const Box& box) { return box.node.uid == former; };
  auto box = std::find_if(boxes.begin(), boxes.end(), isFormer);
  if (box == boxes.end())
    box = std::find_if(boxes.begin(), boxes.end(), [](const Box& each) { return each.node.level == 0; });
  Redraw();
  if (box != boxes.end()) SetCurrent(static_cast<std::size_t>(box - boxes.begin()));
  return graph.nodes.size() - boxes.size();
}

void CInfluenceView::PlaceBoxes() {
  const QFontMetrics metrics = fontMetrics();
  const qreal height = std::max<qreal>(metrics.height(), IconSize(*this)) + 2 * kPadding;
  qreal left = 0;
  for (auto first = boxes.begin(); first != boxes.end();) {
    const auto last = std::find_if(first, boxes.end(), [level = first->node.level](const Box& each) {
      return each.node.level != level;
    });
    qreal width = 0;
    for (auto box = first; box != last; ++box) {
      const QString shown = ToScreen(box->node.symbol).left(kMostCharacters);
      width = std::max<qreal>(width, metrics.horizontalAdvance(shown + u'…'));
    }
    width += 3 * kPadding + IconSize(*this);
    // Columns are centred on one line.
    qreal top = -static_cast<qreal>(last - first) * (height + kRowGap) / 2;
    for (auto box = first; box != last; ++box) {
      box->place = QRectF(left, top, width, height);
      top += height + kRowGap;
    }
    left += width + kColumnGap;
    first = last;
  }
}

void CInfluenceView::DrawBoxes() {
  const int icon = IconSize(*this);
  for (const Box& box : boxes) {
    QPainterPath outline;
    outline.addRoundedRect(box.place, kRadius, kRadius);
    // The element itself is seen by its thick outline.
    const bool isFocus = box.node.level == 0;
    auto* item = scene()->addPath(outline, QPen(palette().color(QPalette::Text), isFocus ? 3 : 1),
                                  palette().brush(QPalette::Button));
    QStringList tip = {ToScreen(box.node.symbol)};
    for (const std::string* part : {&box.node.description, &box.node.unit}) {
      if (!part->empty()) tip.append(ToScreen(*part));
    }
    item->setToolTip(PlainTip(tip.join(QStringLiteral(", "))));
    auto* picture = scene()->addPixmap(IconOfKind(box.node.kind).pixmap(icon, icon));
    picture->setPos(box.place.left() + kPadding, box.place.center().y() - icon / 2.0);
    QString symbol = ToScreen(box.node.symbol);
    if (symbol.size() > kMostCharacters) symbol = symbol.left(kMostCharacters) + u'…';
    auto* text = scene()->addSimpleText(symbol, font());
    text->setBrush(palette().brush(QPalette::ButtonText));
    text->setPos(box.place.left() + 2 * kPadding + icon,
                 box.place.center().y() - text->boundingRect().height() / 2);
  }
}

void CInfluenceView::DrawEdge(const QRectF& from, const QRectF& to, bool isDirect) {
  QPen pen(LineColour(palette()), 1, isDirect ? Qt::SolidLine : Qt::DashLine);
  const bool isSameColumn = qFuzzyCompare(1 + from.left(), 1 + to.left());
  const bool isForward = from.left() < to.left();
  // From side to side; within a column in a bow on the right.
  const qreal out = isForward || isSameColumn ? 1 : -1;
  const qreal in = isForward ? -1 : 1;
  const QPointF start(out > 0 ? from.right() : from.left(), from.center().y());
  const QPointF end(in > 0 ? to.right() : to.left(), to.center().y());
  const qreal bow =
      isSameColumn ? kColumnGap / 2 : std::max(kColumnGap / 2, std::abs(end.x() - start.x()) / 2);
  QPainterPath line(start);
  line.cubicTo(start + QPointF(out * bow, 0), end + QPointF(in * bow, 0), end + QPointF(in * kArrow, 0));
  scene()->addPath(line, pen)->setZValue(-1);
  QPolygonF head;
  head << end << end + QPointF(in * kArrow, -kArrow / 2) << end + QPointF(in * kArrow, kArrow / 2);
  scene()->addPolygon(head, QPen(Qt::NoPen), LineColour(palette()));
}

void CInfluenceView::DrawEdges() {
  for (const GraphEdge& edge : edges)
    DrawEdge(boxes[edge.source].place, boxes[edge.target].place, edge.isDirect);
}

void CInfluenceView::Redraw() {
  constexpr qreal kMargin = 20;
  scene()->clear();
  PlaceBoxes();
  DrawEdges();
  DrawBoxes();
  setSceneRect(scene()->itemsBoundingRect().adjusted(-kMargin, -kMargin, kMargin, kMargin));
}

void CInfluenceView::SetCurrent(std::size_t box) {
  current = box;
  ensureVisible(boxes[current].place);
  viewport()->setAccessibleDescription(ToScreen(boxes[current].node.symbol));
  viewport()->update();
}

std::size_t CInfluenceView::Neighbour(int key) const {
  const Box& from = boxes[current];
  std::size_t best = current;
  const auto distance = [this, &from](std::size_t place) {
    const QPointF way = boxes[place].place.center() - from.place.center();
    // Columns first: the next one that way, and in it what lies nearest in height.
    constexpr qreal kColumnWeight = 1e6;
    return std::abs(way.x()) * kColumnWeight + std::abs(way.y());
  };
  const auto liesThatWay = [&from, key](const Box& to) {
    const QPointF way = to.place.center() - from.place.center();
    const bool isSameColumn = to.node.level == from.node.level;
    switch (key) {
      case Qt::Key_Left:
        return !isSameColumn && way.x() < 0;
      case Qt::Key_Right:
        return !isSameColumn && way.x() > 0;
      case Qt::Key_Up:
        return isSameColumn && way.y() < 0;
      default:
        return isSameColumn && way.y() > 0;
    }
  };
  for (std::size_t place = 0; place < boxes.size(); ++place) {
    if (liesThatWay(boxes[place]) && (best == current || distance(place) < distance(best))) best = place;
  }
  return best;
}

void CInfluenceView::keyPressEvent(QKeyEvent* key) {
  if (boxes.empty() || key->modifiers().testAnyFlags(Qt::ControlModifier | Qt::AltModifier)) {
    QGraphicsView::keyPressEvent(key);
    return;
  }
  switch (key->key()) {
    case Qt::Key_Left:
    case Qt::Key_Right:
    case Qt::Key_Up:
    case Qt::Key_Down:
      SetCurrent(Neighbour(key->key()));
      break;
    case Qt::Key_Return:
    case Qt::Key_Enter:
      emit ElementChosen(boxes[current].node.uid);
      break;
    default:
      QGraphicsView::keyPressEvent(key);
  }
}

void CInfluenceView::mouseReleaseEvent(QMouseEvent* click) {
  QGraphicsView::mouseReleaseEvent(click);
  if (click->button() != Qt::LeftButton) return;
  const QPointF point = mapToScene(click->position().toPoint());
  const auto box = std::find_if(boxes.begin(), boxes.end(),
                                [&point](const Box& each) { return each.place.contains(point); });
  if (box == boxes.end()) return;
  SetCurrent(static_cast<std::size_t>(box - boxes.begin()));
  emit ElementChosen(box->node.uid);
}

void CInfluenceView::changeEvent(QEvent* change) {
  QGraphicsView::changeEvent(change);
  if (change->type() == QEvent::PaletteChange || change->type() == QEvent::FontChange) Redraw();
}

void CInfluenceView::focusInEvent(QFocusEvent* focus) {
  QGraphicsView::focusInEvent(focus);
  viewport()->update();
}

void CInfluenceView::focusOutEvent(QFocusEvent* focus) {
  QGraphicsView::focusOutEvent(focus);
  viewport()->update();
}

void CInfluenceView::drawForeground(QPainter* painter, const QRectF& /*seen*/) {
  if (!hasFocus() || current >= boxes.size()) return;
  constexpr qreal kOutside = 3;
  painter->setBrush(Qt::NoBrush);
  painter->setPen(QPen(palette().color(QPalette::Highlight), 2));
  painter->drawRect(boxes[current].place.adjusted(-kOutside, -kOutside, kOutside, kOutside));
}

QStringList CInfluenceView::DrawnText() const {
  QStringList texts;
  for (std::size_t place = 0; place < boxes.size(); ++place) {
    const GraphNode& node = boxes[place].node;
    texts.append((place == current ? "> " : "  ") + QString::number(node.level) + u' ' +
                 ToScreen(node.symbol));
  }
  return texts;
}

}  // namespace tessal
