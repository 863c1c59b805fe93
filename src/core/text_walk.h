// Every text that people write into a template, with its place: symbols, descriptions, units, expressions,
// settings, user functions, and the names and descriptions of visibility groups. Searches and replacements
// are loops over them.
#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>
#include <unordered_map>

#include "elements/element_kind.h"
#include "platform/uid.h"

namespace tessal {

class CEL_Element;
class CEL_Property;
class TemplateCore;

/// A symbol has uses that only a rename takes along.
enum class TextRole : std::uint8_t { Symbol, Expression, Text };

/// The fields of a visibility group or level.
inline constexpr std::string_view kNameField = "Name";
inline constexpr std::string_view kDescriptionField = "Description";

/// Where a text is, for as long as its element or group is there.
struct TextPlace {
  Uid element = Uid::None;  ///< none for the texts of visibility groups
  std::string_view field;   ///< its label
  std::int32_t group = 0;   ///< the number, from 1, of the visibility group
  std::int32_t level = 0;   ///< and of its level; 0 for the group itself
  bool operator==(const TextPlace&) const = default;
};

struct TextOfTemplate {
  TextPlace place;
  TextRole role = TextRole::Text;
  ElementKind kind = ElementKind::None;
  const CEL_Element* element = nullptr;  ///< none in a visibility group
  std::string_view text;                 ///< its bytes, good until the next change
  bool isLocked = false;                 ///< the editor does not let it be changed
};

/// Calls the visitor with each text, in the order of the template: the root, each collection after the texts
/// of its list, the settings with their functions and groups, and the particle classes.
void ForEachText(const TemplateCore& core, const std::function<void(const TextOfTemplate&)>& visit);

/// What people call the owner of a text: the symbol of an element, the caption of a list, the name of a
/// group; of a level the names of its group and of itself.
std::string OwnerName(const TemplateCore& core, const TextOfTemplate& text);

/// The texts of a template by their places. Made in one walk; good until elements come or go.
class TextsByPlace final {
 public:
  explicit TextsByPlace(TemplateCore& indexed);

  /// The property of a place; none for a place in a visibility group, or when there is no such.
  CEL_Property* PropertyAt(const TextPlace& place) const;
  /// The bytes at a place; empty when it is gone.
  std::string TextAt(const TextPlace& place) const;
  /// Sets a text by the setters that a form uses. False, and nothing changes, when the place is gone, or when
  /// a group or level may not have that name.
  bool SetText(const TextPlace& place, std::string_view text);

 private:
  TemplateCore& core;
  std::unordered_map<Uid, CEL_Element*> elements;
};

}  // namespace tessal
