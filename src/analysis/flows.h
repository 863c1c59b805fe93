// Equations by their processes: a sum of processes, each with its factor, and a rest. A process that is such
// a sum of other processes, without a rest, is composed; all others are elementary.
#pragma once

#include <functional>
#include <map>
#include <optional>
#include <unordered_map>
#include <unordered_set>

#include "analysis/algebra.h"

namespace tessal {

/// A sum by processes.
struct FlowForm {
  std::map<AtomId, ProductSum> factors;  ///< by the atoms of the processes; none is 0
  ProductSum rest;                       ///< what is no multiple of a process
};

/// Takes a sum apart. A process in a divisor, a call or a condition, or times another, belongs to the rest.
FlowForm FlowFormOf(const Algebra& algebra, const ProductSum& sum);

/// Knows which processes are composed, and of what.
class Flows final {
 public:
  /// Processes of which `isKept` says so count as elementary.
  Flows(Algebra& flowAlgebra, std::function<bool(const SymbolRecord&)> isKeptFlow = {})
      : algebra(flowAlgebra), isKept(std::move(isKeptFlow)) {}
  Flows(const Flows&) = delete;
  Flows& operator=(const Flows&) = delete;

  /// A sum in which composed processes are replaced by what they are made of. Where that would become too
  /// large, they stay.
  ProductSum Elementary(const ProductSum& sum);

 private:
  bool HasComposedBody(AtomId flow);
  void Compose(AtomId flow);
  ProductSum Replaced(const ProductSum& sum) const;

  Algebra& algebra;
  std::function<bool(const SymbolRecord&)> isKept;
  /// What each process that was looked at is made of; itself for an elementary one.
  std::unordered_map<AtomId, ProductSum> made;
  std::unordered_set<AtomId> looked;  ///< composed processes whose parts are looked at
};

}  // namespace tessal
