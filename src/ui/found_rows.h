// The rows of what was found: one for each match, and for a replacement one for each text that it changes,
// with a box to leave it out. Their texts are made when they are painted.
#pragma once

#include <QAbstractTableModel>
#include <QString>
#include <utility>
#include <vector>

#include "core/find.h"
#include "core/replace.h"

namespace tessal {

/// A text as one row shows it, cut where it is long, with the places that are marked.
struct MarkedText {
  QString text;
  std::vector<std::pair<int, int>> marks;  ///< start and length, in characters of the text
};

class CFoundRows final : public QAbstractTableModel {
  Q_OBJECT

 public:
  enum Column : std::uint8_t { Element, Field, Text, After, kColumns };

  using QAbstractTableModel::QAbstractTableModel;

  void ShowFound(std::vector<FoundText> texts);
  void ShowReplacements(std::vector<Replacement> changes);
  /// Shows the refused ones alone, with the reason in the place of the new text.
  void ShowRefused(const std::vector<RefusedReplacement>& refused);

  bool IsPreview() const { return isPreview; }
  const std::vector<Replacement>& Replacements() const { return replacements; }
  /// What a row is about.
  const FoundText& FoundAt(int row) const;
  const TextMatch& MatchAt(int row) const;
  MarkedText Marked(const QModelIndex& cell) const;

  int rowCount(const QModelIndex& parent = {}) const override;
  int columnCount(const QModelIndex& parent = {}) const override;
  QVariant data(const QModelIndex& cell, int role) const override;
  bool setData(const QModelIndex& cell, const QVariant& value, int role) override;
  Qt::ItemFlags flags(const QModelIndex& cell) const override;
  QVariant headerData(int section, Qt::Orientation orientation, int role) const override;

 signals:
  /// A box was ticked, or its tick was taken away.
  void ChoiceChanged();

 private:
  struct Row {
    std::size_t text;
    std::size_t match;
  };

  bool IsFree(int row) const;
  QString AfterText(int row) const;
  QVariant CheckState(const QModelIndex& cell) const;

  bool isPreview = false;
  std::vector<FoundText> found;
  std::vector<Replacement> replacements;
  std::vector<QString> reasons;  ///< of refused replacements; none in a preview
  std::vector<Row> rows;
};

}  // namespace tessal
