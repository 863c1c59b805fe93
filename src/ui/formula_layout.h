// An expression laid out as mathematics: boxes with a width and a height over and under a base line, set
// beside, over and into each other. Brackets are set where the tree's grouping needs them.
#pragma once

#include <QColor>
#include <QFont>
#include <QPointF>
#include <QSizeF>
#include <QString>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

class QPainter;
class QPainterPath;
class QRectF;

namespace tessal {

class ExpressionNode;

struct FormulaStyle {
  QFont font;
  QColor ink;
  QColor number;
  QColor callable;
  QColor keyword;
  QColor property;
  /// The colour of a symbol.
  std::function<QColor(const std::string& symbol)> colourOf;
};

/// What the formula is the right side of: a symbol, or its derivative by time; nothing for an empty symbol.
struct FormulaLeftSide {
  std::string symbol;
  bool isDerivative = false;
};

class FormulaLayout final {
 public:
  /// None for a tree that is too large to be read as a formula: deeper than 60 boxes in boxes, or of more
  /// than 4,000. Chains of sums, products, conditions and ELSE IF count as one level.
  static std::optional<FormulaLayout> Of(const ExpressionNode& tree, const FormulaLeftSide& left,
                                         const FormulaStyle& style);

  QSizeF Size() const;
  /// Paints with the upper left corner at a point.
  void Paint(QPainter& painter, QPointF corner) const;

 private:
  friend class FormulaBuilder;

  enum class Shape : std::uint8_t {
    Row,  ///< nothing of its own
    Text,
    Rule,  ///< a line along the middle
    LeftBracket,
    RightBracket,
    LeftBrace,
    RightBrace,
    LeftSquare,
    RightSquare,
    Bar,  ///< an upright line
    LeftFloor,
    RightFloor,
    LeftCeiling,
    RightCeiling,
    Root
  };

  using BoxNumber = std::size_t;

  struct Box {
    Shape shape = Shape::Row;
    qreal width = 0;
    qreal ascent = 0;   ///< over the base line
    qreal descent = 0;  ///< under it
    QString text = {};
    QFont font = {};
    QColor colour = {};
    std::vector<std::pair<BoxNumber, QPointF>> parts = {};  ///< from the left end of the base line
  };

  static QPainterPath Strokes(Shape shape, const QRectF& place);
  static QPainterPath Brace(const QRectF& place, bool isLeft);
  static QPainterPath RootSign(const QRectF& place, qreal hook);
  static void PaintBox(QPainter& painter, const Box& box, QPointF place);

  std::vector<Box> boxes;  ///< the last is the whole
};

}  // namespace tessal
