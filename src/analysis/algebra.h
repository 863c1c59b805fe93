// Expressions as sums of products: what the process matrix and the mass balance calculate with. A sum is a
// value; what its products are made of (symbols, calls, conditionals) are atoms, which an algebra keeps, each
// once, so that equal parts of different expressions cancel.
#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "analysis/symbol_index.h"

namespace tessal {

class ExpressionNode;

/// The number of an atom of an algebra.
using AtomId = std::uint32_t;

/// A power of an atom; never 0.
struct AtomPower {
  AtomId atom;
  std::int32_t power;
  bool operator==(const AtomPower&) const = default;
};

/// A product: its coefficient is never 0, and its atoms are in the order of their numbers.
struct Product {
  double coefficient = 1;
  std::vector<AtomPower> atoms{};
  bool operator==(const Product&) const = default;
};

/// A sum of products that differ in their atoms, in the order of these; empty for 0.
using ProductSum = std::vector<Product>;

struct Atom {
  enum class Kind : std::uint8_t {
    Symbol,       ///< of an element, or an undefined name
    Bracket,      ///< a sum that is not multiplied out; one part
    Call,         ///< of a function; its arguments
    Conditional,  ///< a condition, as a number of an atom, and two parts
    Bigger,       ///< a condition; two parts
    Equal,        ///< the same
    Not,          ///< of a condition
    And,          ///< of two conditions
    Or,           ///< the same
    Other         ///< what only the simulation knows, such as a property of a particle
  };

  Kind kind = Kind::Other;
  const SymbolRecord* record = nullptr;  ///< of a symbol; none for an undefined name
  std::vector<ProductSum> parts{};
  std::vector<AtomId> conditions{};
  std::string text{};         ///< as people write it
  bool mentionsFlow = false;  ///< whether it is, or is made of, a process
};

/// What is done with a product of brackets.
enum class Brackets : std::uint8_t {
  Kept,          ///< one without a process stays a factor, as it was written
  MultipliedOut  ///< all are multiplied out, so that equal products cancel
};

class Algebra final {
 public:
  /// Sums with more products, and products of more atoms, are not made.
  static constexpr std::size_t kMostProducts = 2000;
  static constexpr std::size_t kMostAtoms = 100;

  Algebra(const SymbolIndex& symbolIndex, Brackets bracketRule) : index(symbolIndex), brackets(bracketRule) {}
  Algebra(const Algebra&) = delete;
  Algebra& operator=(const Algebra&) = delete;

  const SymbolIndex& Index() const { return index; }
  const Atom& At(AtomId atom) const { return atoms[atom]; }
  std::size_t AtomCount() const { return atoms.size(); }

  /// The expression of a text as a sum; none, with `Failure`, when it is too large or divides by zero.
  std::optional<ProductSum> Expand(std::string_view text, const ExpressionNode& tree);
  /// The same of a record's expression, which is expanded once; none, too, for one that does not parse.
  const std::optional<ProductSum>& BodyOf(const SymbolRecord& record);
  /// Why the last expression or product was not made, in words.
  const std::string& Failure() const { return failure; }

  AtomId SymbolAtom(const SymbolRecord& record);

  /// None, with `Failure`, when the result is too large.
  std::optional<ProductSum> Times(const ProductSum& left, const ProductSum& right);
  /// The derivative by a symbol; none, with `Failure`, where it is in a call, a condition or a divisor.
  std::optional<ProductSum> Derivative(const ProductSum& sum, AtomId symbol);

  /// The sum as an expression of the language, "-aNC/dz"; "0" when it is empty.
  std::string Text(const ProductSum& sum) const;

 private:
  class Expansion;

  AtomId Intern(std::string key, Atom atom);
  AtomId BracketAtom(const ProductSum& sum, std::string_view text);
  std::string KeyOf(const ProductSum& sum) const;
  bool MentionsFlow(const ProductSum& sum) const;
  std::string ProductText(const Product& product) const;
  std::string FactorText(const AtomPower& factor) const;
  bool Contains(AtomId atom, AtomId symbol) const;
  std::nullopt_t Fail(std::string reason);

  const SymbolIndex& index;
  Brackets brackets;
  std::vector<Atom> atoms;
  std::unordered_map<std::uint32_t, std::optional<ProductSum>> bodies;  ///< by the numbers of their records
  std::unordered_map<std::uint32_t, AtomId> symbols;                    ///< by the numbers of their records
  std::unordered_map<std::string, AtomId> numbers;  ///< by keys that say what an atom is made of
  std::string failure;
};

/// Whether an element is a rate that equations are made of: a process, or of a particle class an arithmetic
/// expression that an equation uses.
bool IsFlow(const TemplateCore& core, const SymbolRecord& record);

/// Adds products to a sum that need not be in order; `Settle` puts it in order and unites equal ones.
void Append(ProductSum& sum, const ProductSum& added, double factor = 1);
void Settle(ProductSum& sum);
/// Whether a sum in order has a product of these atoms.
bool HasProduct(const ProductSum& sum, const Product& likeThis);

}  // namespace tessal
