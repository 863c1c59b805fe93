// The sections and keywords of a template file by their places in its text. Made by a look at the text alone,
// so it is there for a file that is not whole.
#pragma once

#include <cstddef>
#include <optional>
#include <string_view>
#include <vector>

namespace tessal::cli {

struct OutlineSection {
  std::string_view name;
  std::size_t start = 0;              ///< of its head
  std::size_t end = 0;                ///< after its `EndSect`, or the end of the text
  std::optional<std::size_t> parent;  ///< the section that it lies in
  bool IsIn(std::size_t place) const { return place >= start && place <= end; }
};

struct OutlineKeyword {
  std::string_view word;
  std::optional<std::size_t> section;
};

class FileOutline final {
 public:
  explicit FileOutline(std::string_view outlined);

  const std::vector<OutlineSection>& Sections() const { return sections; }
  const std::vector<OutlineKeyword>& Keywords() const { return keywords; }
  /// The innermost section that a place is in.
  std::optional<std::size_t> SectionAt(std::size_t place) const;
  /// The keyword or name of a section at a place, its end included; empty where there is none.
  std::string_view WordAt(std::size_t place) const;
  /// The keyword before a place in a value; empty where there is none.
  std::string_view KeywordBefore(std::size_t place) const;

 private:
  std::size_t ReadHead(std::size_t place);
  std::size_t ReadWord(std::size_t place);

  std::string_view text;
  std::vector<OutlineSection> sections;  ///< in the order of their heads
  std::vector<OutlineKeyword> keywords;  ///< in the order of the text
  std::optional<std::size_t> open;       ///< the section that is being read
};

}  // namespace tessal::cli
