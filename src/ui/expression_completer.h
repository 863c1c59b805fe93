// Completes what is typed into an expression: a list opens under the second letter of a word, or on
// Ctrl+Space, with what may follow there, and typing narrows it down.
#pragma once

#include <QAbstractTableModel>
#include <QObject>
#include <functional>
#include <string_view>
#include <vector>

#include "core/completion.h"
#include "ui/expression_field.h"

class QCompleter;
class QTreeView;

namespace tessal {

class CEL_Element;
class CTessalDoc;

/// The element whose expression a field shows; none while it shows none.
using ElementSource = std::function<const CEL_Element*()>;

/// The rows of the list: what is typed, and what it is. Holds texts of its own, so that it may outlive what
/// it was made from.
class CCompletionModel final : public QAbstractTableModel {
  Q_OBJECT

 public:
  struct Row {
    QString text;
    QString detail;
    QColor colour;
    CompletionGroup group = CompletionGroup::Symbol;
  };

  explicit CCompletionModel(QObject* owner) : QAbstractTableModel(owner) {}

  void Show(std::vector<Row> shown);
  const std::vector<Row>& Rows() const { return rows; }

  int rowCount(const QModelIndex& above) const override;
  int columnCount(const QModelIndex& above) const override;
  QVariant data(const QModelIndex& index, int role) const override;

 private:
  std::vector<Row> rows;
};

class CExpressionCompleter final : public QObject, public ExpressionKeys {
  Q_OBJECT

 public:
  /// Belongs to the field.
  CExpressionCompleter(CAutoRichEditCtrl& shownField, const CTessalDoc& shownDocument,
                       ElementSource shownElement);

  bool TakesKey(QKeyEvent& key) override;
  void FollowKey(const QKeyEvent& key) override;

  /// Puts a text in the place of what was typed of it, as a choice from the list does.
  void Complete(const CCompletionModel::Row& row);

 private:
  enum class Wish : std::uint8_t { Typed, Asked };

  /// Opens the list, narrows it down, or closes it, by what lies at the caret.
  void Offer(Wish wish);
  void Open();
  bool IsOpen() const;
  CCompletionModel::Row RowOf(const Completion& completion) const;

  CAutoRichEditCtrl& field;
  const CTessalDoc& document;
  ElementSource element;
  CCompletionModel* model;
  QCompleter* completer;
  QTreeView* list;
  int wordStart = 0;  ///< of what the list completes
};

}  // namespace tessal
