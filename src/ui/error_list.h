// The list under the forms: every message of the registry and every undefined symbol.
#pragma once

#include <QTreeWidget>
#include <array>
#include <cstddef>
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

/// The messages by severity: errors are what keeps a template from being used, undefined symbols among them.
enum class MessageGroup : std::uint8_t { Errors, Warnings, Notices };
inline constexpr std::size_t kMessageGroups = 3;

/// Which rows are shown.
struct MessageFilter {
  std::array<bool, kMessageGroups> shows{true, true, true};
  QString words;  ///< each of them must be in the row, in capitals or small letters
};

class CErrorList final : public QTreeWidget {
  Q_OBJECT

 public:
  explicit CErrorList(QWidget* parent);

  /// Validates the template again and fills the list. The selected rows stay selected where they are still
  /// there.
  void RefreshErrorList(TemplateCore& core);

  /// The elements that have rows in the list.
  std::unordered_map<Uid, ElementMessages> MessagesOfElements() const;
  /// How many messages there are of a severity, shown or not.
  int CountOf(MessageGroup group) const;

  void Filter(const MessageFilter& rowFilter);
  /// Goes so many rows that are shown further, around the ends, and to the element of the row there.
  void GoToMessage(int step);

 signals:
  /// A row was clicked or entered; -1 for one that belongs to no element.
  void ElementChosen(Uid uid);
  /// The user asked to create the undefined symbol of a row.
  void CreateSymbolRequested(const std::string& symbol);
  /// The user asked what the message with a code means.
  void ExplanationRequested(const std::string& code);
  /// The list was filled.
  void Refreshed();

 protected:
  void keyPressEvent(QKeyEvent* key) override;
  void mouseMoveEvent(QMouseEvent* move) override;
  void contextMenuEvent(QContextMenuEvent* request) override;
  void resizeEvent(QResizeEvent* resize) override;

 private:
  struct Row {
    QString item;
    QString message;
    Uid uid;
    std::uint32_t level;
    std::string code;
    std::string undefinedSymbol;  ///< empty in the rows of the registry
  };
  /// A column and its direction; without a column the rows have the order of the messages.
  struct Sorting {
    int column = -1;
    Qt::SortOrder order = Qt::AscendingOrder;
  };

  static std::vector<Row> CollectRows(const TemplateCore& core);
  const Row& RowOf(const QTreeWidgetItem& item) const;
  /// Makes the items of the rows, in their order, and hides those that the filter leaves out.
  void ShowRows();
  std::vector<std::size_t> SortedPlaces() const;
  bool PassesFilter(const Row& row) const;
  void SortBy(const Sorting& wanted);
  /// A click on a column's title: up, down, then the order of the messages again.
  void CycleSorting(int column);
  void CopyRows() const;
  void FillMenu(QMenu& menu, const QTreeWidgetItem& item);
  void FitColumns();

  std::vector<Row> rows;
  Sorting sorting;
  MessageFilter filter;
};

}  // namespace tessal
