// The colours of an expression while it is edited: looks that lie over the text and are no part of it, so
// that neither what is typed nor what is taken back carries them along. The owner has each new text scanned
// before the toolkit formats the lines that have changed.
#pragma once

#include <QSyntaxHighlighter>
#include <string>
#include <vector>

namespace tessal {

class TemplateCore;

class CExpressionHighlighter final : public QSyntaxHighlighter {
  Q_OBJECT

 public:
  CExpressionHighlighter(const TemplateCore& templateCore, QObject* owner);

  /// Scans the document's text for its colours on a ground; a text that does not scan cleanly has none. True
  /// when lines before the change look different too.
  bool Scan(const QString& text, const QColor& ground);

  /// The name of the element whose link covers the character at a position; empty without one.
  std::string LinkAt(int position) const;

 protected:
  void highlightBlock(const QString& text) override;

 private:
  /// A token with looks of its own, between two positions of the document.
  struct Part {
    int begin = 0;
    int end = 0;
    QTextCharFormat looks;
    std::string link;  ///< the name of an element, if it is one
  };
  using Parts = std::vector<Part>;

  /// The first part that ends after a position.
  Parts::const_iterator FirstAfter(int position) const;

  const TemplateCore& core;
  Parts parts;
  bool isClean = true;
  int revision = 0;  ///< of the parts
};

}  // namespace tessal
