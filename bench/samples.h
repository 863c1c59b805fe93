// Samples of works that are to be compared: taken in turns, so that whatever slows the machine down meets all
// of them alike, and summed up by their medians.
#pragma once

#include <ctime>
#include <functional>
#include <vector>

namespace tessal::bench {

/// The middle value, or the mean of the two in the middle. There is at least one.
double Median(std::vector<double> values);

template <class Cost>
using Work = std::function<Cost()>;

/// Does each work once in each round, and returns the costs of each work.
template <class Cost>
std::vector<std::vector<Cost>> InTurns(const std::vector<Work<Cost>>& works, int rounds) {
  std::vector<std::vector<Cost>> costs(works.size());
  for (int round = 0; round < rounds; ++round) {
    for (std::size_t place = 0; place < works.size(); ++place) costs[place].push_back(works[place]());
  }
  return costs;
}

/// The median of one field of the costs.
template <class Cost>
double MedianOf(const std::vector<Cost>& costs, double Cost::*field) {
  std::vector<double> values;
  for (const Cost& cost : costs) values.push_back(cost.*field);
  return Median(std::move(values));
}

/// The processor time of this process since the object was made, in seconds.
class ProcessorClock final {
 public:
  double Seconds() const { return Now() - start; }

 private:
  static double Now() {
    constexpr double kNanosecond = 1e-9;
    timespec time = {};
    clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &time);
    return static_cast<double>(time.tv_sec) + static_cast<double>(time.tv_nsec) * kNanosecond;
  }

  double start = Now();
};

}  // namespace tessal::bench
