// Shows how a document differs from a file: what was added, removed and changed, field by field.
#pragma once

#include <QDialog>

namespace tessal {

struct DocumentComparison;

class ComparisonDialog final : public QDialog {
  Q_OBJECT

 public:
  /// `before` and `after` name the file and the document, as the heads of the columns of values.
  ComparisonDialog(const DocumentComparison& comparison, const QString& before, const QString& after,
                   QWidget* parent);
};

/// A sentence about how much differs.
QString SummaryOf(const DocumentComparison& comparison);

}  // namespace tessal
