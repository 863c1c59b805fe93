// What the expression of an element says about its unit, beside the field of the unit.
#pragma once

#include <QWidget>

class QLabel;

namespace tessal {

class CEL_Element;
class CLabel;
class TemplateCore;

class CUnitNote final : public QWidget {
  Q_OBJECT

 public:
  explicit CUnitNote(QWidget* parent);

  /// Shows the unit of the element's expression, with an icon and another word where the element declares
  /// another; nothing where it is unknown.
  void Show(const TemplateCore& core, const CEL_Element& element);
  QString Text() const;

 private:
  QLabel* icon;
  CLabel* text;
};

}  // namespace tessal
