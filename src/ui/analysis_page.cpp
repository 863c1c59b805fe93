#include "ui/analysis_page.h"

#include <QComboBox>
#include <QHBoxLayout>
#include <QLabel>

#include "ui/child.h"
#include "ui/focus_watch.h"

namespace tessal {

CAnalysisPage::CAnalysisPage(QWidget* parent) : QWidget(parent) {}

QComboBox* CAnalysisPage::AddChoice(QHBoxLayout& row, const QString& label) {
  auto* choice = MakeChild<QComboBox>(this);
  choice->setAccessibleName(label);
  choice->setSizeAdjustPolicy(QComboBox::AdjustToContents);
  // A reader takes what is chosen for the name of a choice.
  choice->setToolTip(label);
  choice->setFocusPolicy(Qt::StrongFocus);
  IgnoreWheelWithoutFocus(*choice);
  auto* name = MakeChild<QLabel>(label + u':', this);
  name->setBuddy(choice);
  row.addWidget(name);
  row.addWidget(choice);
  return choice;
}

}  // namespace tessal
