#include "ratio_table.h"

namespace tessal::bench {

namespace {

constexpr std::size_t kWorkWidth = 84;
constexpr const char* kUnitHead = "           unit";

}  // namespace

RatioTable::RatioTable() : table(kWorkWidth, {"work : peer", kUnitHead, "ours", "peer's", "ratio"}) {}

void RatioTable::PrintRow(const std::string& work, const std::string& peer, const std::string& unit,
                          double ours, double theirs) const {
  table.PrintRow(
      {work + " : " + peer, unit, ThreeDigits(ours), ThreeDigits(theirs), ThreeDigits(ours / theirs)});
}

}  // namespace tessal::bench
