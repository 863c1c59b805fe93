#include "text_table.h"

#include <algorithm>
#include <cmath>
#include <iomanip>
#include <iostream>
#include <sstream>

namespace tessal::bench {

TextTable::TextTable(std::size_t firstWidth, std::vector<std::string> heads) {
  constexpr std::size_t kFigure = 8;
  for (const std::string& head : heads) widths.push_back(std::max(head.size(), kFigure));
  widths.front() = firstWidth;
  PrintRow(heads);
}

void TextTable::PrintRow(const std::vector<std::string>& cells) const {
  std::cout << std::left;
  for (std::size_t place = 0; place < cells.size(); ++place) {
    if (place > 0) std::cout << "  " << std::right;
    std::cout << std::setw(static_cast<int>(widths[place])) << cells[place];
  }
  std::cout << std::endl;
}

std::string Fixed(double value, int decimals) {
  std::ostringstream text;
  text << std::fixed << std::setprecision(decimals) << value;
  return text.str();
}

std::string ThreeDigits(double value) {
  constexpr double kTen = 10;
  constexpr double kHundred = 100;
  const double size = std::abs(value);
  return Fixed(value, size >= kHundred ? 0 : size >= kTen ? 1 : 2);
}

}  // namespace tessal::bench
