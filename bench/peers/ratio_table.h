// The table of our costs beside those of the peers.
#pragma once

#include <string>

#include "text_table.h"

namespace tessal::bench {

class RatioTable final {
 public:
  RatioTable();

  void PrintRow(const std::string& work, const std::string& peer, const std::string& unit, double ours,
                double theirs) const;

 private:
  TextTable table;
};

}  // namespace tessal::bench
