#include "core/edits.h"

#include <algorithm>
#include <string_view>
#include <type_traits>
#include <utility>

namespace tessal {

namespace {

/// What an element takes beside its texts, roughly.
constexpr std::size_t kElementSize = 2048;
constexpr std::size_t kMemberSize = 64;

template <class... Visitors>
struct Overloaded : Visitors... {
  using Visitors::operator()...;
};
template <class... Visitors>
Overloaded(Visitors...) -> Overloaded<Visitors...>;

/// Puts what is away at its place, or takes what is there away.
template <class Away, class Items>
void PutOrTake(Items& items, std::size_t place, std::unique_ptr<Away>& away) {
  const auto position = items.begin() + static_cast<std::ptrdiff_t>(std::min(place, items.size()));
  if (away) {
    items.insert(position, std::move(*std::exchange(away, nullptr)));
  } else if (position != items.end()) {
    away = std::make_unique<Away>(std::move(*position));
    items.erase(position);
  }
}

template <class Element>
void PutOrTakeElement(Sequence<Element>& elements, PresenceEdit& edit) {
  const auto position = elements.begin() + static_cast<std::ptrdiff_t>(std::min(edit.place, elements.size()));
  if (edit.away) {
    elements.insert(position, std::unique_ptr<Element>(static_cast<Element*>(edit.away.release())));
  } else if (position != elements.end()) {
    edit.away = std::move(*position);
    elements.erase(position);
  }
}

class Exchanging final {
 public:
  explicit Exchanging(TemplateState& exchanged) : state(exchanged) {}

  void operator()(ValueEdit& edit) const {
    PropertyValue present = ValueOf(*edit.property);
    SetValue(*edit.property, edit.other);
    edit.other = std::move(present);
  }

  void operator()(PresenceEdit& edit) const {
    const auto exchange = [&edit](auto& elements) { PutOrTakeElement(elements, edit); };
    if (edit.list.kind == ElementKind::ExternalFunction) {
      exchange(state.misc.ExternalFunctionList());
    } else {
      WithList(state.collections, edit.list, exchange);
    }
  }

  void operator()(PlaceEdit& edit) const {
    WithList(state.collections, edit.list,
             [&edit](auto& elements) { MoveWithinSequence(elements, edit.to, edit.from); });
    std::swap(edit.from, edit.to);
  }

  void operator()(GroupTextEdit& edit) const {
    VisibilityGroup& group = Group(edit.group);
    if (edit.level > 0) {
      VisibilityLevel& level = group.levels[static_cast<std::size_t>(edit.level - 1)];
      std::swap(edit.isName ? level.name : level.description, edit.other);
    } else {
      std::swap(edit.isName ? group.name : group.description, edit.other);
    }
  }

  void operator()(GroupEdit& edit) const {
    PutOrTake(Groups(), static_cast<std::size_t>(edit.group - 1), edit.away);
    std::swap(state.groupCounter, edit.otherCounter);
  }

  void operator()(LevelEdit& edit) const {
    PutOrTake(Group(edit.group).levels, static_cast<std::size_t>(edit.level - 1), edit.away);
  }

  void operator()(const MembershipEdit& edit) const {
    auto& items = Group(edit.group).levels[static_cast<std::size_t>(edit.level - 1)].items;
    if (!items.insert(edit.uid).second) items.erase(edit.uid);
  }

  void operator()(TakeOverEdit& edit) const {
    std::swap(Groups(), edit.other->groups);
    std::swap(state.misc.Visibilities().groupsPassedOver, edit.other->groupsPassedOver);
    std::swap(state.account, edit.other->account);
  }

  void operator()(BuiltInsEdit& edit) const { std::swap(state.flags.showAllBuiltIns, edit.other); }

  void operator()(KeptTextEdit& edit) const { std::swap(state.keptText, edit.other); }

 private:
  std::vector<VisibilityGroup>& Groups() const { return state.misc.Visibilities().groups; }
  VisibilityGroup& Group(std::int32_t number) const { return Groups()[static_cast<std::size_t>(number - 1)]; }

  TemplateState& state;
};

std::size_t SizeOfLevel(const VisibilityLevel& level) {
  return sizeof(level) + level.name.size() + level.description.size() + level.items.size() * kMemberSize;
}

std::size_t SizeOfGroup(const VisibilityGroup& group) {
  std::size_t size = sizeof(group) + group.name.size() + group.description.size();
  for (const VisibilityLevel& level : group.levels) size += SizeOfLevel(level);
  return size;
}

std::size_t SizeOfElement(const CEL_Element& element) {
  std::size_t size = kElementSize;
  std::vector<ElementField> fields;
  element.GetFields(fields);
  for (const ElementField& field : fields) size += field.text.size();
  if (const auto* specie = dynamic_cast<const CEL_Lagrange_Specie*>(&element)) {
    specie->ForEachMember([&size](const CEL_Element& member) { size += SizeOfElement(member); });
  }
  return size;
}

/// What a step has changed, gathered for its name.
struct Summary {
  std::vector<const CEL_Element*> created;
  std::vector<const CEL_Element*> deleted;
  std::size_t moves = 0;
  const CEL_Element* moved = nullptr;
  const ValueEdit* renamed = nullptr;
  const ValueEdit* firstValue = nullptr;
  bool isOneValue = true;
  bool isOneElement = true;
  const TemplateEdit* firstOfGroups = nullptr;
  std::size_t memberships = 0;
  bool takesOver = false;
  const BuiltInsEdit* builtIns = nullptr;
  bool changesPools = false;
};

Summary SummaryOf(const std::vector<TemplateEdit>& edits) {
  Summary summary;
  for (const TemplateEdit& edit : edits) {
    std::visit(Overloaded{[&summary](const ValueEdit& value) {
                            const bool isSymbol = value.property == &value.element->symbol;
                            if (isSymbol && summary.renamed == nullptr) summary.renamed = &value;
                            if (summary.firstValue == nullptr) {
                              summary.firstValue = &value;
                              return;
                            }
                            summary.isOneValue = false;
                            if (value.element != summary.firstValue->element) summary.isOneElement = false;
                          },
                          [&summary](const PresenceEdit& presence) {
                            (presence.away ? summary.deleted : summary.created).push_back(presence.element);
                          },
                          [&summary](const PlaceEdit& place) {
                            ++summary.moves;
                            summary.moved = place.element;
                          },
                          [&summary](const TakeOverEdit&) { summary.takesOver = true; },
                          [&summary](const BuiltInsEdit& switched) { summary.builtIns = &switched; },
                          [&summary](const KeptTextEdit&) { summary.changesPools = true; },
                          [&summary, &edit](const auto& ofGroups) {
                            using Kind = std::decay_t<decltype(ofGroups)>;
                            if (summary.firstOfGroups == nullptr) summary.firstOfGroups = &edit;
                            if (std::is_same_v<Kind, MembershipEdit>) ++summary.memberships;
                          }},
               edit);
  }
  return summary;
}

std::string NameOf(const CEL_Element& element) {
  const std::string symbol = element.FullSymbol();
  return symbol.empty() ? std::string(element.KindText()) : symbol;
}

std::string OneOrCount(std::string_view verb, const std::vector<const CEL_Element*>& elements) {
  if (elements.size() == 1) return std::string(verb) + ' ' + NameOf(*elements.front());
  return std::string(verb) + ' ' + std::to_string(elements.size()) + " elements";
}

/// The name of a step about visibility groups.
class GroupNaming final {
 public:
  GroupNaming(const TemplateState& named, std::size_t membershipCount)
      : state(named), memberships(membershipCount) {}

  std::string operator()(const GroupTextEdit& edit) const {
    const std::string present = edit.level > 0 ? Level(edit.group, edit.level) : Group(edit.group);
    if (edit.isName) return "Rename " + edit.other + " to " + present;
    return "Change description of " + present;
  }
  std::string operator()(const GroupEdit& edit) const {
    return edit.away ? "Delete group " + edit.away->name : "Create group " + Group(edit.group);
  }
  std::string operator()(const LevelEdit& edit) const {
    return edit.away ? "Delete level " + edit.away->name : "Create level " + Level(edit.group, edit.level);
  }
  std::string operator()(const MembershipEdit& edit) const {
    const std::string level = Level(edit.group, edit.level);
    if (memberships > 1) return "Change " + std::to_string(memberships) + " memberships of " + level;
    return "Change a membership of " + level;
  }
  std::string operator()(const auto& /*other*/) const { return "Edit groups"; }

 private:
  const VisibilityGroup* Find(std::int32_t group) const {
    const auto& groups = state.misc.Visibilities().groups;
    const auto place = static_cast<std::size_t>(group - 1);
    return place < groups.size() ? &groups[place] : nullptr;
  }
  std::string Group(std::int32_t group) const {
    const VisibilityGroup* found = Find(group);
    return found == nullptr ? std::string() : found->name;
  }
  std::string Level(std::int32_t group, std::int32_t level) const {
    const VisibilityGroup* found = Find(group);
    const auto place = static_cast<std::size_t>(level - 1);
    return found != nullptr && place < found->levels.size() ? found->levels[place].name : std::string();
  }

  const TemplateState& state;
  std::size_t memberships;
};

std::string NameOfValues(const Summary& summary) {
  const ValueEdit& value = *summary.firstValue;
  if (summary.renamed != nullptr) {
    const auto* former = std::get_if<std::string>(&summary.renamed->other);
    return "Rename " + (former == nullptr ? std::string() : *former) + " to " +
           summary.renamed->element->symbol.TextOf();
  }
  const std::string name = NameOf(*value.element);
  if (summary.isOneValue) {
    const std::string_view label = value.element->LabelOf(*value.property);
    return "Change " + std::string(label) + " of " + name;
  }
  return summary.isOneElement ? "Edit " + name : "Edit " + name + " and others";
}

}  // namespace

PropertyValue ValueOf(const CEL_Property& property) {
  switch (property.Type()) {
    case ValueType::Real:
      return property.RealValue();
    case ValueType::Integer:
      return property.IntValue();
    case ValueType::Boolean:
      return property.BoolValue();
    default:
      return std::string(property.Text());
  }
}

void SetValue(CEL_Property& property, const PropertyValue& value) {
  std::visit(Overloaded{[&property](double number) { property.SetReal(number); },
                        [&property](std::int32_t number) { property.SetInt(number); },
                        [&property](bool truth) { property.SetBool(truth); },
                        [&property](const std::string& text) { property.SetText(text); }},
             value);
}

void Exchange(TemplateState& state, TemplateEdit& edit) {
  std::visit(Exchanging(state), edit);
}

std::size_t SizeOf(const TemplateEdit& edit) {
  const auto own = [](const auto& each) -> std::size_t {
    using Kind = std::decay_t<decltype(each)>;
    if constexpr (std::is_same_v<Kind, ValueEdit>) {
      const auto* text = std::get_if<std::string>(&each.other);
      return text == nullptr ? 0 : text->size();
    } else if constexpr (std::is_same_v<Kind, PresenceEdit>) {
      return each.away ? SizeOfElement(*each.away) : 0;
    } else if constexpr (std::is_same_v<Kind, GroupTextEdit> || std::is_same_v<Kind, KeptTextEdit>) {
      return each.other.size();
    } else if constexpr (std::is_same_v<Kind, GroupEdit>) {
      return each.away ? SizeOfGroup(*each.away) : 0;
    } else if constexpr (std::is_same_v<Kind, LevelEdit>) {
      return each.away ? SizeOfLevel(*each.away) : 0;
    } else if constexpr (std::is_same_v<Kind, TakeOverEdit>) {
      std::size_t size = sizeof(TakenOver);
      for (const VisibilityGroup& group : each.other->groups) size += SizeOfGroup(group);
      return size;
    } else {
      return 0;
    }
  };
  return sizeof(TemplateEdit) + std::visit(own, edit);
}

std::string NameOfStep(const TemplateState& state, const std::vector<TemplateEdit>& edits) {
  const Summary summary = SummaryOf(edits);
  if (summary.takesOver) return "Take over what was not read";
  if (!summary.created.empty()) return OneOrCount("Create", summary.created);
  if (!summary.deleted.empty()) return OneOrCount("Delete", summary.deleted);
  if (summary.moves == 1 && summary.moved != nullptr) return "Move " + NameOf(*summary.moved);
  if (summary.moves > 0) return "Move elements";
  if (summary.builtIns != nullptr) {
    return summary.builtIns->other ? "Hide deprecated built-ins" : "Show all built-ins";
  }
  if (summary.firstOfGroups != nullptr)
    return std::visit(GroupNaming(state, summary.memberships), *summary.firstOfGroups);
  if (summary.firstValue != nullptr) return NameOfValues(summary);
  return summary.changesPools ? "Change the pools" : "";
}

Uid SubjectOfStep(const std::vector<TemplateEdit>& edits) {
  Uid subject = Uid::None;
  for (const TemplateEdit& edit : edits) {
    if (const auto* presence = std::get_if<PresenceEdit>(&edit)) return presence->element->GetUid();
    if (const auto* place = std::get_if<PlaceEdit>(&edit)) return place->element->GetUid();
    const auto* value = std::get_if<ValueEdit>(&edit);
    if (value == nullptr) continue;
    // What is renamed comes before what mentions it.
    if (value->property == &value->element->symbol) return value->element->GetUid();
    if (subject == Uid::None) subject = value->element->GetUid();
  }
  return subject;
}

}  // namespace tessal
