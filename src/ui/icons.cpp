#include "ui/icons.h"

#include <QFile>
#include <QGuiApplication>
#include <QIconEngine>
#include <QPainter>
#include <QPalette>
#include <QPixmapCache>
#include <QSvgRenderer>
#include <algorithm>
#include <array>
#include <iterator>
#include <map>
#include <memory>
#include <optional>
#include <utility>

#include "core/messages.h"
#include "ui/item_data.h"
#include "ui/text_bytes.h"

/// The drawings lie in a library that is linked in: they are entered by hand, from outside of any namespace.
static void EnterDrawings() {
  Q_INIT_RESOURCE(icons);
}

namespace tessal {

namespace {

/// Colours that are seen on a light and on a dark ground, and carry white.
constexpr QRgb kTeal = qRgb(0, 128, 128);
constexpr QRgb kMagenta = qRgb(186, 50, 160);
constexpr QRgb kOrange = qRgb(200, 100, 0);
constexpr QRgb kGreen = qRgb(46, 139, 60);
constexpr QRgb kBlue = qRgb(40, 110, 200);
constexpr QRgb kViolet = qRgb(120, 90, 200);
constexpr QRgb kBrown = qRgb(150, 95, 50);
constexpr QRgb kGrey = qRgb(120, 125, 130);
constexpr QRgb kRed = qRgb(205, 40, 40);

struct KindIcon {
  ElementKind kind;
  const char* drawing;
  QRgb colour;
};

using Kind = ElementKind;

constexpr KindIcon kKindIcons[] = {
    {node_kind::kRoot, "template", kBlue},
    {Kind::StateVariable, "square-s", kTeal},
    {Kind::Constant, "square-c", kMagenta},
    {Kind::Forcing, "square-f", kOrange},
    {Kind::Auxiliary, "square-a", kGreen},
    {Kind::Process, "square-p", kBlue},
    {Kind::DerivedOutput, "square-d", kViolet},
    {Kind::Specie, "particles", kTeal},
    {Kind::SpecieStateVariable, "round-s", kTeal},
    {Kind::SpecieConstant, "round-c", kMagenta},
    {Kind::SpecieForcing, "round-f", kOrange},
    {Kind::SpatialFunction, "search", kBrown},
    {Kind::ArithmeticExpression, "round-a", kGreen},
    {Kind::HorizontalVector, "horizontal", kBlue},
    {Kind::VerticalEquation, "vertical", kViolet},
    {Kind::Miscellaneous, "settings", kGrey},
    {Kind::ExternalFunction, "function", kViolet},
    {Kind::VisibilityGroup, "visibility", kGrey},
    {Kind::VisibilityGroups, "folder", kGrey},
    {node_kind::kPluginFunctions, "folder", kViolet},
    {Kind::StateVariableList, "folder", kTeal},
    {Kind::ConstantList, "folder", kMagenta},
    {Kind::ForcingList, "folder", kOrange},
    {Kind::AuxiliaryList, "folder", kGreen},
    {Kind::ProcessList, "folder", kBlue},
    {Kind::DerivedOutputList, "folder", kViolet},
    {Kind::SpecieStateVariableList, "folder", kTeal},
    {Kind::SpecieConstantList, "folder", kMagenta},
    {Kind::SpecieForcingList, "folder", kOrange},
    {Kind::SpatialFunctionList, "folder", kBrown},
    {Kind::ArithmeticExpressionList, "folder", kGreen},
    {Kind::HorizontalVectorList, "folder", kBlue},
    {Kind::VerticalEquationList, "folder", kViolet},
};

/// In the order of `IconCommand`; they have the colour of texts.
constexpr std::array<const char*, 15> kCommandDrawings = {
    "new",  "edit", "delete", "move-up", "move-down", "back",      "forward", "history",
    "undo", "redo", "cut",    "copy",    "paste",     "duplicate", "rename"};

struct LevelIcon {
  const char* drawing;
  QRgb colour;
};

/// In the order of the levels from 1.
constexpr std::array<LevelIcon, 4> kLevelIcons = {
    {{"notice", kBlue}, {"warning", kOrange}, {"critical", kRed}, {"fatal", kRed}}};

/// Draws when it is painted, so that a change of the palette needs no new icon.
class DrawingEngine final : public QIconEngine {
 public:
  /// Without a colour of its own a drawing has that of the palette's texts.
  DrawingEngine(QString drawingName, std::optional<QRgb> ownColour)
      : name(std::move(drawingName)), colour(ownColour) {}

  QIconEngine* clone() const override { return std::make_unique<DrawingEngine>(name, colour).release(); }

  void paint(QPainter* painter, const QRect& rect, QIcon::Mode mode, QIcon::State state) override {
    const qreal ratio = painter->device()->devicePixelRatioF();
    QPixmap drawn = pixmap(rect.size() * ratio, mode, state);
    drawn.setDevicePixelRatio(ratio);
    painter->drawPixmap(rect, drawn);
  }

  QPixmap pixmap(const QSize& size, QIcon::Mode mode, QIcon::State /*state*/) override {
    const QColor shown = ColourIn(mode);
    const QString key = QStringLiteral("tessal:%1:%2:%3:%4x%5")
                            .arg(name, shown.name())
                            .arg(static_cast<int>(mode))
                            .arg(size.width())
                            .arg(size.height());
    QPixmap drawn;
    if (QPixmapCache::find(key, &drawn)) return drawn;
    drawn = Draw(size, shown, mode);
    QPixmapCache::insert(key, drawn);
    return drawn;
  }

 private:
  QColor ColourIn(QIcon::Mode mode) const {
    if (colour) return {*colour};
    const auto group = mode == QIcon::Disabled ? QPalette::Disabled : QPalette::Active;
    return QGuiApplication::palette().color(group, QPalette::ButtonText);
  }

  QPixmap Draw(const QSize& size, const QColor& shown, QIcon::Mode mode) const {
    constexpr qreal kDisabledOpacity = 0.4;
    QPixmap drawn(size);
    drawn.fill(Qt::transparent);
    QFile file(QStringLiteral(":/icons/%1.svg").arg(name));
    if (!file.open(QIODevice::ReadOnly)) return drawn;
    QSvgRenderer drawing(file.readAll().replace("currentColor", shown.name().toLatin1()));
    QPainter painter(&drawn);
    if (mode == QIcon::Disabled && colour) painter.setOpacity(kDisabledOpacity);
    drawing.setAspectRatioMode(Qt::KeepAspectRatio);
    drawing.render(&painter);
    return drawn;
  }

  QString name;
  std::optional<QRgb> colour;
};

/// The icon of a drawing in a colour, made once.
QIcon IconOf(const char* drawing, std::optional<QRgb> colour) {
  static const bool entered = (EnterDrawings(), true);
  Q_UNUSED(entered)
  static std::map<std::pair<QString, std::optional<QRgb>>, QIcon> made;
  const QString name = QString::fromLatin1(drawing);
  QIcon& icon = made[{name, colour}];
  if (icon.isNull()) icon = QIcon(std::make_unique<DrawingEngine>(name, colour).release());
  return icon;
}

const LevelIcon* RowOfLevel(std::uint32_t level) {
  return level >= 1 && level <= kLevelIcons.size() ? &kLevelIcons[level - 1] : nullptr;
}

}  // namespace

QIcon IconOfKind(ElementKind kind) {
  const auto* const row = std::find_if(std::begin(kKindIcons), std::end(kKindIcons),
                                       [kind](const KindIcon& entry) { return entry.kind == kind; });
  return row == std::end(kKindIcons) ? QIcon() : IconOf(row->drawing, row->colour);
}

QIcon IconOfCommand(IconCommand command) {
  return IconOf(kCommandDrawings[static_cast<std::size_t>(command)], std::nullopt);
}

QIcon IconOfLevel(std::uint32_t level) {
  const LevelIcon* row = RowOfLevel(level);
  return row == nullptr ? QIcon() : IconOf(row->drawing, row->colour);
}

QString WordOfLevel(std::uint32_t level) {
  return ToScreen(LevelWord(level)).remove(u'-');
}

QColor ColourOfLevel(std::uint32_t level) {
  const LevelIcon* row = RowOfLevel(level);
  return row == nullptr ? QColor() : QColor(row->colour);
}

}  // namespace tessal
