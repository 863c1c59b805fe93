// The analyses in the editor: the pane that shows them, its commands, and the ways from what they found to
// its place.
#pragma once

#include <QObject>
#include <functional>
#include <vector>

#include "analysis/analysis_finding.h"
#include "analysis/dependency_graph.h"
#include "platform/docview.h"

class QWidget;

namespace tessal {

class CAnalysisPane;
class CElementTree;
class CErrorList;
class CFindTools;
class CTessalDoc;

/// What the analyses are about, and the parts of a view that they lead through.
struct AnalysisSurroundings {
  QWidget& view;
  CTessalDoc& document;
  CElementTree& tree;
  CErrorList& messages;
  CFindTools& find;
  std::function<void()> commit;  ///< puts what is being entered into the template
};

class CAnalysisTools final : public QObject {
  Q_OBJECT

 public:
  /// The pane is for the view to lay out.
  explicit CAnalysisTools(AnalysisSurroundings surroundings);

  CAnalysisPane& Pane() const { return *pane; }
  /// The commands for the menus.
  const std::vector<ViewCommand>& Commands() const { return commands; }

  /// Whether something was typed in the pane that is not in the template yet.
  bool HasTyped() const;
  /// Puts it into the template.
  void CommitTyped();

 private:
  struct Command {
    QString text;
    QString key;
    std::function<void()> run;
  };

  std::vector<Command> CommandRows();
  Uid SelectedElement() const;
  void ShowInfluences(GraphDirection direction);
  void SelectById(Uid uid);
  void GoToFinding(const AnalysisFinding& finding);
  /// Marks the first use of a name in the expression of an element.
  void GoToUse(Uid user, const std::string& name);

  AnalysisSurroundings around;
  CAnalysisPane* pane;
  std::vector<ViewCommand> commands;
};

}  // namespace tessal
