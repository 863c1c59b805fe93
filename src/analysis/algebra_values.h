// Values of sums at a point: every symbol that declares a value has one, auxiliaries and processes have that
// of their expressions. At a random point a function that can not be computed is an unknown with one value
// for each list of arguments; so are, if asked for, all functions, and the outcome of each comparison.
#pragma once

#include <cstdint>
#include <optional>
#include <unordered_map>
#include <unordered_set>

#include "analysis/algebra.h"

namespace tessal {

/// Where values are taken.
enum class PointKind : std::uint8_t {
  Defaults,         ///< the declared values; what can not be computed has none
  Random,           ///< values about the declared ones
  RandomFunctions,  ///< the same, and all functions are unknowns
  RandomTruths      ///< the same, and each comparison holds or not at random
};

class PointValues final {
 public:
  /// The values of the same point are the same in each run.
  PointValues(Algebra& valuedAlgebra, PointKind pointKind, std::uint64_t pointNumber)
      : algebra(valuedAlgebra), kind(pointKind), seed(pointNumber) {}
  PointValues(const PointValues&) = delete;
  PointValues& operator=(const PointValues&) = delete;

  /// Not a number where a function can not be computed, or an expression not be expanded.
  double ValueOf(const ProductSum& sum);
  double ValueOf(AtomId atom);
  /// The sum of the absolute values of the products: what a sum near zero is compared with.
  double SizeOf(const ProductSum& sum);

 private:
  double ValueOf(const Product& product);
  double ValueOfSymbol(AtomId atom);
  double ValueOfRecord(const SymbolRecord& record);
  double ValueOfBody(const SymbolRecord& record);
  double ValueOfCall(const Atom& call);
  bool Holds(AtomId condition);
  /// A number from 0 to 1 that depends on the seed and on what it is asked for.
  double RandomFor(std::uint64_t subject) const;

  Algebra& algebra;
  PointKind kind;
  std::uint64_t seed;
  std::unordered_map<AtomId, double> known;
  std::unordered_set<std::uint32_t> entered;  ///< records that have a value, or are about to get one
};

}  // namespace tessal
