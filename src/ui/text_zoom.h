// The size of all texts of a view: larger and smaller by the wheel with Ctrl, by keys, and back to the usual
// one. The choice is kept in the settings, for all views.
#pragma once

#include <QObject>
#include <vector>

#include "platform/docview.h"

class QAction;
class QWidget;

namespace tessal {

class CTextZoom final : public QObject {
  Q_OBJECT

 public:
  explicit CTextZoom(QWidget& zoomedView);

  std::vector<ViewCommand> Commands() const;
  /// The present size, in percent of the usual one.
  int Percent() const { return percent; }
  void SetPercent(int wanted);

 protected:
  bool eventFilter(QObject* watched, QEvent* happened) override;

 private:
  void Apply();

  QWidget& view;
  double usualPoints;
  int percent;
  int turned = 0;  ///< of the wheel, since the last step
  std::vector<QAction*> actions;
};

}  // namespace tessal
