#include "core/merge_values.h"

#include <algorithm>
#include <cmath>
#include <utility>
#include <variant>

#include "core/template_core.h"

namespace tessal {

namespace {

/// Versions count what wrote a file, as the revision counts its saves: the later one is right.
bool IsStamp(std::string_view label) {
  return label == "Revision" || label.ends_with(" version");
}

PropertyValue Renamed(const MergeSide& side, const CEL_Property& property) {
  if (property.Type() == ValueType::Expression && !side.names.empty())
    return ReplaceNames(property.Text(), side.names);
  return ValueOf(property);
}

bool AreSame(const PropertyValue& one, const PropertyValue& other) {
  const auto* real = std::get_if<double>(&one);
  const auto* otherReal = std::get_if<double>(&other);
  if (real != nullptr && otherReal != nullptr && std::isnan(*real)) return std::isnan(*otherReal);
  return one == other;
}

std::string Shown(const PropertyValue& value, const CEL_Property& like) {
  CEL_Property shown(like.Type());
  SetValue(shown, value);
  return shown.TextOf();
}

}  // namespace

MergedText MergeTexts(const std::string& base, const std::string& ours, const std::string& theirs) {
  if (ours == theirs || theirs == base) return {ours, false};
  if (ours == base) return {theirs, false};
  return {ours, true};
}

void ValueMerge::Merge(const CEL_Element* former, CEL_Element& into, const CEL_Element& from,
                       const std::string& name, LinksToSet& links) const {
  const NotificationsOff silent;
  bool isTouched = false;
  const bool isSearch = into.Kind() == ElementKind::SpatialFunction;
  for (const auto& [label, place] : into.Values()) {
    CEL_Property& present = into.*place;
    const PropertyValue our = ValueOf(present);
    const PropertyValue their = Renamed(theirs, from.*place);
    if (AreSame(our, their) || (isSearch && IsLink(label))) continue;
    if (IsStamp(label)) {
      SetValue(present, std::max(our, their));
      continue;
    }
    if (FollowsFromPlace(label)) continue;
    const bool isKnown = former != nullptr;
    const PropertyValue before = isKnown ? Renamed(base, former->*place) : our;
    if (isKnown && AreSame(before, their)) continue;
    if (isKnown && AreSame(before, our)) {
      SetValue(present, their);
      isTouched = true;
      continue;
    }
    conflicts.push_back(
        {std::string(into.KindText()), name, std::string(label), Shown(our, present), Shown(their, present)});
  }
  if (isTouched) into.FollowValues();
  if (!isSearch) return;
  static const NewNames kAsTheyAre;
  const SearchLink our = LinkOfSearch(ours, into, kAsTheyAre);
  const SearchLink their = LinkOfSearch(theirs.core, from, theirs.names);
  const SearchLink before = former == nullptr ? our : LinkOfSearch(base.core, *former, base.names);
  SearchLink& link = links[&into];
  const auto merge = [this, &link, &our, &their, &before, &into, &name, former](std::string SearchLink::*part,
                                                                                std::string_view label) {
    MergedText merged = MergeTexts(before.*part, our.*part, their.*part);
    if (former == nullptr) merged = {our.*part, our.*part != their.*part};
    link.*part = merged.text;
    if (merged.isConflict)
      conflicts.push_back({std::string(into.KindText()), name, std::string(label), our.*part, their.*part});
  };
  merge(&SearchLink::variable, "Variable ID");
  merge(&SearchLink::specie, "Lookfor");
}

void ValueMerge::Take(CEL_Element& made, const CEL_Element& from, LinksToSet& links) const {
  const NotificationsOff silent;
  made.TakeValuesOf(from);
  made.ForEachExpression([this](const PropertyRow&, CEL_Property& expression) {
    expression.SetText(ReplaceNames(expression.Text(), theirs.names));
  });
  if (made.Kind() == ElementKind::SpatialFunction)
    links.insert_or_assign(&made, LinkOfSearch(theirs.core, from, theirs.names));
}

bool ValueMerge::WeChanged(const CEL_Element& former, const CEL_Element& present) const {
  static const NewNames kAsTheyAre;
  return ContentOf(base.core, former, base.names) != ContentOf(ours, present, kAsTheyAre);
}

bool ValueMerge::TheyChanged(const CEL_Element& former, const CEL_Element& present) const {
  return former.Kind() != present.Kind() ||
         ContentOf(base.core, former, base.names) != ContentOf(theirs.core, present, theirs.names);
}

std::string ValueMerge::Text(const MergeSide& side, const CEL_Element& element,
                             const ElementValue& value) const {
  const CEL_Property& property = element.*value.place;
  if (element.Kind() == ElementKind::SpatialFunction && IsLink(value.label)) {
    const SearchLink link = LinkOfSearch(side.core, element, side.names);
    return value.label == "Lookfor" ? link.specie : link.variable;
  }
  return Shown(Renamed(side, property), property);
}

void ValueMerge::NoteTheirs(const CEL_Element* former, const CEL_Element& from, const std::string& name,
                            std::string_view oursValue) const {
  const std::string kind(from.KindText());
  const std::size_t before = conflicts.size();
  const bool isSameClass = former != nullptr && former->Kind() == from.Kind();
  for (const ElementValue& value : from.Values()) {
    if (FollowsFromPlace(value.label)) continue;
    std::string their = Text(theirs, from, value);
    if (isSameClass ? their == Text(base, *former, value) : their.empty()) continue;
    conflicts.push_back({kind, name, std::string(value.label), std::string(oursValue), std::move(their)});
  }
  if (conflicts.size() == before)
    conflicts.push_back({kind, name, "", std::string(oursValue), std::string(kKeptValue)});
}

}  // namespace tessal
