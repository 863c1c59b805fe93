// Making elements for names that expressions use and nobody has defined, and at a user's request.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <string>

#include "elements/element_kind.h"
#include "platform/uid.h"

namespace tessal {

/// What is to be made.
struct CreateRequest {
  std::string symbol;                    ///< empty: the element keeps its default name and has no texts
  ElementKind kind = ElementKind::None;  ///< one of those from StateVariable to HorizontalVector
  Uid ownerId = Uid::None;  ///< for kinds 8 to 13 the identity of the list head in the particle class
};

/// A new element and its place among its siblings.
struct CreatedElement {
  Uid uid = Uid::None;          ///< 0 when nothing was made
  bool placed = false;          ///< moved before its users, after the predecessor
  Uid predecessor = Uid::None;  ///< identity of the element before it, 0 for the first place
};

/// The question about a name that expressions use and nobody has defined. Whoever asks it hands the request
/// of the answer to the template, and then asks the template for the next offer.
struct CreationOffer {
  static constexpr std::size_t kChoiceCount = 9;

  std::string symbol;
  std::string question;                              ///< with Yes and No for answers
  std::uint32_t mask = 0;                            ///< bit n offers choice n
  std::array<CreateRequest, kChoiceCount> requests;  ///< what each choice makes

  /// What the choice with an index makes; none for an index that is no choice, such as the -1 of a dialog
  /// that was skipped.
  const CreateRequest* RequestOf(int choice) const;
};

}  // namespace tessal
