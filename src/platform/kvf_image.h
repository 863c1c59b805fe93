// A key file that was read, as the handles and nodes of the key-file library refer to it. Its items lie in
// one row, in the order of the file, at eight bytes an item; names and texts are places in the text of the
// file. So a file of a million elements costs less than its text again, and is released in one go.
#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "platform/kvf2004.h"

namespace tessal {

/// The kinds of value that a parameter may have.
enum class KvfValueType : std::uint8_t { Integer, Real, Boolean, Quoted, Path };

/// One item of a row: a section, a keyword or a parameter, by the place and size of its name or text.
/// A section is followed by one more cell, with its number of sub-sections and its line, and by one with the
/// place after its last item. A keyword is followed by its parameters; where there are too many for its own
/// cell to say, their number lies in a cell between.
class KvfCell final {
 public:
  enum class Type : std::uint8_t { Parameter, Keyword, Section };

  /// A size that does not fit the cell is in the image's list of long texts.
  static constexpr std::uint32_t kLongSize = (1U << 24U) - 1U;
  /// A number of parameters that lies in a cell of its own.
  static constexpr std::uint32_t kManyParameters = 7;

  KvfCell(Type type, std::uint32_t detail, std::size_t start, std::size_t size)
      : first(static_cast<std::uint32_t>(start)),
        second((size < kLongSize ? static_cast<std::uint32_t>(size) : kLongSize) | detail << kDetailShift |
               static_cast<std::uint32_t>(type) << kTypeShift) {}
  /// A cell of two numbers.
  KvfCell(std::size_t one, std::size_t other)
      : first(static_cast<std::uint32_t>(one)), second(static_cast<std::uint32_t>(other)) {}

  Type ItemType() const { return static_cast<Type>(second >> kTypeShift & kTypeMask); }
  std::uint32_t Start() const { return first; }
  std::uint32_t Size() const { return second & kLongSize; }
  /// Of a parameter the type of its value, of a keyword the number of its parameters.
  std::uint32_t Detail() const { return second >> kDetailShift & kDetailMask; }
  void SetDetail(std::uint32_t detail) { second |= detail << kDetailShift; }
  /// Whether somebody has read the parameter, or asked for the section.
  bool WasRead() const { return (second & kReadMark) != 0; }
  void MarkRead() { second |= kReadMark; }

  std::uint32_t One() const { return first; }
  std::uint32_t Other() const { return second; }

 private:
  static constexpr std::uint32_t kDetailShift = 24;
  static constexpr std::uint32_t kDetailMask = 7;
  static constexpr std::uint32_t kTypeShift = 27;
  static constexpr std::uint32_t kTypeMask = 3;
  static constexpr std::uint32_t kReadMark = 1U << 31U;

  std::uint32_t first;
  std::uint32_t second;
};
static_assert(sizeof(KvfCell) == 8);

/// A comment of a file. It has no place among the items.
struct KvfComment {
  int line;             ///< from 1
  std::uint32_t start;  ///< in the text, after the slashes
  std::uint32_t size;
};

/// The part of the text that a top-level section takes, from the start of its first line to that of the line
/// after its last.
struct KvfSpan {
  std::uint32_t section;  ///< its place in the row
  std::size_t start;
  std::size_t end;
};

class KvfImage final {
 public:
  /// The places of the cells that belong to a section, after its own.
  static constexpr std::uint32_t kSectionCells = 3;

  /// Of the bytes of a file. A mark of the byte order is dropped, and what follows a zero byte.
  explicit KvfImage(std::string bytes);
  KvfImage(const KvfImage&) = delete;
  KvfImage& operator=(const KvfImage&) = delete;

  std::string_view Source() const { return *source; }

  // Items, by their places in the row.
  const KvfCell& At(std::uint32_t place) const { return row[place]; }
  KvfCell& At(std::uint32_t place) { return row[place]; }
  /// The name or text of an item as it is in the file.
  std::string_view TextAt(std::uint32_t place) const;
  /// The line of a section or keyword, from 1.
  int LineAt(std::uint32_t place) const;
  /// How many parameters a keyword has, and where the first of them is.
  std::uint32_t ParameterCount(std::uint32_t keyword) const {
    const std::uint32_t count = row[keyword].Detail();
    return count < KvfCell::kManyParameters ? count : row[keyword + 1].One();
  }
  std::uint32_t FirstParameter(std::uint32_t keyword) const {
    return keyword + (row[keyword].Detail() < KvfCell::kManyParameters ? 1 : 2);
  }
  /// The first section or keyword of a section, and the one after another. At the end both give the section's
  /// end.
  static std::uint32_t FirstEntry(std::uint32_t section) { return section + kSectionCells; }
  std::uint32_t NextEntry(std::uint32_t entry) const {
    return row[entry].ItemType() == KvfCell::Type::Section ? EndOfSection(entry)
                                                           : FirstParameter(entry) + ParameterCount(entry);
  }
  std::uint32_t EndOfSection(std::uint32_t section) const { return row[section + 2].One(); }
  std::uint32_t SubSectionCount(std::uint32_t section) const { return row[section + 1].One(); }

  /// The n-th of a section's keywords or sub-sections that has a name, whatever the case of its letters; 0
  /// for none.
  std::uint32_t FindName(std::uint32_t section, KvfCell::Type type, std::string_view name, int number) const;

  std::shared_ptr<const std::string> source;
  std::size_t bytesCut = 0;  ///< after a zero byte, which ends the text
  /// The first item is the root, a section that holds the top-level sections.
  std::vector<KvfCell> row;
  std::vector<std::pair<std::uint32_t, std::size_t>> longTexts;  ///< places and sizes, in order
  std::vector<std::pair<std::size_t, int>> lines;  ///< starts of some lines and their numbers, in order
  std::vector<KvfSpan> targets;
  std::vector<KvfComment> comments;
  /// Whether the text keeps to the stricter grammar of the item tree. False where it may not.
  bool isStrict = false;
};

/// Where and near what a text stopped being key-file text.
struct KvfSyntaxError {
  int line = 0;      ///< from 1
  int position = 0;  ///< from 1, in its line
  std::string text;  ///< at most 40 bytes, one line
};

/// Fills an image from its source. False, with the error filled in, when that is no key-file text.
bool ReadKvfImage(KvfImage& image, KvfSyntaxError& error);

/// What is in the source beside one of its top-level sections, from the first section on, with CRLF line ends
/// and without blank lines at the ends. With 0 for the section, all of it.
std::string KvfTextBeside(const KvfImage& image, std::uint32_t section);

/// Visits the comments in the head of the source and inside a top-level section, without those that the
/// library writes itself.
void ForEachKvfRemark(const KvfImage& image, std::uint32_t section,
                      const std::function<void(const KvfRemark&)>& visit);

}  // namespace tessal
