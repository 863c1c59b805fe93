// The random deviates: the generator number by number, the distributions by their moments and by goodness of
// fit. Seeds are fixed, so a test that passes once passes always; the limits are four standard deviations.

#include <algorithm>
#include <cmath>
#include <functional>
#include <string>
#include <utility>
#include <vector>

#include <gtest/gtest.h>

#include "expr/numeric/random.h"

namespace tessal {
namespace {

constexpr int kSamples = 400000;
constexpr double kDeviations = 4;

class RandomDeviates : public testing::Test {
 protected:
  RandomDeviates() { ResetRandomNumbers(); }
};

std::vector<double> Draw(const std::function<double()>& deviate) {
  std::vector<double> samples(kSamples);
  std::generate(samples.begin(), samples.end(), deviate);
  return samples;
}

struct Moments {
  double mean, variance;
  double fourth;  // the fourth central moment, for the spread of the variance
};

void ExpectMoments(const std::vector<double>& samples, const Moments& expected, const std::string& what) {
  const auto count = static_cast<double>(samples.size());
  double sum = 0;
  for (const double sample : samples) sum += sample;
  const double mean = sum / count;
  double squares = 0;
  for (const double sample : samples) squares += (sample - mean) * (sample - mean);
  const double variance = squares / (count - 1);
  const double spread = std::sqrt((expected.fourth - expected.variance * expected.variance) / count);
  EXPECT_NEAR(mean, expected.mean, kDeviations * std::sqrt(expected.variance / count)) << what;
  EXPECT_NEAR(variance, expected.variance, kDeviations * spread) << what;
}

/// Pearson's statistic against its own expectation and standard deviation.
void ExpectGoodFit(const std::vector<double>& observed, const std::vector<double>& expected,
                   const std::string& what) {
  double statistic = 0;
  for (std::size_t cell = 0; cell < expected.size(); ++cell) {
    const double difference = observed[cell] - expected[cell];
    statistic += difference * difference / expected[cell];
  }
  const auto freedom = static_cast<double>(expected.size() - 1);
  EXPECT_LT(statistic, freedom + kDeviations * std::sqrt(2 * freedom))
      << what << ", " << freedom << " degrees of freedom";
}

/// For continuous deviates: their distribution function makes them uniform, and 500 cells equally full.
void ExpectContinuousFit(const std::vector<double>& samples,
                         const std::function<double(double)>& distribution, const std::string& what) {
  constexpr std::size_t kCells = 500;
  std::vector<double> observed(kCells);
  for (const double sample : samples) {
    const double share = distribution(sample);
    ASSERT_TRUE(share >= 0 && share <= 1) << what << " " << sample;
    observed[std::min(kCells - 1, static_cast<std::size_t>(share * kCells))] += 1;
  }
  ExpectGoodFit(observed, std::vector<double>(kCells, static_cast<double>(samples.size()) / kCells), what);
}

/// For counts: cells are single counts, the tails drawn together where fewer than 10 are expected.
void ExpectDiscreteFit(const std::vector<double>& samples,
                       const std::function<double(double)>& logProbability, const std::string& what) {
  std::vector<double> observed{0};
  std::vector<double> expected{0};
  const double largest = *std::max_element(samples.begin(), samples.end());
  std::vector<double> counts(static_cast<std::size_t>(largest) + 1);
  for (const double sample : samples) {
    ASSERT_TRUE(sample >= 0 && sample == std::floor(sample)) << what << " " << sample;
    counts[static_cast<std::size_t>(sample)] += 1;
  }
  double rest = static_cast<double>(samples.size());
  for (std::size_t count = 0; count < counts.size(); ++count) {
    const double share =
        static_cast<double>(samples.size()) * std::exp(logProbability(static_cast<double>(count)));
    observed.back() += counts[count];
    expected.back() += share;
    rest -= share;
    if (expected.back() >= 10 && rest >= 10) {
      observed.push_back(0);
      expected.push_back(0);
    }
  }
  expected.back() += std::max(0.0, rest);
  ExpectGoodFit(observed, expected, what);
}

TEST_F(RandomDeviates, GeneratorGivesItsSequence) {
  constexpr double kModulus = 2147483647;
  const std::pair<int, double> rows[] = {
      {1, 1978234897}, {2, 1358237425}, {3, 161652028}, {100, 84520374}, {1000000, 109042921}};
  int drawn = 0;
  for (const auto& [position, output] : rows) {
    double deviate = 0;
    for (; drawn < position; ++drawn) deviate = UniformDeviate();
    EXPECT_DOUBLE_EQ(deviate, output / kModulus) << position;
  }
}

TEST_F(RandomDeviates, ResetRepeatsTheRun) {
  const std::vector<double> first{NormalDeviate(), UniformDeviate(), PoissonDeviate(20), GammaDeviate(9)};
  ResetRandomNumbers();
  const std::vector<double> second{NormalDeviate(), UniformDeviate(), PoissonDeviate(20), GammaDeviate(9)};
  EXPECT_EQ(first, second);
}

TEST_F(RandomDeviates, ContinuousOnesHaveTheirMomentsAndShape) {
  const auto uniform = [] { return UniformDeviateBetween(-3, 5); };
  const auto scaled = [] { return NormalDeviateOf(10, 4); };
  const auto normal = [](double z) { return std::erfc(-z / std::sqrt(2)) / 2; };
  const struct {
    const char* what;
    std::function<double()> deviate;
    Moments moments;
    std::function<double(double)> distribution;
  } rows[] = {
      {"uniform", uniform, {1, 64.0 / 12, 4096.0 / 80}, [](double x) { return (x + 3) / 8; }},
      {"standard normal", NormalDeviate, {0, 1, 3}, normal},
      {"normal", scaled, {10, 4, 48}, [&](double x) { return normal((x - 10) / 2); }},
      {"exponential", ExponentialDeviate, {1, 1, 9}, [](double x) { return -std::expm1(-x); }},
  };
  for (const auto& row : rows) {
    const std::vector<double> samples = Draw(row.deviate);
    ExpectMoments(samples, row.moments, row.what);
    ExpectContinuousFit(samples, row.distribution, row.what);
    const auto& [mean, variance, fourth] = row.moments;
    for (const std::size_t lag : {1U, 2U, 31U, 32U}) {
      double product = 0;
      for (std::size_t i = lag; i < samples.size(); ++i)
        product += (samples[i] - mean) * (samples[i - lag] - mean);
      EXPECT_LT(std::fabs(product / (kSamples * variance)), kDeviations / std::sqrt(kSamples))
          << row.what << lag;
    }
  }
}

TEST_F(RandomDeviates, PoissonHasItsShapeOnBothSidesOfTheThreshold) {
  for (const double mean : {0.1, 1.0, 5.5, 11.99, 12.0, 13.7, 60.0, 1000.0}) {
    const std::string what = "Poisson " + std::to_string(mean);
    const std::vector<double> samples = Draw([mean] { return PoissonDeviate(mean); });
    ExpectMoments(samples, {mean, mean, mean * (1 + 3 * mean)}, what);
    ExpectDiscreteFit(
        samples, [mean](double k) { return k * std::log(mean) - mean - std::lgamma(k + 1); }, what);
  }
  // The cache of one mean serves no other.
  double sum = 0;
  for (int i = 0; i < 100000; ++i) sum += PoissonDeviate(2) + PoissonDeviate(30);
  EXPECT_NEAR(sum / 100000, 32, kDeviations * std::sqrt(32.0 / 100000));
}

TEST_F(RandomDeviates, GammaHasItsShapeOnBothSidesOfTheThreshold) {
  for (const int order : {1, 2, 5, 6, 7, 20, 200}) {
    const std::string what = "gamma " + std::to_string(order);
    const std::vector<double> samples = Draw([order] { return GammaDeviate(order + 0.5); });
    const double k = order;
    ExpectMoments(samples, {k, k, 3 * k * k + 6 * k}, what);
    // The waiting time for the n-th event is beyond x if fewer than n events come before x.
    const auto distribution = [order](double x) {
      double fewer = 0;
      for (int i = 0; i < order; ++i) fewer += std::exp(i * std::log(x) - x - std::lgamma(i + 1.0));
      return std::max(0.0, 1 - fewer);
    };
    ExpectContinuousFit(samples, distribution, what);
  }
}

TEST_F(RandomDeviates, BinomialHasItsShapeForFewAndManyEvents) {
  const struct {
    double probability, events;
  } rows[] = {{0.3, 1},   {0.5, 10},      {0.9, 24},   {0.02, 24},    {0.039, 25},
              {0.04, 25}, {0.3, 25},      {0.96, 25},  {0.5, 26},     {0.97, 40},
              {0.2, 300}, {0.0005, 1000}, {0.75, 900}, {0.001, 3000}, {0.5, 100000}};
  for (const auto& row : rows) {
    const double p = row.probability;
    const double n = row.events;
    const std::string what = "binomial " + std::to_string(p) + " " + std::to_string(n);
    const std::vector<double> samples =
        Draw([&row] { return BinomialDeviate(row.probability, row.events + 0.9); });
    const double variance = n * p * (1 - p);
    ExpectMoments(samples, {n * p, variance, variance * (1 + 3 * (n - 2) * p * (1 - p))}, what);
    EXPECT_LE(*std::max_element(samples.begin(), samples.end()), n) << what;
    ExpectDiscreteFit(
        samples,
        [p, n](double k) {
          return std::lgamma(n + 1) - std::lgamma(k + 1) - std::lgamma(n - k + 1) + k * std::log(p) +
                 (n - k) * std::log1p(-p);
        },
        what);
  }
}

TEST_F(RandomDeviates, StayNearAHugeMean) {
  // Where the acceptance has lost its digits the deviate is still near the mean.
  EXPECT_NEAR(PoissonDeviate(1e18) / 1e18, 1, 1e-6);
  EXPECT_NEAR(BinomialDeviate(0.5, 1e18) / 1e18, 0.5, 1e-6);
  EXPECT_NEAR(GammaDeviate(1e18) / 1e18, 1, 1e-6);
}

}  // namespace
}  // namespace tessal
