// A label of plain text, whose font is described field by field as the title over the right pane needs it. A
// line that is longer than the label ends in dots, with the whole in a tip.
#pragma once

#include <QLabel>

namespace tessal {

class CLabel final : public QLabel {
  Q_OBJECT

 public:
  explicit CLabel(QWidget* parent) : QLabel(parent) { setTextFormat(Qt::PlainText); }

  /// A height that depended on the width would keep a form from shrinking to what its fields need.
  bool hasHeightForWidth() const override { return false; }

  /// The weight on the scale from 1 to 1000 (400 normal, 700 bold), and the height in pixels.
  void SetFontWeight(int weight);
  void SetFontHeight(int pixels);

 protected:
  bool event(QEvent* happened) override;
  void paintEvent(QPaintEvent* paint) override;

 private:
  bool IsTooLong() const;
};

}  // namespace tessal
