// Checked access to the ordered sequences of elements.
#pragma once

#include <cstddef>
#include <memory>
#include <stdexcept>
#include <vector>

namespace tessal {

/// An ordered sequence of owned elements. Its order is the order of declaration.
template <class Element>
using Sequence = std::vector<std::unique_ptr<Element>>;

/// The failure of every access beyond a sequence. The guards of load and save catch it.
inline std::out_of_range SubscriptFailure() {
  return std::out_of_range("invalid vector<T> subscript");
}

/// The element at a place from 0; raises the subscript failure when there is none.
template <class Element>
Element& At(const Sequence<Element>& sequence, std::size_t index) {
  if (index >= sequence.size()) throw SubscriptFailure();
  return *sequence[index];
}

}  // namespace tessal
