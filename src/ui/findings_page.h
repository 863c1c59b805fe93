// The page that lists what all analyses find. A row leads to its place; nothing of it is in the list of
// messages.
#pragma once

#include <string>
#include <vector>

#include "analysis/analysis_finding.h"
#include "ui/analysis_page.h"

class QAction;
class QLabel;
class QPushButton;

namespace tessal {

class CRowTable;
class CTessalDoc;

class CFindingsPage final : public CAnalysisPage {
  Q_OBJECT

 public:
  CFindingsPage(const CTessalDoc& analysedDocument, QWidget* parent);

  void Refresh() override;
  QWidget& FirstStop() const override;

 signals:
  /// The user asked for an analysis: what is being entered is to be part of it.
  void AnalysisRequested();
  void FindingChosen(const AnalysisFinding& finding);
  /// The user asked what a rule with a code means.
  void ExplanationRequested(const std::string& code);

 private:
  void Show(std::vector<AnalysisFinding> found);
  void Explain();
  void UpdateCommands();

  const CTessalDoc& document;
  QPushButton* explain;
  QAction* explainRow;
  QLabel* state;
  CRowTable* table;
  std::vector<AnalysisFinding> findings;
};

}  // namespace tessal
