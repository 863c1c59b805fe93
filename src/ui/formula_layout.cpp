#include "ui/formula_layout.h"

#include <QFontMetricsF>
#include <QPainter>
#include <QPainterPath>
#include <algorithm>
#include <array>

#include "expr/expression_shape.h"
#include "platform/ascii.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

constexpr int kDeepest = 60;
constexpr std::size_t kMostBoxes = 4'000;
constexpr qreal kLineWidth = 1.0;

struct Relation {
  std::string_view text;
  char16_t sign;
};

constexpr std::array<Relation, 6> kRelations = {{
    {"==", u'='},
    {"!=", u'\u2260'},
    {">", u'>'},
    {"<", u'<'},
    {">=", u'\u2265'},
    {"<=", u'\u2264'},
}};

}  // namespace

/// One layout under way. `level` counts how small the text is: exponents are one level smaller than their
/// base.
class FormulaBuilder final {
 public:
  explicit FormulaBuilder(const FormulaStyle& formulaStyle) : style(formulaStyle) {}

  bool IsTooLarge() const { return isTooLarge; }
  std::vector<FormulaLayout::Box> Take() { return std::move(boxes); }

  void Whole(const ExpressionNode& tree, const FormulaLeftSide& left) {
    BoxNumber whole = Build(tree, Bond::None, 0).box;
    if (!left.symbol.empty()) {
      const BoxNumber symbol = Text(ToScreen(left.symbol), style.colourOf(left.symbol), 0);
      const BoxNumber side =
          left.isDerivative ? Fraction(Row({Sign(u"d", 0), symbol}), Sign(u"dt", 0), 0) : symbol;
      whole = Row({side, Sign(u" = ", 0), whole});
    }
    // The whole is the last box.
    if (whole + 1 != boxes.size()) Row({whole});
  }

 private:
  using Shape = FormulaLayout::Shape;
  using Box = FormulaLayout::Box;
  using BoxNumber = FormulaLayout::BoxNumber;

  /// A box, and how tightly what is in it holds together.
  struct Built {
    BoxNumber box;
    Bond bond;
  };

  // Boxes.

  BoxNumber Add(Box box) {
    if (boxes.size() >= kMostBoxes) {
      isTooLarge = true;
      if (!boxes.empty()) return boxes.size() - 1;
    }
    boxes.push_back(std::move(box));
    return boxes.size() - 1;
  }

  QFont FontAt(int level) const {
    constexpr std::array<qreal, 3> kScales = {1.0, 0.75, 0.6};
    QFont font = style.font;
    const qreal scale = kScales.at(static_cast<std::size_t>(std::min(level, 2)));
    if (font.pixelSize() > 0) {
      font.setPixelSize(std::max(1, qRound(font.pixelSize() * scale)));
    } else {
      font.setPointSizeF(font.pointSizeF() * scale);
    }
    return font;
  }

  BoxNumber Text(const QString& text, const QColor& colour, int level, bool isBold = false) {
    Box box;
    box.shape = Shape::Text;
    box.text = text;
    box.font = FontAt(level);
    box.font.setBold(isBold);
    box.colour = colour;
    const QFontMetricsF metrics(box.font);
    box.width = metrics.horizontalAdvance(text);
    box.ascent = metrics.ascent();
    box.descent = metrics.descent();
    return Add(std::move(box));
  }

  BoxNumber Sign(QStringView text, int level) { return Text(text.toString(), style.ink, level); }

  /// Boxes side by side on one base line.
  BoxNumber Row(const std::vector<BoxNumber>& parts) {
    Box row;
    for (const BoxNumber part : parts) {
      row.parts.emplace_back(part, QPointF(row.width, 0));
      row.width += boxes[part].width;
      row.ascent = std::max(row.ascent, boxes[part].ascent);
      row.descent = std::max(row.descent, boxes[part].descent);
    }
    return Add(std::move(row));
  }

  /// How far the middle of signs such as a minus lies over the base line.
  qreal AxisAt(int level) const { return QFontMetricsF(FontAt(level)).strikeOutPos(); }

  BoxNumber Fraction(BoxNumber upper, BoxNumber lower, int level) {
    constexpr qreal kOverhang = 3;
    constexpr qreal kGap = 2;
    const qreal axis = AxisAt(level);
    Box fraction;
    fraction.width = std::max(boxes[upper].width, boxes[lower].width) + 2 * kOverhang;
    Box rule;
    rule.shape = Shape::Rule;
    rule.width = fraction.width;
    rule.colour = style.ink;
    const BoxNumber line = Add(std::move(rule));
    const auto middle = [&fraction, this](BoxNumber part) {
      return (fraction.width - boxes[part].width) / 2;
    };
    const qreal up = axis + kGap + boxes[upper].descent;
    const qreal down = kGap - axis + boxes[lower].ascent;
    fraction.parts = {{upper, QPointF(middle(upper), -up)},
                      {line, QPointF(0, -axis)},
                      {lower, QPointF(middle(lower), down)}};
    fraction.ascent = up + boxes[upper].ascent;
    fraction.descent = down + boxes[lower].descent;
    return Add(std::move(fraction));
  }

  BoxNumber Fence(Shape shape, const Box& inner, int level) {
    Box fence;
    fence.shape = shape;
    fence.colour = style.ink;
    const qreal thin = QFontMetricsF(FontAt(level)).horizontalAdvance(u'(');
    fence.width = shape == Shape::LeftBrace || shape == Shape::RightBrace ? thin * 1.4 : thin;
    fence.ascent = inner.ascent;
    fence.descent = inner.descent;
    return Add(std::move(fence));
  }

  BoxNumber Fenced(BoxNumber inner, Shape left, Shape right, int level) {
    const BoxNumber before = Fence(left, boxes[inner], level);
    const BoxNumber after = Fence(right, boxes[inner], level);
    return Row({before, inner, after});
  }

  BoxNumber Bracketed(BoxNumber inner, int level) {
    return Fenced(inner, Shape::LeftBracket, Shape::RightBracket, level);
  }

  BoxNumber Raised(BoxNumber base, BoxNumber exponent) {
    constexpr qreal kRise = 0.5;
    const qreal up =
        std::max(boxes[base].ascent * kRise, boxes[base].ascent - boxes[exponent].ascent * kRise);
    Box power;
    power.width = boxes[base].width + boxes[exponent].width;
    power.ascent = std::max(boxes[base].ascent, up + boxes[exponent].ascent);
    power.descent = std::max(boxes[base].descent, boxes[exponent].descent - up);
    power.parts = {{base, QPointF(0, 0)}, {exponent, QPointF(boxes[base].width, -up)}};
    return Add(std::move(power));
  }

  BoxNumber Root(BoxNumber inner, int level) {
    constexpr qreal kGap = 3;
    const qreal hook = QFontMetricsF(FontAt(level)).horizontalAdvance(u'n') * 1.2;
    Box root;
    root.shape = Shape::Root;
    root.colour = style.ink;
    root.width = boxes[inner].width + hook + kGap;
    root.ascent = boxes[inner].ascent + kGap;
    root.descent = boxes[inner].descent;
    root.parts = {{inner, QPointF(hook, 0)}};
    return Add(std::move(root));
  }

  // Nodes.

  /// The box of a node, in brackets where its place asks for a tighter bond than it has.
  Built Build(const ExpressionNode& node, Bond wanted, int level) {
    if (isTooLarge || ++depth > kDeepest) {
      isTooLarge = true;
      return {boxes.empty() ? Add({}) : boxes.size() - 1, Bond::Atom};
    }
    Built built = Bare(node, level);
    --depth;
    if (built.bond >= wanted) return built;
    return {Bracketed(built.box, level), Bond::Atom};
  }

  BoxNumber BoxOf(const ExpressionNode& node, Bond wanted, int level) {
    return Build(node, wanted, level).box;
  }

  Built Bare(const ExpressionNode& node, int level) {
    switch (node.Kind()) {
      case NodeKind::Identifier:
        return {Name(node.Text(), level), Bond::Atom};
      case NodeKind::Number:
        return Number(node.Text(), level);
      case NodeKind::Property:
        return {Fenced(Text(ToScreen(node.Text()), style.property, level), Shape::LeftSquare,
                       Shape::RightSquare, level),
                Bond::Atom};
      case NodeKind::Call:
        return Call(node, level);
      case NodeKind::Arithmetic:
        return Arithmetic(node, level);
      case NodeKind::Comparison:
        return Condition(node, level);
      case NodeKind::Conditional:
        return {Cases(node, level), Bond::None};
      case NodeKind::Negate:
        return {Row({Sign(u"\u2212", level), BoxOf(*node.Child(1), Bond::Product, level)}), Bond::Negation};
      case NodeKind::Interaction:
        return {Interaction(node, level), Bond::Atom};
      case NodeKind::Target:
        return {List({node.Child(1), node.Child(2)}, level), Bond::Atom};
      case NodeKind::Modlist:
        return {List(FieldsOf(node), level), Bond::Atom};
      case NodeKind::Exceedance:
        return {Row({Callable(node.Text(), level), List({node.Child(1)}, level)}), Bond::Power};
      default:
        return IsDirectModification(node.Kind()) ? Direct(node, level) : Parts(node, level);
    }
  }

  BoxNumber Name(std::string_view name, int level) {
    return Text(ToScreen(name), style.colourOf(std::string(name)), level);
  }

  BoxNumber Callable(std::string_view name, int level) {
    return Text(ToScreen(UpperCase(name)), style.callable, level, true);
  }

  /// Shows what is in a node that has no form of its own.
  Built Parts(const ExpressionNode& node, int level) {
    std::vector<BoxNumber> parts;
    for (std::int32_t slot = 1; slot <= node.ChildCount(); ++slot)
      parts.push_back(BoxOf(*node.Child(slot), Bond::None, level));
    return {Row(parts), Bond::Atom};
  }

  /// Turns an exponent into a power of ten.
  Built Number(std::string_view number, int level) {
    const std::size_t mark = number.find_first_of("eE");
    if (mark == std::string_view::npos) return {Text(ToScreen(number), style.number, level), Bond::Atom};
    QString exponent = ToScreen(number.substr(mark + 1));
    exponent.remove(u'+').replace(u'-', u'\u2212');
    const BoxNumber ten = Text(QStringLiteral("10"), style.number, level);
    const BoxNumber power = Raised(ten, Text(exponent, style.number, level + 1));
    return {Row({Text(ToScreen(number.substr(0, mark)), style.number, level), Sign(u"\u00b7", level), power}),
            Bond::Product};
  }

  Built Arithmetic(const ExpressionNode& node, int level) {
    if (node.Text() == "/") {
      const BoxNumber upper = BoxOf(*node.Child(1), Bond::None, level);
      const BoxNumber lower = BoxOf(*node.Child(2), Bond::None, level);
      return {Fraction(upper, lower, level), Bond::Power};
    }
    const bool isSum = IsSum(node);
    // The right side of a sum or a product begins with no sign: two of them need brackets between them.
    const auto isSame = isSum ? IsSum : IsProduct;
    const Bond right = isSum ? Bond::Product : Bond::Power;
    std::vector<const ExpressionNode*> chain;
    const ExpressionNode* first = &node;
    for (; isSame(*first); first = first->Child(1)) chain.push_back(first);
    std::vector<BoxNumber> parts = {BoxOf(*first, isSum ? Bond::Sum : Bond::Negation, level)};
    for (auto link = chain.rbegin(); link != chain.rend() && !isTooLarge; ++link) {
      const bool isMinus = (*link)->Text() == "-";
      parts.push_back(Sign(!isSum    ? QStringView(u" \u00b7 ")
                           : isMinus ? QStringView(u" \u2212 ")
                                     : u" + ",
                           level));
      parts.push_back(
          BoxOf(*(*link)->Child(2), BeginsWithSign(*(*link)->Child(2)) ? Bond::Atom : right, level));
    }
    return {Row(parts), isSum ? Bond::Sum : Bond::Product};
  }

  Built Condition(const ExpressionNode& node, int level) {
    const std::optional<Logic> logic = LogicOf(node);
    if (!logic) {
      const auto sign = std::find_if(kRelations.begin(), kRelations.end(),
                                     [&node](const Relation& each) { return each.text == node.Text(); });
      const QString text = u' ' + QString(sign == kRelations.end() ? QChar(u'?') : QChar(sign->sign)) + u' ';
      const BoxNumber left = BoxOf(*node.Child(1), Bond::Sum, level);
      const BoxNumber middle = Sign(text, level);
      return {Row({left, middle, BoxOf(*node.Child(2), Bond::Sum, level)}), Bond::Comparison};
    }
    if (logic->which == Logic::Operator::Not)
      return {Row({Sign(u"\u00ac", level), BoxOf(logic->left, Bond::Atom, level)}), Bond::Comparison};
    return Joined(node, *logic, level);
  }

  /// A chain of AND or of OR is a chain to the left.
  Built Joined(const ExpressionNode& node, const Logic& last, int level) {
    const bool isAnd = last.which == Logic::Operator::And;
    std::vector<const ExpressionNode*> sides;
    const ExpressionNode* first = &node;
    for (auto logic = LogicOf(node); logic && logic->which == last.which;) {
      sides.push_back(&logic->right);
      first = &logic->left;
      if (first->Kind() != NodeKind::Comparison) break;
      auto next = LogicOf(*first);
      if (!next || next->which != last.which) break;
      logic.emplace(*next);
    }
    const Bond inner = isAnd ? Bond::Comparison : Bond::And;
    std::vector<BoxNumber> parts = {BoxOf(*first, inner, level)};
    for (auto side = sides.rbegin(); side != sides.rend() && !isTooLarge; ++side) {
      parts.push_back(Sign(isAnd ? u" \u2227 " : u" \u2228 ", level));
      parts.push_back(BoxOf(**side, inner, level));
    }
    return {Row(parts), isAnd ? Bond::And : Bond::Or};
  }

  /// A brace over a row for each value with its condition. What follows ELSE IF is another row.
  BoxNumber Cases(const ExpressionNode& node, int level) {
    struct Line {
      BoxNumber value;
      BoxNumber condition;
    };
    std::vector<Line> lines;
    const ExpressionNode* rest = &node;
    for (; IsIf(*rest) && !isTooLarge; rest = &BranchesOf(*rest).otherwise) {
      const Branches branches = BranchesOf(*rest);
      const BoxNumber value = BoxOf(branches.then, Bond::None, level);
      const BoxNumber word = Text(QStringLiteral("if "), style.keyword, level, true);
      lines.push_back({value, Row({word, BoxOf(branches.condition, Bond::None, level)})});
    }
    const BoxNumber value = BoxOf(*rest, Bond::None, level);
    lines.push_back({value, Text(QStringLiteral("otherwise"), style.keyword, level, true)});
    constexpr qreal kGap = 3;
    const qreal space = QFontMetricsF(FontAt(level)).horizontalAdvance(u'm');
    qreal height = -kGap;
    qreal valueWidth = 0;
    for (const Line& line : lines) {
      const auto [ascent, descent] = Extent(line.value, line.condition);
      height += ascent + descent + kGap;
      valueWidth = std::max(valueWidth, boxes[line.value].width);
    }
    Box grid;
    grid.ascent = height / 2 + AxisAt(level);
    grid.descent = height - grid.ascent;
    qreal reached = -grid.ascent;
    for (const Line& line : lines) {
      const auto [ascent, descent] = Extent(line.value, line.condition);
      const qreal base = reached + ascent;
      grid.parts.emplace_back(line.value, QPointF(0, base));
      grid.parts.emplace_back(line.condition, QPointF(valueWidth + space, base));
      grid.width = std::max(grid.width, valueWidth + space + boxes[line.condition].width);
      reached = base + descent + kGap;
    }
    const BoxNumber inner = Add(std::move(grid));
    const BoxNumber brace = Fence(Shape::LeftBrace, boxes[inner], level);
    return Row({brace, inner});
  }

  std::pair<qreal, qreal> Extent(BoxNumber left, BoxNumber right) const {
    return {std::max(boxes[left].ascent, boxes[right].ascent),
            std::max(boxes[left].descent, boxes[right].descent)};
  }

  Built Call(const ExpressionNode& node, int level) {
    const std::vector<const ExpressionNode*> arguments = ArgumentsOf(node);
    const std::string name = UpperCase(node.Text());
    if (arguments.empty() && name == "PI") return {Sign(u"\u03c0", level), Bond::Atom};
    if (arguments.size() == 2 && name == "POW") {
      const BoxNumber base = BoxOf(*arguments[0], Bond::Atom, level);
      return {Raised(base, BoxOf(*arguments[1], Bond::None, level + 1)), Bond::Power};
    }
    if (arguments.size() == 1) {
      if (const auto built = OfOne(name, *arguments[0], level)) return *built;
    }
    const BoxNumber called = Callable(node.Text(), level);
    return {Row({called, List(arguments, level)}), Bond::Power};
  }

  /// A function of one argument that has a sign of its own.
  std::optional<Built> OfOne(std::string_view name, const ExpressionNode& argument, int level) {
    struct Fences {
      std::string_view name;
      Shape left;
      Shape right;
    };
    constexpr std::array<Fences, 3> kFences = {{{"ABS", Shape::Bar, Shape::Bar},
                                                {"FLOOR", Shape::LeftFloor, Shape::RightFloor},
                                                {"CEIL", Shape::LeftCeiling, Shape::RightCeiling}}};
    if (name == "SQRT") return Built{Root(BoxOf(argument, Bond::None, level), level), Bond::Power};
    if (name == "SQR") {
      const BoxNumber base = BoxOf(argument, Bond::Atom, level);
      return Built{Raised(base, Text(QStringLiteral("2"), style.number, level + 1)), Bond::Power};
    }
    if (name == "EXP") {
      const BoxNumber base = Text(QStringLiteral("e"), style.callable, level, true);
      return Built{Raised(base, BoxOf(argument, Bond::None, level + 1)), Bond::Power};
    }
    const auto fences = std::find_if(kFences.begin(), kFences.end(),
                                     [name](const Fences& each) { return each.name == name; });
    if (fences == kFences.end()) return std::nullopt;
    return Built{Fenced(BoxOf(argument, Bond::None, level), fences->left, fences->right, level), Bond::Atom};
  }

  Built Direct(const ExpressionNode& node, int level) {
    const BoxNumber target = Name(node.Text(), level);
    const BoxNumber sign = Text(u' ' + ToScreen(DirectSign(node.Kind())) + u' ', style.callable, level, true);
    return {Row({target, sign, BoxOf(*node.Child(1), Bond::None, level)}), Bond::None};
  }

  BoxNumber Interaction(const ExpressionNode& node, int level) {
    const BoxNumber verb = Callable(node.Text(), level);
    std::vector<BoxNumber> parts = {BoxOf(*node.Child(1), Bond::None, level)};
    for (const ExpressionNode* list : ItemsOf(node.Child(2), NodeKind::Modlists)) {
      if (isTooLarge) break;
      parts.push_back(Sign(u", ", level));
      parts.push_back(BoxOf(*list, Bond::None, level));
    }
    return Row({verb, Fenced(Row(parts), Shape::LeftBrace, Shape::RightBrace, level)});
  }

  /// Values in brackets, separated by commas.
  BoxNumber List(const std::vector<const ExpressionNode*>& values, int level) {
    std::vector<BoxNumber> parts;
    for (const ExpressionNode* value : values) {
      if (isTooLarge) break;
      if (!parts.empty()) parts.push_back(Sign(u", ", level));
      parts.push_back(BoxOf(*value, Bond::None, level));
    }
    if (parts.empty()) parts.push_back(Sign(u"", level));
    return Bracketed(Row(parts), level);
  }

  const FormulaStyle& style;
  std::vector<Box> boxes;
  int depth = 0;
  bool isTooLarge = false;
};

std::optional<FormulaLayout> FormulaLayout::Of(const ExpressionNode& tree, const FormulaLeftSide& left,
                                               const FormulaStyle& style) {
  FormulaBuilder builder(style);
  builder.Whole(tree, left);
  if (builder.IsTooLarge()) return std::nullopt;
  FormulaLayout formula;
  formula.boxes = builder.Take();
  return formula;
}

QSizeF FormulaLayout::Size() const {
  return {boxes.back().width, boxes.back().ascent + boxes.back().descent};
}

void FormulaLayout::Paint(QPainter& painter, QPointF corner) const {
  painter.setRenderHint(QPainter::Antialiasing);
  std::vector<std::pair<BoxNumber, QPointF>> toPaint = {
      {boxes.size() - 1, corner + QPointF(0, boxes.back().ascent)}};
  while (!toPaint.empty()) {
    const auto [number, place] = toPaint.back();
    toPaint.pop_back();
    PaintBox(painter, boxes[number], place);
    for (const auto& [part, offset] : boxes[number].parts) toPaint.emplace_back(part, place + offset);
  }
}

/// The lines of brackets and bars, in the width and the height of their box: from the left 0 to the right 1,
/// from the top 0 to the bottom 1.
QPainterPath FormulaLayout::Strokes(Shape shape, const QRectF& place) {
  struct Polyline {
    Shape shape;
    std::size_t count;
    std::array<QPointF, 4> points;
  };
  static constexpr std::array<Polyline, 8> kPolylines = {{
      {Shape::Rule, 2, {{{0, 0.5}, {1, 0.5}}}},
      {Shape::LeftSquare, 4, {{{1, 0}, {0, 0}, {0, 1}, {1, 1}}}},
      {Shape::RightSquare, 4, {{{0, 0}, {1, 0}, {1, 1}, {0, 1}}}},
      {Shape::Bar, 2, {{{0.5, 0}, {0.5, 1}}}},
      {Shape::LeftFloor, 3, {{{0, 0}, {0, 1}, {1, 1}}}},
      {Shape::RightFloor, 3, {{{1, 0}, {1, 1}, {0, 1}}}},
      {Shape::LeftCeiling, 3, {{{1, 0}, {0, 0}, {0, 1}}}},
      {Shape::RightCeiling, 3, {{{0, 0}, {1, 0}, {1, 1}}}},
  }};
  QPainterPath path;
  const auto row = std::find_if(kPolylines.begin(), kPolylines.end(),
                                [shape](const Polyline& each) { return each.shape == shape; });
  if (row == kPolylines.end()) return path;
  for (std::size_t point = 0; point < row->count; ++point) {
    const QPointF at(place.left() + row->points.at(point).x() * place.width(),
                     place.top() + row->points.at(point).y() * place.height());
    if (point == 0) {
      path.moveTo(at);
    } else {
      path.lineTo(at);
    }
  }
  return path;
}

QPainterPath FormulaLayout::Brace(const QRectF& place, bool isLeft) {
  const qreal open = isLeft ? place.right() : place.left();
  const qreal tip = isLeft ? place.left() : place.right();
  const qreal spine = place.center().x();
  const qreal middle = place.center().y();
  const qreal bend = std::min(place.height() / 4, place.width());
  QPainterPath path(QPointF(open, place.top()));
  path.quadTo(spine, place.top(), spine, place.top() + bend);
  path.lineTo(spine, middle - bend);
  path.quadTo(spine, middle, tip, middle);
  path.quadTo(spine, middle, spine, middle + bend);
  path.lineTo(spine, place.bottom() - bend);
  path.quadTo(spine, place.bottom(), open, place.bottom());
  return path;
}

/// The hook of a root, and the line over what is under it.
QPainterPath FormulaLayout::RootSign(const QRectF& place, qreal hook) {
  const qreal middle = place.center().y();
  QPainterPath path(QPointF(place.left(), middle + hook / 4));
  path.lineTo(place.left() + hook / 4, middle);
  path.lineTo(place.left() + hook / 2, place.bottom());
  path.lineTo(place.left() + hook - 1, place.top() + 1);
  path.lineTo(place.right(), place.top() + 1);
  return path;
}

void FormulaLayout::PaintBox(QPainter& painter, const Box& box, QPointF place) {
  if (box.shape == Shape::Row) return;
  painter.setPen(QPen(box.colour, kLineWidth));
  if (box.shape == Shape::Text) {
    painter.setFont(box.font);
    painter.drawText(place, box.text);
    return;
  }
  constexpr qreal kInset = 1.5;
  const QRectF whole(place.x(), place.y() - box.ascent, box.width, box.ascent + box.descent);
  const QRectF inner = whole.adjusted(kInset, 0, -kInset, 0);
  painter.setBrush(Qt::NoBrush);
  switch (box.shape) {
    case Shape::LeftBracket:
    case Shape::RightBracket: {
      const bool isLeft = box.shape == Shape::LeftBracket;
      const qreal end = isLeft ? inner.right() : inner.left();
      QPainterPath path(QPointF(end, inner.top()));
      path.quadTo(isLeft ? whole.left() - kInset : whole.right() + kInset, inner.center().y(), end,
                  inner.bottom());
      painter.drawPath(path);
      return;
    }
    case Shape::LeftBrace:
    case Shape::RightBrace:
      painter.drawPath(Brace(inner, box.shape == Shape::LeftBrace));
      return;
    case Shape::Root:
      painter.drawPath(RootSign(whole, box.parts.front().second.x()));
      return;
    default:
      painter.drawPath(Strokes(box.shape, box.shape == Shape::Rule ? whole : inner));
  }
}

}  // namespace tessal
