// The edits of a template as values. Each holds what it takes to go from one of two states to the other, and
// can do so again and again: what was removed lies in the edit, what is there lies in the template.
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <variant>
#include <vector>

#include "core/collections.h"
#include "core/template_state.h"

namespace tessal {

/// A value of a property of any type.
using PropertyValue = std::variant<double, std::int32_t, bool, std::string>;

PropertyValue ValueOf(const CEL_Property& property);
/// Gives a property a value of its own type.
void SetValue(CEL_Property& property, const PropertyValue& value);

/// A property has another value.
struct ValueEdit {
  CEL_Element* element;
  CEL_Property* property;
  PropertyValue other;  ///< the value of the other state
};

/// An element has come into a list, or has gone from it.
struct PresenceEdit {
  ListPlace list;
  std::size_t place;
  CEL_Element* element;
  std::unique_ptr<CEL_Element> away;  ///< the same element while it is out of the template
};

/// An element has another place in its list.
struct PlaceEdit {
  ListPlace list;
  std::size_t from;
  std::size_t to;
  CEL_Element* element;
};

/// The name or the description of a visibility group, or of one of its levels.
struct GroupTextEdit {
  std::int32_t group;  ///< from 1, as the level
  std::int32_t level;  ///< 0 for the group's own
  bool isName;
  std::string other;
};

/// A visibility group, or a level of one, has come or gone.
struct GroupEdit {
  std::int32_t group;
  std::unique_ptr<VisibilityGroup> away;
  std::uint32_t otherCounter;  ///< of the names of new groups
};
struct LevelEdit {
  std::int32_t group;
  std::int32_t level;
  std::unique_ptr<VisibilityLevel> away;
};

/// An element has come into a level, or has left it.
struct MembershipEdit {
  std::int32_t group;
  std::int32_t level;
  Uid uid;
};

/// What the load had passed over was taken over.
struct TakenOver {
  std::vector<VisibilityGroup> groups;
  std::vector<VisibilityGroup> groupsPassedOver;
  LoadAccount account;
};
struct TakeOverEdit {
  std::unique_ptr<TakenOver> other;
};

/// Whether the choices of inputs show all built-ins.
struct BuiltInsEdit {
  bool other;
};

/// What the file holds beside the template is another text.
struct KeptTextEdit {
  std::string other;
};

using TemplateEdit = std::variant<ValueEdit, PresenceEdit, PlaceEdit, GroupTextEdit, GroupEdit, LevelEdit,
                                  MembershipEdit, TakeOverEdit, BuiltInsEdit, KeptTextEdit>;

/// Takes the template from the present one of the edit's states to the other. Nobody hears of it, and what
/// follows from the change is the caller's to bring up to date.
void Exchange(TemplateState& state, TemplateEdit& edit);

/// How much memory an edit holds, in bytes and roughly.
std::size_t SizeOf(const TemplateEdit& edit);

/// The name of a step that has no name of its own, from what it has changed: "Rename k1 to kd". The edits are
/// as after the step.
std::string NameOfStep(const TemplateState& state, const std::vector<TemplateEdit>& edits);

/// The element that a step is about; none for one about groups.
Uid SubjectOfStep(const std::vector<TemplateEdit>& edits);

}  // namespace tessal
