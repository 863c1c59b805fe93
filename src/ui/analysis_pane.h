// The pane of the analyses: a page for each, of which one is seen. What is seen follows the template after a
// pause, so that nobody waits for an analysis while walking or typing.
#pragma once

#include <QFrame>
#include <functional>

#include "platform/uid.h"

class QTabWidget;
class QTimer;

namespace tessal {

class CAnalysisPage;
class CFindingsPage;
class CInfluencePage;
class CMatrixPage;
class CPoolsPage;
class CTessalDoc;

class CAnalysisPane final : public QFrame {
  Q_OBJECT

 public:
  /// Asks for the element that is selected; none where the node is no element.
  CAnalysisPane(CTessalDoc& analysedDocument, std::function<Uid()> selectedElement, QWidget* parent);

  CFindingsPage& Findings() const { return *findings; }
  CMatrixPage& Matrix() const { return *matrix; }
  CPoolsPage& Pools() const { return *pools; }
  CInfluencePage& Influences() const { return *influences; }

  /// Shows the pane with a page in front, analyses, and gives the page the focus.
  void Open(CAnalysisPage& page);
  /// The template or the selection may be another: the page in front follows, where it is seen.
  void NoteChange();
  /// The same at once, where a change was noted.
  void CatchUp();
  void CloseUp();

 signals:
  /// The way leads to an element.
  void ElementChosen(Uid uid);
  /// The pane is about to be seen.
  void Opening();
  void Closed();

 protected:
  void keyPressEvent(QKeyEvent* key) override;

 private:
  void AddPage(CAnalysisPage& page, const QString& title);
  void RefreshPage();

  QTabWidget* pages;
  QTimer* pause;
  CFindingsPage* findings;
  CMatrixPage* matrix;
  CPoolsPage* pools;
  CInfluencePage* influences;
};

}  // namespace tessal
