// What the pages of the analyses share: each shows what one analysis says of the template as it is at the
// moment. Analyses cost more than a check, so a page is brought up to date only while it is seen.
#pragma once

#include <QWidget>

#include "platform/uid.h"

class QComboBox;
class QHBoxLayout;

namespace tessal {

class CAnalysisPage : public QWidget {
  Q_OBJECT

 public:
  explicit CAnalysisPage(QWidget* parent);

  /// Analyses the template again, and shows the outcome.
  virtual void Refresh() = 0;
  /// What has the focus when somebody opens the page.
  virtual QWidget& FirstStop() const = 0;

 signals:
  /// The way leads to an element.
  void ElementChosen(Uid uid);

 protected:
  /// A choice with its label, put at the end of a row.
  QComboBox* AddChoice(QHBoxLayout& row, const QString& label);
};

}  // namespace tessal
