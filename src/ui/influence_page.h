// The page of the influences: the elements around the selected one, drawn and as a list, which says the same
// to those who do not see the drawing.
#pragma once

#include <functional>
#include <string>
#include <vector>

#include "analysis/dependency_graph.h"
#include "ui/analysis_page.h"

class QCheckBox;
class QComboBox;
class QSpinBox;

namespace tessal {

class CInfluenceView;
class CLabel;
class CRowTable;
class CTessalDoc;

class CInfluencePage final : public CAnalysisPage {
  Q_OBJECT

 public:
  /// The page asks for the element that is selected; none where the node is no element.
  CInfluencePage(const CTessalDoc& analysedDocument, std::function<Uid()> selectedElement, QWidget* parent);

  void Refresh() override;
  QWidget& FirstStop() const override;

  void SetDirection(GraphDirection direction);

 private:
  GraphQuery Query() const;
  void FindMutual();
  void ShowList();
  void ShowState(std::size_t leftOut);
  std::string ListText(std::size_t place, int column) const;

  const CTessalDoc& document;
  std::function<Uid()> selected;
  QComboBox* direction = nullptr;
  QSpinBox* steps;
  QCheckBox* mainKinds;
  CLabel* state;
  CInfluenceView* drawing;
  CRowTable* list;
  DependencyGraph graph;
  /// By node: it influences the element in one step and is influenced by it in turn. Such a node has one
  /// place in the drawing, that of what influences.
  std::vector<bool> mutual;
};

}  // namespace tessal
