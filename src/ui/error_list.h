// The list under the forms: every message of the registry and every undefined symbol.
#pragma once

#include <QTreeWidget>
#include <cstdint>
#include <string>
#include <unordered_map>
#include <vector>

#include "platform/uid.h"

namespace tessal {

class TemplateCore;

/// What the list says of an element: how many rows, and the highest level among them.
struct ElementMessages {
  int count = 0;
  std::uint32_t level = 0;
};

class CErrorList final : public QTreeWidget {
  Q_OBJECT

 public:
  explicit CErrorList(QWidget* parent);

  /// Validates the template again and fills the list. The selected row stays selected where it is still
  /// there.
  void RefreshErrorList(TemplateCore& core);

  /// The elements that have rows in the list.
  std::unordered_map<Uid, ElementMessages> MessagesOfElements() const;

 signals:
  /// A row was clicked or entered; -1 for one that belongs to no element.
  void ElementChosen(Uid uid);
  /// The user asked to create the undefined symbol of a row.
  void CreateSymbolRequested(const std::string& symbol);
  /// The list was filled.
  void Refreshed();

 protected:
  void mouseMoveEvent(QMouseEvent* move) override;
  void contextMenuEvent(QContextMenuEvent* request) override;
  void resizeEvent(QResizeEvent* resize) override;

 private:
  struct Row {
    QString item;
    QString message;
    Uid uid;
    std::uint32_t level;
    std::string undefinedSymbol;  ///< empty in the rows of the registry
  };

  static std::vector<Row> CollectRows(const TemplateCore& core);
  void FitColumns();

  std::vector<Row> rows;
};

}  // namespace tessal
