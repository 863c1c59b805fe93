// The drawing of a dependency graph around one element: what influences it on the left, what it influences on
// the right, a column for each number of steps. Arrow keys walk among the elements, Return and a click go to
// one.
#pragma once

#include <QGraphicsView>
#include <cstddef>
#include <vector>

#include "analysis/dependency_graph.h"

namespace tessal {

class CInfluenceView final : public QGraphicsView {
  Q_OBJECT

 public:
  /// More would neither be seen nor drawn in time.
  static constexpr std::size_t kMostDrawn = 200;

  explicit CInfluenceView(QWidget* parent);

  /// Draws a graph, the elements nearest to the focus first; how many are left out.
  std::size_t Draw(const DependencyGraph& graph);
  /// The symbols that are drawn, column by column from the left, the present one with a mark.
  QStringList DrawnText() const;

 signals:
  void ElementChosen(Uid uid);

 protected:
  void keyPressEvent(QKeyEvent* key) override;
  void mouseReleaseEvent(QMouseEvent* click) override;
  void changeEvent(QEvent* change) override;
  void focusInEvent(QFocusEvent* focus) override;
  void focusOutEvent(QFocusEvent* focus) override;
  void drawForeground(QPainter* painter, const QRectF& seen) override;

 private:
  struct Box {
    GraphNode node;
    QRectF place;
  };

  /// Which nodes are drawn, by place among the nodes, in the order of their columns.
  static std::vector<std::size_t> Chosen(const DependencyGraph& graph);
  void PlaceBoxes();
  void DrawBoxes();
  void DrawEdges();
  void DrawEdge(const QRectF& from, const QRectF& to, bool isDirect);
  void Redraw();
  /// Makes a box the present one.
  void SetCurrent(std::size_t box);
  /// The box next to the present one in its column, or the nearest in the next column that has any.
  std::size_t Neighbour(int key) const;

  std::vector<Box> boxes;        ///< by columns, from the left and from the top
  std::vector<GraphEdge> edges;  ///< between boxes
  std::size_t current = 0;
};

}  // namespace tessal
