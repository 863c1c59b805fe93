#include "expr/numeric/random.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <limits>

#include "expr/numeric/angles.h"
#include "expr/numeric/arithmetic.h"

namespace tessal {

namespace {

constexpr std::int32_t kMultiplier = 16807;
constexpr std::int32_t kModulus = 2147483647;
constexpr std::int32_t kQuotient = kModulus / kMultiplier;
constexpr std::int32_t kRest = kModulus % kMultiplier;
constexpr std::int32_t kFirstSeed = -123456;
constexpr std::size_t kShuffleEntries = 32;
constexpr std::size_t kWarmUpRounds = kShuffleEntries + 8;
constexpr std::int32_t kOutputsPerEntry = 67108864;
constexpr double kDeviatePerOutput = 4.656612875245797e-10;
constexpr double kLargestDeviate = 0.9999999999999997;

constexpr double kPoissonRejectionFrom = 12;
constexpr double kGammaRejectionFrom = 6;
constexpr double kBinomialRejectionFrom = 25;

/// Rejection takes two or three rounds on the average. It can only come to this many where arguments are so
/// large that the acceptance has lost its digits; the mean is then the result.
constexpr int kMostRejections = 10000;

/// What depends on the mean of the last Poisson deviate only; no mean equals that of a fresh cache.
struct PoissonCache {
  double mean = std::numeric_limits<double>::quiet_NaN();
  double productLimit = 0;
  double root = 0;
  double logMean = 0;
  double logPeak = 0;
};

struct GeneratorState {
  std::int32_t seed = kFirstSeed;
  std::int32_t lastOutput = 0;
  std::array<std::int32_t, kShuffleEntries> shuffle{};
  bool hasSecondNormal = false;
  double secondNormal = 0;
  PoissonCache poisson;
};

GeneratorState& Generator() {
  static GeneratorState state;
  return state;
}

/// The next number of the congruence, without leaving 32 bits.
std::int32_t Advance(std::int32_t seed) {
  const std::int32_t high = seed / kQuotient;
  const std::int32_t next = kMultiplier * (seed - high * kQuotient) - kRest * high;
  return next < 0 ? next + kModulus : next;
}

void Seed(GeneratorState& state) {
  // The smallest 32-bit number has no negation; no seed that low is ever set.
  state.seed = std::max(1, -state.seed);
  for (std::size_t round = kWarmUpRounds; round-- > 0;) {
    state.seed = Advance(state.seed);
    if (round < kShuffleEntries) state.shuffle.at(round) = state.seed;
  }
  state.lastOutput = state.shuffle.front();
}

/// A point of the Cauchy distribution, under whose density the rejection methods throw.
double CauchyDeviate() {
  return std::tan(kPi * UniformDeviate());
}

PoissonCache PoissonConstants(double mean) {
  PoissonCache constants{.mean = mean};
  if (mean < kPoissonRejectionFrom) {
    constants.productLimit = std::exp(-mean);
  } else {
    constants.root = std::sqrt(2 * mean);
    constants.logMean = std::log(mean);
    constants.logPeak = mean * constants.logMean - LogGamma(mean + 1);
  }
  return constants;
}

/// Counts exponential waiting times within the mean, as a product of deviates.
double PoissonByProduct(const PoissonCache& constants) {
  double count = -1;
  double product = 1;
  do {
    count += 1;
    product *= UniformDeviate();
  } while (product > constants.productLimit);
  return count;
}

double PoissonByRejection(const PoissonCache& constants) {
  for (int round = 0; round < kMostRejections; ++round) {
    const double y = CauchyDeviate();
    const double candidate = constants.root * y + constants.mean;
    if (candidate < 0) continue;
    const double count = std::floor(candidate);
    const double logRatio = count * constants.logMean - LogGamma(count + 1) - constants.logPeak;
    const double acceptance = 0.9 * (1 + y * y) * std::exp(logRatio);
    if (!(UniformDeviate() > acceptance)) return count;
  }
  return std::floor(constants.mean);
}

double GammaByProduct(int order) {
  double product = 1;
  for (int event = 0; event < order; ++event) product *= UniformDeviate();
  return -std::log(product);
}

double GammaByRejection(double order) {
  const double mode = order - 1;
  const double width = std::sqrt(2 * mode + 1);
  for (int round = 0; round < kMostRejections; ++round) {
    const double y = CauchyDeviate();
    const double candidate = width * y + mode;
    if (candidate <= 0) continue;
    const double acceptance = (1 + y * y) * std::exp(mode * std::log(candidate / mode) - width * y);
    if (!(UniformDeviate() > acceptance)) return candidate;
  }
  return order;
}

double BinomialBySummation(double probability, int events) {
  double successes = 0;
  for (int event = 0; event < events; ++event) {
    if (UniformDeviate() < probability) successes += 1;
  }
  return successes;
}

/// Many events, few successes: sums the geometric waiting times between successes. Devroye 1986, Non-Uniform
/// Random Variate Generation, chapter X.4.
double BinomialByWaitingTimes(double probability, double events) {
  const double logFailure = std::log1p(-probability);
  double successes = 0;
  double event = 0;
  while (true) {
    event += std::floor(std::log(UniformDeviate()) / logFailure) + 1;
    if (!(event <= events)) return successes;
    successes += 1;
  }
}

double BinomialByRejection(double probability, double events) {
  const double mean = events * probability;
  const double root = std::sqrt(2 * mean * (1 - probability));
  const double logSuccess = std::log(probability);
  const double logFailure = std::log1p(-probability);
  const double logPermutations = LogGamma(events + 1);
  for (int round = 0; round < kMostRejections; ++round) {
    const double y = CauchyDeviate();
    const double candidate = root * y + mean;
    if (candidate < 0 || candidate >= events + 1) continue;
    const double successes = std::floor(candidate);
    const double failures = events - successes;
    const double logProbability = logPermutations - LogGamma(successes + 1) - LogGamma(failures + 1) +
                                  successes * logSuccess + failures * logFailure;
    const double acceptance = 1.2 * root * (1 + y * y) * std::exp(logProbability);
    if (!(UniformDeviate() > acceptance)) return successes;
  }
  return std::floor(mean);
}

/// For a probability from 0 to one half.
double FewerHalfBinomial(double probability, double events) {
  if (!(probability > 0)) return 0;
  if (events < kBinomialRejectionFrom) return BinomialBySummation(probability, static_cast<int>(events));
  if (events * probability < 1) return BinomialByWaitingTimes(probability, events);
  return BinomialByRejection(probability, events);
}

}  // namespace

void ResetRandomNumbers() {
  Generator() = GeneratorState{};
}

double UniformDeviate() {
  GeneratorState& state = Generator();
  if (state.seed <= 0 || state.lastOutput == 0) Seed(state);
  state.seed = Advance(state.seed);
  std::int32_t& entry = state.shuffle.at(static_cast<std::size_t>(state.lastOutput / kOutputsPerEntry));
  state.lastOutput = entry;
  entry = state.seed;
  return std::min(state.lastOutput * kDeviatePerOutput, kLargestDeviate);
}

double UniformDeviateBetween(double minimum, double maximum) {
  return UniformDeviate() * (maximum - minimum) + minimum;
}

double NormalDeviate() {
  GeneratorState& state = Generator();
  if (state.hasSecondNormal) {
    state.hasSecondNormal = false;
    return state.secondNormal;
  }
  double u = 0;
  double v = 0;
  double squared = 0;
  do {
    u = 2 * UniformDeviate() - 1;
    v = 2 * UniformDeviate() - 1;
    squared = u * u + v * v;
  } while (squared >= 1 || squared == 0);
  const double factor = std::sqrt(-2 * std::log(squared) / squared);
  state.secondNormal = factor * u;
  state.hasSecondNormal = true;
  return factor * v;
}

double NormalDeviateOf(double mean, double variance) {
  return NormalDeviate() * std::sqrt(variance) + mean;
}

double ExponentialDeviate() {
  double deviate = 0;
  do {
    deviate = UniformDeviate();
  } while (deviate == 0);
  return -std::log(deviate);
}

double PoissonDeviate(double mean) {
  if (std::isnan(mean)) return mean;
  PoissonCache& constants = Generator().poisson;
  if (mean != constants.mean) constants = PoissonConstants(mean);
  return mean < kPoissonRejectionFrom ? PoissonByProduct(constants) : PoissonByRejection(constants);
}

double GammaDeviate(double order) {
  if (std::isnan(order)) return order;
  const double wholeOrder = std::trunc(order);
  if (wholeOrder < 1) return 0;
  if (wholeOrder < kGammaRejectionFrom) return GammaByProduct(static_cast<int>(wholeOrder));
  return GammaByRejection(wholeOrder);
}

double BinomialDeviate(double probability, double events) {
  if (std::isnan(probability) || std::isnan(events)) return std::numeric_limits<double>::quiet_NaN();
  const double wholeEvents = std::max(0.0, std::trunc(events));
  const double chance = std::clamp(probability, 0.0, 1.0);
  if (chance > 0.5) return wholeEvents - FewerHalfBinomial(1 - chance, wholeEvents);
  return FewerHalfBinomial(chance, wholeEvents);
}

}  // namespace tessal
