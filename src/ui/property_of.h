// The property of an element as the tables of forms and lists name it.
#pragma once

#include "elements/element.h"

namespace tessal {

template <class Owner>
Owner OwnerOfMember(CEL_Property Owner::*);

/// A member of an element's class, of an element that is known to be of that class.
template <auto Member>
CEL_Property& Of(CEL_Element& element) {
  using Owner = decltype(OwnerOfMember(Member));
  return static_cast<Owner&>(element).*Member;
}

}  // namespace tessal
