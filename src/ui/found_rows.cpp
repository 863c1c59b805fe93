#include "ui/found_rows.h"

#include <algorithm>

#include "platform/utf8_bytes.h"
#include "ui/icons.h"
#include "ui/item_data.h"
#include "ui/plain_tip.h"
#include "ui/strings.h"
#include "ui/text_bytes.h"

namespace tessal {

namespace {

/// Of a long text a row shows so much before its first mark, and so much in all; in bytes.
constexpr std::size_t kShownBefore = 40;
constexpr std::size_t kMostShown = 400;
constexpr QChar kDots = u'\u2026';

QString OnOneLine(QString text) {
  for (QChar& character : text) {
    if (character < u' ' || character == QChar::LineSeparator || character == QChar::ParagraphSeparator)
      character = u' ';
  }
  return text;
}

/// Whether a character of a UTF-8 text begins at a place.
bool BeginsCharacter(const std::string& text, std::size_t place) {
  return place >= text.size() || !ContinuesCharacter(text[place]);
}

/// The part of a text around the first of the marks, with those that lie in it.
MarkedText PartWithMarks(const std::string& text, const TextMatch* first, const TextMatch* last) {
  const std::size_t firstStart = first == last ? 0 : first->start;
  std::size_t start = firstStart > kShownBefore ? firstStart - kShownBefore : 0;
  while (!BeginsCharacter(text, start)) ++start;
  std::size_t end = std::min(text.size(), start + kMostShown);
  while (!BeginsCharacter(text, end)) ++end;
  MarkedText marked;
  if (start > 0) marked.text = kDots;
  std::size_t taken = start;
  const auto take = [&marked, &text, &taken](std::size_t upTo) {
    marked.text += OnOneLine(QString::fromStdString(text.substr(taken, upTo - taken)));
    taken = upTo;
  };
  for (; first != last && first->start < end; ++first) {
    take(first->start);
    const auto markStart = static_cast<int>(marked.text.size());
    take(std::min(end, first->start + first->length));
    marked.marks.emplace_back(markStart, static_cast<int>(marked.text.size()) - markStart);
  }
  take(end);
  if (end < text.size()) marked.text += kDots;
  return marked;
}

}  // namespace

void CFoundRows::ShowFound(std::vector<FoundText> texts) {
  beginResetModel();
  isPreview = false;
  found = std::move(texts);
  replacements.clear();
  reasons.clear();
  rows.clear();
  for (std::size_t text = 0; text < found.size(); ++text) {
    for (std::size_t match = 0; match < found[text].matches.size(); ++match) rows.push_back({text, match});
  }
  endResetModel();
}

void CFoundRows::ShowReplacements(std::vector<Replacement> changes) {
  beginResetModel();
  isPreview = true;
  found.clear();
  replacements = std::move(changes);
  reasons.clear();
  rows.clear();
  for (std::size_t text = 0; text < replacements.size(); ++text) rows.push_back({text, 0});
  endResetModel();
}

void CFoundRows::ShowRefused(const std::vector<RefusedReplacement>& refused) {
  std::vector<Replacement> left;
  std::vector<QString> why;
  for (const RefusedReplacement& each : refused) {
    left.push_back(replacements[each.place]);
    left.back().isChosen = false;
    why.push_back(QString::fromStdString(each.reason));
  }
  ShowReplacements(std::move(left));
  reasons = std::move(why);
}

const FoundText& CFoundRows::FoundAt(int row) const {
  const std::size_t text = rows[static_cast<std::size_t>(row)].text;
  return isPreview ? replacements[text].found : found[text];
}

const TextMatch& CFoundRows::MatchAt(int row) const {
  return FoundAt(row).matches[rows[static_cast<std::size_t>(row)].match];
}

bool CFoundRows::IsFree(int row) const {
  const Replacement& replacement = replacements[rows[static_cast<std::size_t>(row)].text];
  return reasons.empty() && replacement.obstacle == ReplaceObstacle::None;
}

QString CFoundRows::AfterText(int row) const {
  const std::size_t text = rows[static_cast<std::size_t>(row)].text;
  if (!reasons.empty()) return reasons[text];
  switch (replacements[text].obstacle) {
    case ReplaceObstacle::Symbol:
      return strings::kSymbolStays;
    case ReplaceObstacle::Locked:
      return strings::kLockedStays;
    default:
      return PartWithMarks(replacements[text].after, nullptr, nullptr).text;
  }
}

MarkedText CFoundRows::Marked(const QModelIndex& cell) const {
  if (cell.column() != Text) return {data(cell, Qt::DisplayRole).toString(), {}};
  const FoundText& text = FoundAt(cell.row());
  if (!isPreview) {
    const TextMatch* match = &MatchAt(cell.row());
    return PartWithMarks(text.text, match, match + 1);
  }
  return PartWithMarks(text.text, text.matches.data(), text.matches.data() + text.matches.size());
}

int CFoundRows::rowCount(const QModelIndex& parent) const {
  return parent.isValid() ? 0 : static_cast<int>(rows.size());
}

int CFoundRows::columnCount(const QModelIndex& parent) const {
  if (parent.isValid()) return 0;
  return isPreview ? kColumns : After;
}

QVariant CFoundRows::CheckState(const QModelIndex& cell) const {
  if (!isPreview || cell.column() != Element || !IsFree(cell.row())) return {};
  const Replacement& replacement = replacements[rows[static_cast<std::size_t>(cell.row())].text];
  return replacement.isChosen ? Qt::Checked : Qt::Unchecked;
}

QVariant CFoundRows::data(const QModelIndex& cell, int role) const {
  if (!cell.isValid()) return {};
  const FoundText& text = FoundAt(cell.row());
  if (role == Qt::DecorationRole && cell.column() == Element)
    return IconOfKind(text.kind == ElementKind::Root ? node_kind::kRoot : text.kind);
  if (role == Qt::CheckStateRole) return CheckState(cell);
  if (role == Qt::ToolTipRole) return PlainTip(data(cell, Qt::DisplayRole).toString());
  if (role != Qt::DisplayRole) return {};
  switch (cell.column()) {
    case Element:
      return OnOneLine(QString::fromStdString(text.owner));
    case Field:
      return ToScreen(text.place.field);
    case Text:
      return Marked(cell).text;
    default:
      return AfterText(cell.row());
  }
}

bool CFoundRows::setData(const QModelIndex& cell, const QVariant& value, int role) {
  if (role != Qt::CheckStateRole || !isPreview || cell.column() != Element || !IsFree(cell.row()))
    return false;
  replacements[rows[static_cast<std::size_t>(cell.row())].text].isChosen = value.toInt() == Qt::Checked;
  emit dataChanged(cell, cell, {Qt::CheckStateRole});
  emit ChoiceChanged();
  return true;
}

Qt::ItemFlags CFoundRows::flags(const QModelIndex& cell) const {
  Qt::ItemFlags flags = QAbstractTableModel::flags(cell);
  if (cell.isValid() && isPreview && cell.column() == Element && IsFree(cell.row()))
    flags |= Qt::ItemIsUserCheckable;
  return flags;
}

QVariant CFoundRows::headerData(int section, Qt::Orientation orientation, int role) const {
  if (orientation != Qt::Horizontal || role != Qt::DisplayRole) return {};
  const QString* const titles[kColumns] = {&strings::kElementColumn, &strings::kFieldColumn,
                                           &strings::kTextColumn, &strings::kAfterColumn};
  return section < kColumns ? *titles[section] : QString();
}

}  // namespace tessal
