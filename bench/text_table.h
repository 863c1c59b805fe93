// A table on standard output, printed row by row as its figures become known.
#pragma once

#include <string>
#include <vector>

namespace tessal::bench {

/// The first column is aligned to the left and has a given width; the others are aligned to the right, and
/// as wide as their head, but not less than a figure needs.
class TextTable final {
 public:
  TextTable(std::size_t firstWidth, std::vector<std::string> heads);

  void PrintRow(const std::vector<std::string>& cells) const;

 private:
  std::vector<std::size_t> widths;
};

/// A figure with so many decimals, and one of a size that is not known before, with three digits.
std::string Fixed(double value, int decimals);
std::string ThreeDigits(double value);

}  // namespace tessal::bench
