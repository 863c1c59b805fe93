// The small window that leads to a symbol by a few of its letters.
#pragma once

#include <QDialog>

#include "platform/uid.h"

class QLineEdit;
class QTreeWidget;
class QTreeWidgetItem;

namespace tessal {

class TemplateCore;

class CGoToSymbol final : public QDialog {
  Q_OBJECT

 public:
  CGoToSymbol(const TemplateCore& template_, QWidget* parent);

 signals:
  void SymbolChosen(Uid uid);

 protected:
  bool eventFilter(QObject* watched, QEvent* happened) override;

 private:
  void ShowFitting();
  void Choose(const QTreeWidgetItem* row);

  const TemplateCore& core;
  QLineEdit* letters;
  QTreeWidget* list;
};

}  // namespace tessal
