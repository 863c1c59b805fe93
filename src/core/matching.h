// Which elements of a template are which of another state of it: by their symbols, and those that were
// renamed by their content.
#pragma once

#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "core/rename.h"

namespace tessal {

class CEL_Element;
class CEL_Lagrange_Specie;
class TemplateCore;

/// The elements with a record, in the order of the template, each once.
std::vector<CEL_Element*> ElementsOf(const TemplateCore& core);

/// The particle class of each element that belongs to one; the class itself is none of them.
using ClassesOfMembers = std::unordered_map<const CEL_Element*, const CEL_Lagrange_Specie*>;
ClassesOfMembers ClassesOf(const TemplateCore& core);

/// Whether its symbol is a caption that the place gives, not a name: derived outputs and movements.
bool HasCaption(const CEL_Element& element);

/// Whether a value with this label is a number that follows from places, or the count of saves.
bool FollowsFromPlace(std::string_view label);
/// Whether it is one of the two numbers by which a search names what it looks at.
bool IsLink(std::string_view label);

/// What a search looks at, by names. A number that is nobody's is left as a number.
struct SearchLink {
  std::string variable;
  std::string specie;
  bool operator==(const SearchLink&) const = default;
};
/// The names of others are the new ones.
SearchLink LinkOfSearch(const TemplateCore& core, const CEL_Element& search, const NewNames& newNames);

/// All that an element holds but its symbol and the numbers that follow from places, as one text in which
/// the names of others are the new ones.
std::string ContentOf(const TemplateCore& core, const CEL_Element& element, const NewNames& newNames);

struct ElementMatch {
  std::unordered_map<const CEL_Element*, const CEL_Element*> later;   ///< by the former element
  std::unordered_map<const CEL_Element*, const CEL_Element*> former;  ///< by the later one
  NewNames renamed;  ///< the later symbols by the former ones
};

/// Matches the elements of a template with those of a later state of it. Several of one symbol are matched in
/// their order. One counts as renamed where exactly one of the later ones that are left has its content, with
/// the names of others rewritten, and is used by one of its users, if it has any; or where one of its users
/// differs from its later state in this name alone. Elements without a name are matched by content, what is
/// left of them in their order.
ElementMatch MatchElements(const TemplateCore& former, const TemplateCore& later);

}  // namespace tessal
