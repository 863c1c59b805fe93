// Writing an item tree as key-file text.
#include <ostream>

#include "keyfile/item_tree.h"

namespace tessal {

namespace {

/// Appends items to a text, which goes to a stream in pieces, if there is one.
class ItemWriter final {
 public:
  ItemWriter(std::string& written, std::ostream* target) : text(written), stream(target) {}

  void Write(const CKvfBaseItem& item) {
    switch (item.ItemKind()) {
      case CKvfBaseItem::kComment:
        WriteComment(static_cast<const CKvfCommentItem&>(item));
        break;
      case CKvfBaseItem::kKeyword:
        WriteKeyword(static_cast<const CKvfKeyItem&>(item));
        break;
      case CKvfBaseItem::kSection:
        WriteSection(static_cast<const CKvfSectionItem&>(item));
        break;
      case CKvfBaseItem::kNone:
        break;
    }
    constexpr std::size_t kPiece = 65536;
    if (text.size() >= kPiece) Flush();
  }

  void Flush() {
    if (stream == nullptr) return;
    stream->write(text.data(), static_cast<std::streamsize>(text.size()));
    text.clear();
  }

 private:
  void WriteComment(const CKvfCommentItem& block) {
    const CommentLine* const first = block.FirstLine();
    for (const CommentLine* line = first; line != nullptr; line = line->next) {
      Indent(block);
      text.append("//").append(line->text) += '\n';
    }
    if (first == nullptr || first->next == nullptr) return;
    Indent(block);
    text += '\n';
  }

  void WriteKeyword(const CKvfKeyItem& keyword) {
    Indent(keyword);
    text.append(keyword.Name()) += " = ";
    std::string_view separator;
    for (const KvfValue& value : keyword.Values()) {
      text += separator;
      value.AppendTo(text);
      separator = ",";
    }
    EndLine(keyword.Comment());
  }

  void WriteSection(const CKvfSectionItem& section) {
    const bool isRoot = section.Parent() == nullptr;
    if (!isRoot) {
      Indent(section);
      text.append("[").append(section.Name()) += ']';
      EndLine(section.StartComment());
    }
    for (const CKvfBaseItem& child : section.Children()) Write(child);
    if (!isRoot) {
      Indent(section);
      text += "EndSect";
      if (!section.Comment().empty()) text.append(" //").append(section.Comment());
    }
    text += "\n\n";
  }

  void Indent(const CKvfBaseItem& item) { text.append(item.IndentSize(), ' '); }

  void EndLine(std::string_view comment) {
    if (!comment.empty()) text.append(" //").append(comment);
    text += '\n';
  }

  std::string& text;
  std::ostream* stream;
};

}  // namespace

void CKvfBaseItem::Write(std::ostream& stream) const {
  std::string text;
  ItemWriter writer(text, &stream);
  writer.Write(*this);
  writer.Flush();
}

void CKvfBaseItem::AppendTo(std::string& text) const {
  ItemWriter(text, nullptr).Write(*this);
}

}  // namespace tessal
