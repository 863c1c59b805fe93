#include "ui/unit_note.h"

#include <QHBoxLayout>
#include <QStyle>

#include "analysis/unit_check.h"
#include "core/message_table.h"
#include "ui/child.h"
#include "ui/icons.h"
#include "ui/label.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

CUnitNote::CUnitNote(QWidget* parent)
    : QWidget(parent), icon(MakeChild<QLabel>(this)), text(MakeChild<CLabel>(this)) {
  auto* parts = MakeChild<QHBoxLayout>(this);
  parts->setContentsMargins(0, 0, 0, 0);
  parts->addWidget(icon);
  parts->addWidget(text, 1);
  // As wide as its text where there is room, and shorter in a narrow form.
  text->setMinimumWidth(1);
  hide();
}

void CUnitNote::Show(const TemplateCore& core, const CEL_Element& element) {
  const std::optional<UnitOfExpression> unit = InferredUnit(core, element);
  setVisible(unit.has_value());
  if (!unit) {
    text->clear();
    return;
  }
  const int size = style()->pixelMetric(QStyle::PM_SmallIconSize);
  icon->setVisible(unit->isOther);
  icon->setPixmap(IconOfLevel(static_cast<std::uint32_t>(ErrorLevel::Warning)).pixmap(size, size));
  text->setText(
      (unit->isOther ? strings::kUnitDiffers : strings::kUnitOfExpression).arg(ToScreen(unit->text)));
}

QString CUnitNote::Text() const {
  return text->text();
}

}  // namespace tessal
