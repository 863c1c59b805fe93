#include "core/matching.h"

#include <algorithm>
#include <utility>

#include "core/template_core.h"

namespace tessal {

namespace {

using Elements = std::vector<const CEL_Element*>;

Elements AllOf(const TemplateCore& core) {
  const std::vector<CEL_Element*> elements = ElementsOf(core);
  return {elements.begin(), elements.end()};
}

/// Whether an element's expressions use the record of that number. The two records of a movement are side by
/// side.
bool Uses(const TemplateCore& core, const CEL_Element& user, std::uint32_t used) {
  const SymbolRecord* first = core.RecordOfElement(user);
  for (std::uint32_t sequence = first->sequence; sequence <= core.SymbolTable().size(); ++sequence) {
    const SymbolRecord* record = core.FindRecordBySequence(sequence);
    if (record->element != &user) return false;
    if (std::find(record->references.begin(), record->references.end(), used) != record->references.end())
      return true;
  }
  return false;
}

std::string NewNameOf(const std::string& name, const NewNames& newNames) {
  const auto found = newNames.find(name);
  return found == newNames.end() ? name : found->second;
}

/// The matching of two templates.
class Matching final {
 public:
  Matching(const TemplateCore& formerCore, const TemplateCore& laterCore)
      : former(formerCore),
        later(laterCore),
        formerElements(AllOf(former)),
        laterElements(AllOf(later)),
        formerClasses(ClassesOf(former)),
        laterClasses(ClassesOf(later)) {}

  ElementMatch Take() {
    // The classes come first: what belongs to which list depends on them.
    MatchBySymbol();
    while (MatchRenamed() || MatchByUsers()) continue;
    MatchUnnamed();
    return std::move(match);
  }

 private:
  using Groups = std::unordered_map<std::string, Elements>;

  void Pair(const CEL_Element& one, const CEL_Element& other) {
    match.later.emplace(&one, &other);
    match.former.emplace(&other, &one);
  }

  bool IsLeft(const CEL_Element& element) const {
    return !match.later.contains(&element) && !match.former.contains(&element);
  }

  /// Matches the elements of equal keys in their order.
  template <class FormerKey, class LaterKey>
  void MatchByKey(bool withCaptions, FormerKey formerKey, LaterKey laterKey) {
    Groups groups;
    const auto takesPart = [this, withCaptions](const CEL_Element& element) {
      return HasCaption(element) == withCaptions && IsLeft(element);
    };
    // The view that reverses a range is none that Clang 14 compiles.
    // NOLINTNEXTLINE(modernize-loop-convert)
    for (auto element = formerElements.rbegin(); element != formerElements.rend(); ++element) {
      // From the end, so that the first of a key is taken first.
      if (takesPart(**element)) groups[formerKey(**element)].push_back(*element);
    }
    for (const CEL_Element* element : laterElements) {
      if (!takesPart(*element)) continue;
      const auto group = groups.find(laterKey(*element));
      if (group == groups.end() || group->second.empty()) continue;
      Pair(*group->second.back(), *element);
      group->second.pop_back();
    }
  }

  void MatchBySymbol() {
    const auto symbol = [](const CEL_Element& element) { return element.symbol.TextOf(); };
    MatchByKey(false, symbol, symbol);
  }

  /// The list that an element is in, in words of the later template.
  std::string FormerList(const CEL_Element& element) const {
    const auto specie = formerClasses.find(&element);
    if (specie == formerClasses.end()) return ListText(element, "");
    const auto partner = match.later.find(specie->second);
    // A class that is no more has no list in the later template.
    return ListText(element, partner == match.later.end() ? "-" : partner->second->symbol.TextOf());
  }
  std::string LaterList(const CEL_Element& element) const {
    const auto specie = laterClasses.find(&element);
    return ListText(element, specie == laterClasses.end() ? "" : specie->second->symbol.TextOf());
  }
  static std::string ListText(const CEL_Element& element, const std::string& specie) {
    return std::to_string(NumberOf(element.Kind())) + '\n' + specie + '\n';
  }

  std::string FormerContent(const CEL_Element& element) const {
    return FormerList(element) + ContentOf(former, element, match.renamed);
  }
  std::string LaterContent(const CEL_Element& element) const {
    static const NewNames kAsItIs;
    return LaterList(element) + ContentOf(later, element, kAsItIs);
  }

  void MatchUnnamed() {
    MatchByKey(
        true, [this](const CEL_Element& element) { return FormerContent(element); },
        [this](const CEL_Element& element) { return LaterContent(element); });
    MatchByKey(
        true, [this](const CEL_Element& element) { return FormerList(element); },
        [this](const CEL_Element& element) { return LaterList(element); });
  }

  /// Whether a user of the former element that is still there uses the later one; true without such users.
  bool UsersFollow(const CEL_Element& one, const CEL_Element& other) const {
    bool hasUsers = false;
    const SymbolRecord* used = former.RecordOfElement(one);
    const SymbolRecord* laterUsed = later.RecordOfElement(other);
    for (const std::uint32_t user : used->referencedBy) {
      const auto partner = match.later.find(former.FindRecordBySequence(user)->element);
      if (partner == match.later.end()) continue;
      hasUsers = true;
      if (Uses(later, *partner->second, laterUsed->sequence)) return true;
    }
    return !hasUsers;
  }

  /// Matches those of the same content; whether there were any. Each may be what another one waits for.
  bool MatchRenamed() {
    Groups groups;
    Groups laterGroups;
    const auto takesPart = [this](const CEL_Element& element) {
      return !HasCaption(element) && IsLeft(element);
    };
    for (const CEL_Element* element : formerElements) {
      if (takesPart(*element)) groups[FormerContent(*element)].push_back(element);
    }
    if (groups.empty()) return false;
    for (const CEL_Element* element : laterElements) {
      if (takesPart(*element)) laterGroups[LaterContent(*element)].push_back(element);
    }
    bool found = false;
    for (const auto& [content, elements] : groups) {
      const auto candidates = laterGroups.find(content);
      if (candidates != laterGroups.end()) found = MatchFollowed(elements, candidates->second) || found;
    }
    return found;
  }

  /// Matches the former elements that have exactly one follower with it.
  bool MatchFollowed(const Elements& elements, const Elements& candidates) {
    // Many of one content are no evidence, and comparing each with each is expensive.
    constexpr std::size_t kMost = 64;
    if (elements.size() > kMost || candidates.size() > kMost) return false;
    const auto followers = [this](const CEL_Element* one, const Elements& others, bool isFormer) {
      Elements followed;
      for (const CEL_Element* other : others) {
        if (isFormer ? UsersFollow(*one, *other) : UsersFollow(*other, *one)) followed.push_back(other);
      }
      return followed;
    };
    bool found = false;
    for (const CEL_Element* element : elements) {
      const Elements forward = followers(element, candidates, true);
      if (forward.size() != 1 || followers(forward.front(), elements, false).size() != 1) continue;
      if (!IsLeft(*forward.front())) continue;
      Pair(*element, *forward.front());
      match.renamed.insert_or_assign(element->symbol.TextOf(), forward.front()->symbol.TextOf());
      found = true;
    }
    return found;
  }

  /// Matches those that a user has exchanged for each other and is the same otherwise, whatever their
  /// content.
  bool MatchByUsers() {
    bool found = false;
    for (const CEL_Element* element : formerElements) {
      if (HasCaption(*element) || !IsLeft(*element)) continue;
      for (const std::uint32_t user : former.RecordOfElement(*element)->referencedBy) {
        const CEL_Element* userElement = former.FindRecordBySequence(user)->element;
        const auto partner = match.later.find(userElement);
        if (partner == match.later.end()) continue;
        const CEL_Element* follower = FollowerIn(*element, *userElement, *partner->second);
        if (follower == nullptr) continue;
        Pair(*element, *follower);
        match.renamed.insert_or_assign(element->symbol.TextOf(), follower->symbol.TextOf());
        found = true;
        break;
      }
    }
    return found;
  }

  /// What the later state of a user uses in the place of an element; none where that is no exchange of names.
  const CEL_Element* FollowerIn(const CEL_Element& element, const CEL_Element& user,
                                const CEL_Element& laterUser) const {
    if (user.Kind() != laterUser.Kind()) return nullptr;
    const SymbolRecord* record = later.RecordOfElement(laterUser);
    for (const std::uint32_t used : record->references) {
      const CEL_Element* candidate = later.FindRecordBySequence(used)->element;
      if (!IsLeft(*candidate) || FormerList(element) != LaterList(*candidate)) continue;
      NewNames names = match.renamed;
      names.insert_or_assign(element.symbol.TextOf(), candidate->symbol.TextOf());
      bool isSame = true;
      user.ForEachExpression([&](const PropertyRow& row, const CEL_Property& expression) {
        isSame = isSame && ReplaceNames(expression.Text(), names) == (laterUser.*row.place).Text();
      });
      if (isSame) return candidate;
    }
    return nullptr;
  }

  const TemplateCore& former;
  const TemplateCore& later;
  Elements formerElements;
  Elements laterElements;
  ClassesOfMembers formerClasses;
  ClassesOfMembers laterClasses;
  ElementMatch match;
};

}  // namespace

bool HasCaption(const CEL_Element& element) {
  return element.Kind() == ElementKind::DerivedOutput || element.Kind() == ElementKind::HorizontalVector ||
         element.Kind() == ElementKind::VerticalEquation;
}

bool FollowsFromPlace(std::string_view label) {
  return label == "Specie ID" || label == "Specie" || label == "Revision";
}

bool IsLink(std::string_view label) {
  return label == "Variable ID" || label == "Lookfor";
}

std::vector<CEL_Element*> ElementsOf(const TemplateCore& core) {
  std::vector<CEL_Element*> elements;
  // The two records of a movement are side by side.
  for (const SymbolRecord& record : core.SymbolTable()) {
    if (elements.empty() || elements.back() != record.element) elements.push_back(record.element);
  }
  return elements;
}

ClassesOfMembers ClassesOf(const TemplateCore& core) {
  ClassesOfMembers classes;
  for (const auto& specie : core.Species()) {
    specie->ForEachMember(
        [&classes, &specie](const CEL_Element& member) { classes.emplace(&member, specie.get()); });
  }
  return classes;
}

SearchLink LinkOfSearch(const TemplateCore& core, const CEL_Element& search, const NewNames& newNames) {
  const auto& function = static_cast<const CEL_Lagrange_Spatial_Function&>(search);
  SearchLink link;
  const std::int32_t number = function.variableId.IntValue();
  const CEL_Element* variable =
      number < 1 ? nullptr : core.GetElementBySequence(static_cast<std::uint32_t>(number));
  link.variable =
      variable == nullptr ? std::to_string(number) : NewNameOf(variable->symbol.TextOf(), newNames);
  const std::int32_t sought = function.lookFor.IntValue();
  const bool isClass = sought >= 1 && static_cast<std::size_t>(sought) <= core.GetSpecieCount();
  link.specie =
      isClass ? NewNameOf(core.GetSpecie(static_cast<std::size_t>(sought - 1)).symbol.TextOf(), newNames)
              : std::to_string(sought);
  return link;
}

std::string ContentOf(const TemplateCore& core, const CEL_Element& element, const NewNames& newNames) {
  const bool isSearch = element.Kind() == ElementKind::SpatialFunction;
  std::string content;
  for (const auto& [label, place] : element.Values()) {
    const CEL_Property& property = element.*place;
    if (property.Type() == ValueType::Expression && !newNames.empty()) {
      content += ReplaceNames(property.Text(), newNames);
    } else if (!FollowsFromPlace(label) && !(isSearch && IsLink(label))) {
      content += property.TextOf();
    }
    content += '\n';
  }
  if (isSearch) {
    const SearchLink link = LinkOfSearch(core, element, newNames);
    content += link.variable + '\n' + link.specie;
  }
  if (element.Kind() == ElementKind::Specie) {
    static_cast<const CEL_Lagrange_Specie&>(element).ForEachMember(
        [&content, &newNames](const CEL_Element& member) {
          if (!HasCaption(member)) content += NewNameOf(member.symbol.TextOf(), newNames) + '\n';
        });
  }
  return content;
}

ElementMatch MatchElements(const TemplateCore& former, const TemplateCore& later) {
  return Matching(former, later).Take();
}

}  // namespace tessal
