// The arguments of a call, shown over the line while the caret is between its parentheses.
#pragma once

#include <QLabel>

#include "ui/expression_field.h"

namespace tessal {

class CTessalDoc;

class CCallTip final : public QLabel {
  Q_OBJECT

 public:
  /// Belongs to the field.
  CCallTip(CAutoRichEditCtrl& shownField, const CTessalDoc& shownDocument);

 protected:
  bool eventFilter(QObject* watched, QEvent* happened) override;

 private:
  void FollowCaret();
  void Place();

  CAutoRichEditCtrl& field;
  const CTessalDoc& document;
  int dismissed = -1;  ///< where the name begins of the call whose tip the user has closed
};

}  // namespace tessal
