#include "analysis/analysis_finding.h"

#include "elements/element.h"

namespace tessal {

AnalysisFinding FindingAbout(const CEL_Element& element, const Finding& finding) {
  return {.message = finding.message,
          .text = finding.text,
          .element = element.GetUid(),
          .symbol = element.FullSymbol(),
          .kind = element.Kind(),
          .line = element.SourceLine()};
}

}  // namespace tessal
