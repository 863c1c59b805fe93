// Making elements for names that expressions use and nobody has defined, and at a user's request.
#pragma once

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
  bool placed = false;          ///< moved ahead of its users, behind the predecessor
  Uid predecessor = Uid::None;  ///< identity of the element before it, 0 for the first place
};

/// How the offer to create undefined symbols asks. The editor shows boxes; the tool and the tests answer.
class CreationQuestions {
 public:
  virtual ~CreationQuestions() = default;

  /// Asks with Yes and No.
  virtual bool AskYesNo(const std::string& question) = 0;
  /// Lets the user choose one of the kinds that the mask offers (bit n for index n); -1 when declined.
  virtual int ChooseKind(const std::string& symbol, std::uint32_t mask) = 0;
  /// Makes the element, and shows it where elements are shown.
  virtual void Create(const CreateRequest& request) = 0;

 protected:
  CreationQuestions() = default;
  CreationQuestions(const CreationQuestions&) = default;
  CreationQuestions& operator=(const CreationQuestions&) = default;
};

}  // namespace tessal
