// What a read of a key file does for each rule of its grammar: nothing, or building the item tree.
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string_view>
#include <vector>

#include "keyfile/item_tree.h"
#include "keyfile/scanner.h"

namespace tessal {

/// A read that only says whether a text is a key file.
class TreelessRead final {
 public:
  static CKvfBaseItem* NewComment(KeyFilePiece /*line*/) { return nullptr; }
  static CKvfBaseItem* PrependComment(KeyFilePiece /*line*/, CKvfBaseItem* /*block*/) { return nullptr; }
  static CKvfBaseItem* NewTargets(CKvfBaseItem* /*section*/) { return nullptr; }
  static CKvfBaseItem* PrependTarget(CKvfBaseItem* /*section*/, CKvfBaseItem* /*targets*/) { return nullptr; }
  static CKvfBaseItem* NewSection() { return nullptr; }
  static CKvfBaseItem* AppendItem(CKvfBaseItem* /*section*/, CKvfBaseItem* /*item*/) { return nullptr; }
  static void NoteSectionLine() {}
  static CKvfBaseItem* EndSection(CKvfBaseItem* /*section*/, KeyFilePiece /*name*/,
                                  KeyFilePiece /*startComment*/, KeyFilePiece /*endComment*/) {
    return nullptr;
  }
  static void AddReal(KeyFilePiece /*digits*/) {}
  static void AddInteger(KeyFilePiece /*digits*/) {}
  static void AddBoolean(KeyFilePiece /*word*/) {}
  static void AddQuoted(KeyFilePiece /*content*/) {}
  static void AddPath(KeyFilePiece /*content*/) {}
  static CKvfBaseItem* EndKey(KeyFilePiece /*name*/, KeyFilePiece /*comment*/) { return nullptr; }
  static void Finish(CKvfBaseItem* /*header*/, CKvfBaseItem* /*targets*/) {}

  static bool IsFull() { return false; }
};

/// A read that builds a tree. Its texts are views into the text that is scanned, but for those with
/// characters that do not count.
class TreeBuilder final {
 public:
  /// A tree may take so many times the bytes of its text, and something for a small text of short lines.
  static constexpr std::size_t kMostTimes = 12;
  static constexpr std::size_t kFreeBytes = 256'000'000;

  TreeBuilder(const KeyFileScan& textScan, std::size_t textSize);

  CKvfBaseItem* NewComment(KeyFilePiece line);
  CKvfBaseItem* PrependComment(KeyFilePiece line, CKvfBaseItem* block);
  CKvfBaseItem* NewTargets(CKvfBaseItem* section);
  CKvfBaseItem* PrependTarget(CKvfBaseItem* section, CKvfBaseItem* targets);
  CKvfBaseItem* NewSection();
  static CKvfBaseItem* AppendItem(CKvfBaseItem* section, CKvfBaseItem* item);
  void NoteSectionLine() { sectionLine = scan.Line(); }
  CKvfBaseItem* EndSection(CKvfBaseItem* section, KeyFilePiece name, KeyFilePiece startComment,
                           KeyFilePiece endComment);
  // The values of a keyword come together before it ends.
  void AddReal(KeyFilePiece digits);
  void AddInteger(KeyFilePiece digits);
  void AddBoolean(KeyFilePiece word);
  void AddQuoted(KeyFilePiece content);
  void AddPath(KeyFilePiece content);
  CKvfBaseItem* EndKey(KeyFilePiece name, KeyFilePiece comment);
  void Finish(CKvfBaseItem* header, CKvfBaseItem* targets);

  /// Whether more was built than may be. The read ends then.
  bool IsFull() const { return memory.Taken() + values.size() * sizeof(KvfValue) > mostBytes; }

  /// The finished tree.
  std::unique_ptr<CKvfItemTree> Take() { return std::move(tree); }

 private:
  std::string_view CommentText(KeyFilePiece piece);
  std::string_view QuotedText(KeyFilePiece piece);

  const KeyFileScan& scan;
  std::size_t mostBytes;
  std::unique_ptr<CKvfItemTree> tree;
  ItemMemory& memory;
  std::vector<KvfValue> values;  ///< of the keyword that is read
  std::size_t openSections = 0;
  std::int32_t sectionLine = 0;
};

}  // namespace tessal
