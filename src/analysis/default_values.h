// What expressions are worth at the default values of a template, as far as that can be computed without a
// simulation.
#pragma once

#include <vector>

namespace tessal {

class ExpressionNode;
class SymbolIndex;

/// The values of the nodes of a tree; not a number where a value is not known, or not defined.
class NodeValues final {
 public:
  double Of(const ExpressionNode& node) const;

 private:
  friend class DefaultValues;

  const ExpressionNode* root = nullptr;
  std::vector<double> values;  ///< by the distance from the root, after which no node lies
};

class DefaultValues final {
 public:
  /// Computes the records of the template once, each from those before it; what is used before it is declared
  /// has no known value.
  explicit DefaultValues(const SymbolIndex& indexed);

  /// The nodes of an expression of the template, when all identifiers have their default values.
  NodeValues Evaluate(const ExpressionNode& tree) const;
  double OfRecord(std::size_t place) const { return records[place]; }

 private:
  double Compute(const ExpressionNode& node, const NodeValues& values) const;

  const SymbolIndex& symbols;
  std::vector<double> records;
};

}  // namespace tessal
