// A table whose texts are looked up when they are shown: a page over a large template holds no copy of it.
#pragma once

#include <QAbstractTableModel>
#include <QIcon>
#include <QStringList>
#include <cstdint>
#include <functional>
#include <string>
#include <utility>
#include <vector>

#include "platform/uid.h"

namespace tessal {

class CRowModel final : public QAbstractTableModel {
  Q_OBJECT

 public:
  struct Row {
    Uid uid = Uid::None;      ///< the element that the row shows, where it shows one
    std::int32_t key = 0;     ///< what its text is looked up by: a place or a number
    std::int32_t number = 0;  ///< what the first column shows
  };
  using TextOf = std::function<std::string(const Row& row, int column)>;
  /// Takes over what was entered in a cell.
  using StoreText = std::function<void(int row, int column, const QString& text)>;

  explicit CRowModel(QObject* parent) : QAbstractTableModel(parent) {}

  void Fill(QStringList columnTitles, std::vector<Row> shownRows, TextOf lookUp);
  /// The columns that can be edited in place.
  void AllowEditing(std::vector<int> columns, StoreText store);
  /// Rows can be dragged to another place among them, before the row of the number or to the end.
  void AllowMoving(std::function<void(int row)> moveTo) { moveRowsTo = std::move(moveTo); }
  /// The column whose cells carry an icon, and which; and the words for those who do not see it.
  void ShowIcons(int column, std::function<QIcon(const Row& row)> iconOf,
                 std::function<QString(const Row& row)> wordsOf = {});

  const std::vector<Row>& Rows() const { return rows; }
  std::string TextAt(int row, int column) const;
  void RemoveRowAt(int row);
  /// Exchanges two neighbouring rows, with their numbers.
  void ExchangeRows(int row, int other);
  void RefreshRow(int row);

  int rowCount(const QModelIndex& parent = {}) const override;
  int columnCount(const QModelIndex& parent = {}) const override;
  QVariant data(const QModelIndex& index, int role) const override;
  bool setData(const QModelIndex& index, const QVariant& value, int role) override;
  QVariant headerData(int section, Qt::Orientation orientation, int role) const override;
  Qt::ItemFlags flags(const QModelIndex& index) const override;
  Qt::DropActions supportedDropActions() const override { return Qt::MoveAction; }
  bool dropMimeData(const QMimeData* data, Qt::DropAction action, int row, int column,
                    const QModelIndex& parent) override;

 private:
  QStringList titles;
  std::vector<Row> rows;
  TextOf textOf;
  std::vector<int> editableColumns;
  StoreText storeText;
  std::function<void(int row)> moveRowsTo;
  int iconColumn = -1;
  std::function<QIcon(const Row&)> icon;
  std::function<QString(const Row&)> iconWords;
};

}  // namespace tessal
