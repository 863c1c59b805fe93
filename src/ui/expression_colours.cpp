#include "ui/expression_colours.h"

#include <QApplication>
#include <QSettings>
#include <QTextEdit>
#include <algorithm>
#include <array>
#include <cmath>
#include <string>
#include <utility>

#include "core/template_core.h"
#include "expr/function_catalogue.h"
#include "expr/scanner.h"
#include "expr/semantic_checks.h"
#include "expr/user_function_names.h"
#include "platform/ascii.h"
#include "ui/strings.h"

namespace tessal {

namespace {

struct KindColour {
  ElementKind kind;
  QRgb colour;
};

// Constants, inputs, intermediate values and rates have a colour each; everything else is blue.
constexpr std::array<KindColour, 7> kKindColours = {{
    {ElementKind::Constant, qRgb(230, 0, 230)},
    {ElementKind::SpecieConstant, qRgb(230, 0, 230)},
    {ElementKind::Forcing, qRgb(230, 115, 0)},
    {ElementKind::SpatialFunction, qRgb(230, 115, 0)},
    {ElementKind::Auxiliary, qRgb(0, 230, 0)},
    {ElementKind::ArithmeticExpression, qRgb(0, 230, 0)},
    {ElementKind::Process, qRgb(0, 115, 230)},
}};
constexpr QRgb kOtherElement = qRgb(0, 0, 255);
constexpr QRgb kOperator = qRgb(0, 0, 0);
constexpr QRgb kConditional = qRgb(64, 64, 64);

TokenStyle Style(const QColor& colour, bool bold, bool italic, bool link) {
  return {true, colour, bold, italic, link};
}

bool IsCallable(const std::string& name) {
  std::string upper = name;
  return IsFunctionName(upper) || IsUserFunctionName(name) || IsInteractionVerb(UpperCase(name));
}

const QString kStrongKey = QStringLiteral("strongColours");

/// The choice, read from the settings once: each coloured word asks for it.
bool& StrongChoice() {
  static bool strong = QSettings().value(kStrongKey, false).toBool();
  return strong;
}

/// W3C, Web Content Accessibility Guidelines 2.1, "relative luminance", for sRGB.
double RelativeLuminance(const QColor& colour) {
  const auto linear = [](double channel) {
    return channel <= 0.03928 ? channel / 12.92 : std::pow((channel + 0.055) / 1.055, 2.4);
  };
  return 0.2126 * linear(colour.redF()) + 0.7152 * linear(colour.greenF()) + 0.0722 * linear(colour.blueF());
}

}  // namespace

TokenStyle StyleOfName(const std::string& name, const TemplateCore& core) {
  std::int32_t id = 0;
  ElementKind elementKind = ElementKind::None;
  if (core.FindElementBySymbol(name, id, elementKind)) {
    const auto row =
        std::find_if(kKindColours.begin(), kKindColours.end(),
                     [elementKind](const KindColour& entry) { return entry.kind == elementKind; });
    return Style(row == kKindColours.end() ? kOtherElement : row->colour, true, false, true);
  }
  if (IsCallable(name)) return Style(kCallableColour, true, true, false);
  if (IsPropertyName(name)) return Style(kPropertyColour, true, false, false);
  return Style(kFaultColour, true, false, false);
}

TokenStyle StyleOfToken(const ExpressionToken& expressionToken, const TemplateCore& core) {
  const TokenCode code = expressionToken.code;
  if (code == TokenCode::Identifier) return StyleOfName(expressionToken.text, core);
  if (code >= TokenCode::IntNum && code <= TokenCode::ScientificNum)
    return Style(kNumberColour, true, true, false);
  const bool isOperator = code >= TokenCode::AddOpPlus && code <= TokenCode::MulOpDivide;
  const bool isBracket = code >= TokenCode::LeftBracket && code <= TokenCode::RightCurly;
  if (isOperator || isBracket) return Style(kOperator, true, false, false);
  if (code >= TokenCode::If && code <= TokenCode::Else) return Style(kConditional, true, true, false);
  return {};
}

QColor ReadableColour(const QColor& colour, const QColor& ground) {
  constexpr int kDarkGround = 128;
  constexpr int kLightEnough = 170;
  if (UsesStrongColours()) return StrongColour(colour, ground);
  if (ground.lightness() >= kDarkGround) return colour;
  return QColor::fromHsl(std::max(colour.hslHue(), 0), colour.hslSaturation(),
                         std::max(255 - colour.lightness(), kLightEnough));
}

double ContrastRatio(const QColor& first, const QColor& second) {
  constexpr double kFlare = 0.05;
  const auto [darker, lighter] = std::minmax({RelativeLuminance(first), RelativeLuminance(second)});
  return (lighter + kFlare) / (darker + kFlare);
}

QColor StrongColour(const QColor& colour, const QColor& ground) {
  // On any ground one of black and white has a contrast of 4.58 or more: the search ends.
  const bool darken = ContrastRatio(Qt::black, ground) > ContrastRatio(Qt::white, ground);
  const int end = darken ? 0 : 255;
  QColor strong = colour;
  for (int lightness = colour.lightness();
       ContrastRatio(strong, ground) < kStrongContrast && lightness != end;) {
    lightness += darken ? -1 : 1;
    strong = QColor::fromHsl(std::max(colour.hslHue(), 0), colour.hslSaturation(), lightness);
  }
  return strong;
}

ViewCommand StrongColoursCommand() {
  const bool strong = UsesStrongColours();
  return {strings::kViewMenu, "S&trong Colours", [strong] { UseStrongColours(!strong); }, true, strong};
}

bool UsesStrongColours() {
  return StrongChoice();
}

void UseStrongColours(bool strong) {
  if (std::exchange(StrongChoice(), strong) == strong) return;
  QSettings().setValue(kStrongKey, strong);
  // To a field it is as if the palette had changed.
  for (QWidget* widget : QApplication::allWidgets()) {
    QEvent change(QEvent::PaletteChange);
    if (qobject_cast<QTextEdit*>(widget) != nullptr) QApplication::sendEvent(widget, &change);
  }
}

}  // namespace tessal
