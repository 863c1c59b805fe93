#include "ui/formula_preview.h"

#include <QApplication>
#include <QClipboard>
#include <QContextMenuEvent>
#include <QImage>
#include <QMenu>
#include <QMimeData>
#include <QPainter>
#include <QScrollBar>
#include <QSettings>
#include <algorithm>
#include <memory>
#include <utility>

#include "docgen/latex.h"
#include "docgen/mathml.h"
#include "expr/parser.h"
#include "ui/expression_colours.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

constexpr int kMargin = 6;
constexpr qreal kSmallestScale = 0.75;
const QString kFormulasKey = QStringLiteral("formulas");

bool& FormulaChoice() {
  static bool shown = QSettings().value(kFormulasKey, true).toBool();
  return shown;
}

}  // namespace

CFormulaPreview::CFormulaPreview(const TemplateCore& templateCore, QWidget* parent)
    : QAbstractScrollArea(parent), core(templateCore) {
  setFocusPolicy(Qt::StrongFocus);
  setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Fixed);
  viewport()->setBackgroundRole(QPalette::Base);
}

void CFormulaPreview::Show(const std::string& expression, FormulaLeftSide side) {
  typed = expression;
  const ScannerRest rest;
  const auto parsed = ParseExpression(expression);
  const bool isOther = side.symbol != left.symbol || side.isDerivative != left.isDerivative;
  if (parsed->Tree() != nullptr) {
    shown = expression;
    left = std::move(side);
    LayOut();
  } else if (isOther) {
    // The formula before it is of another element.
    left = std::move(side);
    formula.reset();
    shown.clear();
    state = State::Empty;
  } else if (state == State::Current) {
    state = State::Former;
  }
  Describe();
  UpdateBars();
  viewport()->update();
  emit HeightChanged();
}

void CFormulaPreview::LayOut() {
  const ScannerRest rest;
  const auto parsed = ParseExpression(shown);
  if (parsed->Tree() == nullptr) return;
  formula = FormulaLayout::Of(*parsed->Tree(), left, StyleOn(palette()));
  state = formula ? State::Current : State::TooLarge;
}

void CFormulaPreview::Describe() {
  QString text = ToScreen(typed);
  if (state == State::Former) text = strings::kFormerFormula.arg(ToScreen(shown));
  if (state == State::TooLarge) text = strings::kFormulaTooLarge;
  setAccessibleDescription(text);
}

FormulaStyle CFormulaPreview::StyleOn(const QPalette& palette) const {
  const QColor ground = palette.color(QPalette::Base);
  const auto readable = [ground](const QColor& colour) { return ReadableColour(colour, ground); };
  FormulaStyle style;
  style.font = font();
  style.ink = palette.color(QPalette::Text);
  style.number = readable(kNumberColour);
  style.callable = readable(kCallableColour);
  style.keyword = palette.color(QPalette::Text);
  style.property = readable(kPropertyColour);
  style.colourOf = [this, readable](const std::string& symbol) {
    return readable(StyleOfName(symbol, core).colour);
  };
  return style;
}

qreal CFormulaPreview::Scale() const {
  if (!formula || formula->Size().width() <= 0) return 1;
  const qreal room = viewport()->width() - 2 * kMargin;
  return std::clamp(room / formula->Size().width(), kSmallestScale, 1.0);
}

int CFormulaPreview::WantedHeight() const {
  const int frame = 2 * frameWidth() + 2 * kMargin;
  const int line = fontMetrics().height();
  if (!formula) return state == State::TooLarge ? line + frame : 0;
  const QSizeF size = formula->Size() * Scale();
  const bool scrolls = size.width() > viewport()->width() - 2 * kMargin;
  return qCeil(size.height()) + frame + (scrolls ? horizontalScrollBar()->sizeHint().height() : 0);
}

int CFormulaPreview::LeastHeight() const {
  return std::min(WantedHeight(), fontMetrics().height() + 2 * frameWidth() + 2 * kMargin);
}

void CFormulaPreview::UpdateBars() {
  const QSizeF size = formula ? formula->Size() * Scale() : QSizeF();
  const auto set = [](QScrollBar& bar, qreal content, int room) {
    bar.setRange(0, std::max(0, qCeil(content) + 2 * kMargin - room));
    bar.setPageStep(room);
    bar.setSingleStep(20);
  };
  set(*horizontalScrollBar(), size.width(), viewport()->width());
  set(*verticalScrollBar(), size.height(), viewport()->height());
}

void CFormulaPreview::paintEvent(QPaintEvent* /*paint*/) {
  QPainter painter(viewport());
  if (state == State::TooLarge) {
    painter.setPen(palette().color(QPalette::PlaceholderText));
    painter.drawText(viewport()->rect(), Qt::AlignCenter, strings::kFormulaTooLarge);
    return;
  }
  if (!formula) return;
  constexpr qreal kGreyed = 0.35;
  if (state == State::Former) painter.setOpacity(kGreyed);
  painter.translate(kMargin - horizontalScrollBar()->value(), kMargin - verticalScrollBar()->value());
  painter.scale(Scale(), Scale());
  formula->Paint(painter, QPointF(0, 0));
}

void CFormulaPreview::resizeEvent(QResizeEvent* resize) {
  QAbstractScrollArea::resizeEvent(resize);
  UpdateBars();
  if (resize->size().width() != resize->oldSize().width()) emit HeightChanged();
}

void CFormulaPreview::changeEvent(QEvent* change) {
  QAbstractScrollArea::changeEvent(change);
  const QEvent::Type type = change->type();
  if (type != QEvent::PaletteChange && type != QEvent::FontChange) return;
  const State former = state;
  if (formula) LayOut();
  if (former == State::Former && state == State::Current) state = former;
  UpdateBars();
  viewport()->update();
}

void CFormulaPreview::keyPressEvent(QKeyEvent* key) {
  QScrollBar& bar = *horizontalScrollBar();
  switch (key->key()) {
    case Qt::Key_Home:
      bar.setValue(bar.minimum());
      return;
    case Qt::Key_End:
      bar.setValue(bar.maximum());
      return;
    default:
      QAbstractScrollArea::keyPressEvent(key);
  }
}

void CFormulaPreview::contextMenuEvent(QContextMenuEvent* request) {
  QMenu menu(this);
  const bool hasFormula = !shown.empty();
  menu.addAction(strings::kCopyMathML, this, &CFormulaPreview::CopyMathML)->setEnabled(hasFormula);
  menu.addAction(strings::kCopyLatex, this, &CFormulaPreview::CopyLatex)->setEnabled(hasFormula);
  menu.addAction(strings::kCopyPicture, this, &CFormulaPreview::CopyPicture)->setEnabled(formula.has_value());
  menu.addSeparator();
  menu.addAction(strings::kHideFormulas, [] { ShowFormulas(false); });
  const bool byKey = request->reason() == QContextMenuEvent::Keyboard;
  menu.exec(byKey ? mapToGlobal(rect().center()) : request->globalPos());
}

void CFormulaPreview::CopyMathML() const {
  const ScannerRest rest;
  const std::string markUp = ExpressionToMathML(shown, left.symbol, left.isDerivative);
  auto content = std::make_unique<QMimeData>();
  content->setText(ToScreen(markUp));
  content->setData(QStringLiteral("application/mathml+xml"), QByteArray::fromStdString(markUp));
  // The clipboard owns it.
  QApplication::clipboard()->setMimeData(content.release());
}

void CFormulaPreview::CopyLatex() const {
  const ScannerRest rest;
  QApplication::clipboard()->setText(ToScreen(ExpressionToLatex(shown, left.symbol, left.isDerivative)));
}

void CFormulaPreview::CopyPicture() const {
  const ScannerRest rest;
  const auto parsed = ParseExpression(shown);
  if (parsed->Tree() == nullptr) return;
  // For paper: dark on light whatever the screen is, and fine enough to print.
  QPalette paper(Qt::white);
  paper.setColor(QPalette::Base, Qt::white);
  paper.setColor(QPalette::Text, Qt::black);
  const auto printed = FormulaLayout::Of(*parsed->Tree(), left, StyleOn(paper));
  if (!printed) return;
  constexpr qreal kFineness = 3;
  const QSizeF size = printed->Size() + QSizeF(2 * kMargin, 2 * kMargin);
  QImage picture((size * kFineness).toSize(), QImage::Format_RGB32);
  if (picture.isNull()) return;
  picture.fill(Qt::white);
  QPainter painter(&picture);
  painter.scale(kFineness, kFineness);
  printed->Paint(painter, QPointF(kMargin, kMargin));
  painter.end();
  QApplication::clipboard()->setImage(picture);
}

bool ShowsFormulas() {
  return FormulaChoice();
}

void ShowFormulas(bool shown) {
  if (std::exchange(FormulaChoice(), shown) == shown) return;
  QSettings().setValue(kFormulasKey, shown);
  for (QWidget* widget : QApplication::allWidgets()) {
    if (auto* preview = qobject_cast<CFormulaPreview*>(widget)) emit preview->HeightChanged();
  }
}

ViewCommand FormulasCommand() {
  const bool shown = ShowsFormulas();
  return {"&View", "&Formulas under Expressions", [shown] { ShowFormulas(!shown); }, true, shown};
}

}  // namespace tessal
