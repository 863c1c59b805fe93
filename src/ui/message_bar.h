// The bar over the list of messages: how many there are of each severity, and which of them are shown.
#pragma once

#include <QWidget>
#include <array>

#include "ui/error_list.h"

class QLineEdit;
class QToolButton;

namespace tessal {

class CMessageBar final : public QWidget {
  Q_OBJECT

 public:
  CMessageBar(CErrorList& errorList, QWidget* parent);

 private:
  void ShowCounts();
  void FilterRows();

  CErrorList& list;
  std::array<QToolButton*, kMessageGroups> groups{};
  QLineEdit* words;
};

}  // namespace tessal
