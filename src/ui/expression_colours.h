// How each word of an expression looks: by what it means in the template.
#pragma once

#include <QColor>
#include <string>

#include "platform/docview.h"

namespace tessal {

struct ExpressionToken;
class TemplateCore;

struct TokenStyle {
  bool coloured = false;  ///< false: the automatic colour
  QColor colour;
  bool bold = false;
  bool italic = false;
  bool link = false;  ///< names an element: it can be jumped to
};

/// What is wrong, and names that mean nothing; for a light ground.
inline constexpr QColor kFaultColour{255, 0, 0};
// What is no symbol, for a light ground.
inline constexpr QColor kCallableColour{0, 155, 0};
inline constexpr QColor kPropertyColour{0, 0, 255};
inline constexpr QColor kNumberColour{255, 0, 255};

/// The style of an identifier.
TokenStyle StyleOfName(const std::string& name, const TemplateCore& core);
TokenStyle StyleOfToken(const ExpressionToken& token, const TemplateCore& core);

/// A colour that is made for a light ground, as it is shown on a given one: unchanged on a light one,
/// lightened on a dark one; with strong colours, as `StrongColour` gives it.
QColor ReadableColour(const QColor& colour, const QColor& ground);

/// The contrast of two colours, from 1 to 21 (W3C, Web Content Accessibility Guidelines 2.1, "contrast
/// ratio").
double ContrastRatio(const QColor& first, const QColor& second);

/// The contrast that strong colours have at least (the same guidelines, level AA).
inline constexpr double kStrongContrast = 4.5;

/// The colour itself where it has that contrast with the ground; otherwise darkened or lightened, with its
/// hue kept, until it has.
QColor StrongColour(const QColor& colour, const QColor& ground);

/// Whether expressions are shown in strong colours: the user's choice, kept in the settings. A change reaches
/// all fields at once.
bool UsesStrongColours();
void UseStrongColours(bool strong);
/// The switch in the menu of views.
ViewCommand StrongColoursCommand();

}  // namespace tessal
