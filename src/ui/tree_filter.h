// The line over the tree that hides what does not fit: the elements whose symbol, description and unit hold
// all the words that are typed stay, with the folders that they are in. The tree itself stays as it is.
#pragma once

#include <QPointer>
#include <QString>
#include <QWidget>
#include <cstddef>
#include <cstdint>
#include <unordered_map>
#include <utility>
#include <vector>

#include "platform/uid.h"

class QLabel;
class QLineEdit;
class QTreeWidgetItem;

namespace tessal {

class CElementTree;
class TemplateCore;

class CTreeFilter final : public QWidget {
  Q_OBJECT

 public:
  CTreeFilter(CElementTree& filteredTree, const TemplateCore& template_, QWidget* parent);

  /// Gives the line the focus, to which Escape gives it back.
  void Begin();
  bool IsOn() const;
  /// Selects the next (1) or the former (-1) of the matches, around the ends.
  void GoToMatch(int step);
  /// Looks again which elements fit: something of theirs has changed.
  void Refresh();

 protected:
  bool eventFilter(QObject* watched, QEvent* happened) override;

 private:
  /// A node by its id and, where several share one, its group.
  using NodeName = std::pair<Uid, std::int32_t>;

  void OnTyped();
  void TurnOff();
  void ScheduleRefresh();
  /// Hides and shows the nodes, and opens the folders of the matches that were none before.
  void Apply(std::vector<NodeName> former);
  struct Branch {
    bool isShown;
    bool holdsNewMatch;
  };
  Branch ApplyTo(QTreeWidgetItem& item, const std::vector<NodeName>& former);
  bool Fits(QTreeWidgetItem& item) const;
  /// Reads what the elements are found by, which is kept from letter to letter.
  void ReadTexts();
  void NoteExpanded(QTreeWidgetItem& item);
  void ShowAll(QTreeWidgetItem& item);
  void ShowCount();
  static NodeName NameOf(QTreeWidgetItem& item);

  CElementTree& tree;
  const TemplateCore& core;
  QLineEdit* line;
  QLabel* count;
  QPointer<QWidget> focusBefore;
  QStringList words;                             ///< in small letters; none while the filter is off
  std::unordered_map<Uid, QString> texts;        ///< of the elements, in small letters; none while it is off
  std::vector<NodeName> matches;                 ///< in the order of the tree
  std::unordered_map<Uid, bool> expandedBefore;  ///< the folders, as they were without a filter
  bool isScheduled = false;
};

}  // namespace tessal
