// The names of one template, each with a number: symbols, and what expressions mention. A name that has a
// number keeps it, so that an expression's names are looked up once, and not at each rebuild.
#pragma once

#include <bit>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory_resource>
#include <string_view>
#include <utility>
#include <vector>

namespace tessal {

/// The number of a name, from 1; 0 for no name.
using NameNumber = std::uint32_t;

/// In a large template every step through memory counts: the cells of the hash table lie side by side, probed
/// one after the other, and hold enough of the hash that few names are compared in vain.
class NameTable final {
 public:
  NameTable() { Clear(); }
  NameTable(const NameTable&) = delete;
  NameTable& operator=(const NameTable&) = delete;

  void Clear() {
    names.assign(1, {});
    cells.assign(kFirstCells, {});
    texts.release();
  }

  /// The number of a name, which gets one if it has none.
  NameNumber NumberOf(std::string_view name) {
    const std::uint32_t hash = ShortHash(name);
    Cell* cell = &cells[CellOf(name, hash)];
    if (cell->number != 0) return cell->number;
    if (2 * names.size() > cells.size()) {
      Grow();
      cell = &cells[CellOf(name, hash)];
    }
    names.push_back(Kept(name));
    *cell = {hash, static_cast<NameNumber>(names.size() - 1)};
    return cell->number;
  }

  std::string_view NameOf(NameNumber number) const { return names[number]; }
  /// One more than the highest number.
  std::size_t End() const { return names.size(); }

 private:
  static constexpr std::size_t kFirstCells = 64;

  struct Cell {
    std::uint32_t hash = 0;
    NameNumber number = 0;  ///< 0 for an empty cell
  };

  static std::uint32_t ShortHash(std::string_view name) {
    return static_cast<std::uint32_t>(std::hash<std::string_view>()(name));
  }
  /// The cell that holds the name, or the empty one that would take it.
  std::size_t CellOf(std::string_view name, std::uint32_t hash) const {
    std::size_t place = hash & (cells.size() - 1);
    while (cells[place].number != 0 && (cells[place].hash != hash || names[cells[place].number] != name)) {
      place = (place + 1) & (cells.size() - 1);
    }
    return place;
  }
  void Grow() {
    const std::vector<Cell> former = std::exchange(cells, std::vector<Cell>(2 * cells.size()));
    for (const Cell& cell : former) {
      if (cell.number == 0) continue;
      std::size_t place = cell.hash & (cells.size() - 1);
      while (cells[place].number != 0) place = (place + 1) & (cells.size() - 1);
      cells[place] = cell;
    }
  }
  std::string_view Kept(std::string_view name) {
    if (name.empty()) return {};
    char* const copy = static_cast<char*>(texts.allocate(name.size(), 1));
    name.copy(copy, name.size());
    return {copy, name.size()};
  }

  std::vector<std::string_view> names;
  std::vector<Cell> cells;
  std::pmr::monotonic_buffer_resource texts;
};

}  // namespace tessal
