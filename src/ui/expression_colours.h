// How each word of an expression looks: by what it means in the template.
#pragma once

#include <QColor>

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

TokenStyle StyleOfToken(const ExpressionToken& token, const TemplateCore& core);

/// A colour that is made for a light ground, as it is shown on a given one: unchanged on a light one,
/// lightened on a dark one.
QColor ReadableColour(const QColor& colour, const QColor& ground);

}  // namespace tessal
