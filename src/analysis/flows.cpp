#include "analysis/flows.h"

#include <algorithm>
#include <utility>
#include <vector>

namespace tessal {

namespace {

bool IsFlowAtom(const Atom& atom) {
  return atom.kind == Atom::Kind::Symbol && atom.mentionsFlow;
}

/// The place of the one process among the factors of a product; none where it is no multiple of a process.
std::optional<std::size_t> PlaceOfFlow(const Algebra& algebra, const Product& product) {
  std::optional<std::size_t> found;
  for (std::size_t place = 0; place < product.atoms.size(); ++place) {
    const AtomPower& factor = product.atoms[place];
    const Atom& atom = algebra.At(factor.atom);
    if (!atom.mentionsFlow) continue;
    if (found || !IsFlowAtom(atom) || factor.power != 1) return std::nullopt;
    found = place;
  }
  return found;
}

Product Without(Product product, std::size_t place) {
  product.atoms.erase(product.atoms.begin() + static_cast<std::ptrdiff_t>(place));
  return product;
}

}  // namespace

FlowForm FlowFormOf(const Algebra& algebra, const ProductSum& sum) {
  FlowForm form;
  for (const Product& product : sum) {
    if (const std::optional<std::size_t> place = PlaceOfFlow(algebra, product)) {
      form.factors[product.atoms[*place].atom].push_back(Without(product, *place));
    } else {
      form.rest.push_back(product);
    }
  }
  for (auto& [flow, factor] : form.factors) Settle(factor);
  return form;
}

bool Flows::HasComposedBody(AtomId flow) {
  const SymbolRecord& record = *algebra.At(flow).record;
  if (isKept && isKept(record)) return false;
  const std::optional<ProductSum>& body = algebra.BodyOf(record);
  return body && !body->empty() && std::all_of(body->begin(), body->end(), [this](const Product& product) {
           return PlaceOfFlow(algebra, product).has_value();
         });
}

/// Finds what a process is made of, after all that it is made of: a chain of processes may be as long as the
/// template.
void Flows::Compose(AtomId first) {
  std::vector<AtomId> open{first};
  while (!open.empty()) {
    const AtomId flow = open.back();
    if (looked.erase(flow) > 0) {
      ProductSum parts = Replaced(*algebra.BodyOf(*algebra.At(flow).record));
      // One that is made of itself, too, is elementary.
      if (!FlowFormOf(algebra, parts).factors.contains(flow)) made[flow] = std::move(parts);
      open.pop_back();
    } else if (made.contains(flow)) {
      open.pop_back();
    } else {
      // Until it is known, and in a circle for good, it is elementary.
      made[flow] = {{1, {{flow, 1}}}};
      if (!HasComposedBody(flow)) continue;
      looked.insert(flow);
      for (const Product& product : *algebra.BodyOf(*algebra.At(flow).record)) {
        const AtomId part = product.atoms[*PlaceOfFlow(algebra, product)].atom;
        if (!made.contains(part)) open.push_back(part);
      }
    }
  }
}

ProductSum Flows::Replaced(const ProductSum& sum) const {
  ProductSum replaced;
  for (const Product& product : sum) {
    const std::optional<std::size_t> place = PlaceOfFlow(algebra, product);
    const auto found = place ? made.find(product.atoms[*place].atom) : made.end();
    const std::optional<ProductSum> parts =
        found == made.end() ? std::nullopt : algebra.Times({Without(product, *place)}, found->second);
    if (!parts || replaced.size() + parts->size() > Algebra::kMostProducts) {
      replaced.push_back(product);
    } else {
      Append(replaced, *parts);
    }
  }
  Settle(replaced);
  return replaced;
}

ProductSum Flows::Elementary(const ProductSum& sum) {
  for (const Product& product : sum) {
    if (const std::optional<std::size_t> place = PlaceOfFlow(algebra, product)) {
      Compose(product.atoms[*place].atom);
    }
  }
  return Replaced(sum);
}

}  // namespace tessal
