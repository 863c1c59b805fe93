// The list under the forms: every message of the registry and every undefined symbol.
#pragma once

#include <QTreeWidget>
#include <vector>

#include "platform/uid.h"

namespace tessal {

class TemplateCore;

class CErrorList final : public QTreeWidget {
  Q_OBJECT

 public:
  explicit CErrorList(QWidget* parent);

  /// Validates the template again and fills the list. The selected row stays selected where it is still
  /// there.
  void RefreshErrorList(TemplateCore& core);

 signals:
  /// A row was clicked or entered; -1 for one that belongs to no element.
  void ElementChosen(Uid uid);

 private:
  struct Row {
    QString item;
    QString message;
    Uid uid;
  };

  static std::vector<Row> CollectRows(const TemplateCore& core);
};

}  // namespace tessal
