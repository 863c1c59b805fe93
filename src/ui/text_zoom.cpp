#include "ui/text_zoom.h"

#include <QAction>
#include <QApplication>
#include <QFont>
#include <QFontInfo>
#include <QSettings>
#include <QWheelEvent>
#include <QWidget>
#include <algorithm>

#include "ui/child.h"
#include "ui/strings.h"

namespace tessal {

namespace {

constexpr int kUsual = 100;
constexpr int kStep = 10;
constexpr int kSmallest = 60;
constexpr int kLargest = 300;
/// What a wheel reports for one step.
constexpr int kNotch = 120;
const QString kKey = QStringLiteral("textPercent");

}  // namespace

CTextZoom::CTextZoom(QWidget& zoomedView)
    : QObject(&zoomedView),
      view(zoomedView),
      usualPoints(QFontInfo(view.font()).pointSizeF()),
      percent(std::clamp(QSettings().value(kKey, kUsual).toInt(), kSmallest, kLargest)) {
  const auto add = [this](const QString& text, const QKeySequence& key, auto change) {
    auto* action = MakeChild<QAction>(text, this);
    action->setShortcut(key);
    action->setShortcutContext(Qt::WidgetWithChildrenShortcut);
    connect(action, &QAction::triggered, this, [this, change] { SetPercent(change(percent)); });
    view.addAction(action);
    actions.push_back(action);
  };
  add(strings::kZoomIn, QKeySequence::ZoomIn, [](int present) { return present + kStep; });
  add(strings::kZoomOut, QKeySequence::ZoomOut, [](int present) { return present - kStep; });
  add(strings::kZoomUsual, QKeySequence(Qt::CTRL | Qt::Key_0), [](int /*present*/) { return kUsual; });
  if (percent != kUsual) Apply();
  // A field would take the wheel for itself.
  qApp->installEventFilter(this);
}

std::vector<ViewCommand> CTextZoom::Commands() const {
  std::vector<ViewCommand> commands;
  for (QAction* action : actions)
    commands.push_back({.menu = strings::kViewMenu, .text = {}, .action = action});
  return commands;
}

void CTextZoom::SetPercent(int wanted) {
  wanted = std::clamp(wanted, kSmallest, kLargest);
  if (wanted == percent) return;
  percent = wanted;
  QSettings().setValue(kKey, percent);
  Apply();
}

void CTextZoom::Apply() {
  QFont font = view.font();
  font.setPointSizeF(usualPoints * percent / kUsual);
  view.setFont(font);
}

bool CTextZoom::eventFilter(QObject* watched, QEvent* happened) {
  if (happened->type() != QEvent::Wheel) return false;
  const auto* turn = static_cast<QWheelEvent*>(happened);
  const auto* under = qobject_cast<const QWidget*>(watched);
  const bool isOurs = under != nullptr && (under == &view || view.isAncestorOf(under));
  if (!isOurs || turn->modifiers() != Qt::ControlModifier) return false;
  turned += turn->angleDelta().y();
  const int steps = turned / kNotch;
  turned -= steps * kNotch;
  if (steps != 0) SetPercent(percent + steps * kStep);
  return true;
}

}  // namespace tessal
