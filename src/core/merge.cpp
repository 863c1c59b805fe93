#include "core/merge.h"

#include <algorithm>
#include <cassert>
#include <memory>
#include <set>
#include <unordered_map>
#include <utility>

#include "core/error_registry.h"
#include "core/merge_functions.h"
#include "core/merge_groups.h"
#include "core/merge_kept_text.h"
#include "core/merge_nodes.h"
#include "core/merge_order.h"
#include "core/search_functions.h"
#include "core/template_core.h"
#include "core/visibility_groups.h"
#include "expr/scanner.h"
#include "platform/kvf_number.h"

namespace tessal {

namespace {

/// Who uses which name that nobody has defined.
using UndefinedUses = std::set<std::pair<std::string, const MergeNode*>>;

UndefinedUses UndefinedUsesOf(const TemplateCore& core, const MergeNodes& nodes) {
  UndefinedUses uses;
  for (const auto& undefined : core.UndefinedSymbols()) {
    for (const Uid uid : undefined->usedBy)
      uses.emplace(undefined->symbol, nodes.Of(core.FindRecordByUid(uid)->element));
  }
  return uses;
}

/// The merge of one template.
class Merging final {
 public:
  Merging(TemplateCore& oursCore, TemplateState& oursState, const TemplateCore& baseCore,
          const TemplateCore& theirsCore)
      : ours(oursCore),
        state(oursState),
        base(baseCore),
        theirs(theirsCore),
        nodes(oursCore, baseCore, theirsCore),
        values(oursCore, nodes.Base(), nodes.Theirs(), conflicts) {}

  std::vector<MergeConflict> Run() {
    nodes.SettleNames(conflicts);
    const UndefinedUses undefinedHere = UndefinedUsesOf(ours, nodes);
    std::set<UseOfNodes> early = EarlyUses(ours, nodes);
    early.merge(EarlyUses(theirs, nodes));
    MergeSettings();
    MergeHeads();
    {
      const RebuildsOff later(state.flags);
      MergeClasses();
      for (MergeNode& node : nodes.All()) MergeElement(node);
      SettleClasses();
    }
    ours.RebuildSymbolTable();
    KeepWhatIsUsed();
    RemoveWhatIsGoing();
    RestoreWhatIsUsed(undefinedHere);
    MergeListOrders(state, nodes, base, theirs, conflicts);
    NumberSpecies(state.collections);
    ours.RebuildSymbolTable();
    if (PutDefinitionsFirst(state, nodes, early, conflicts)) ours.RebuildSymbolTable();
    SetLinks();
    MergeVisibility();
    MergeKeptText(ours, nodes.Base(), nodes.Theirs(), conflicts);
    state.flags.modified = true;
    return std::move(conflicts);
  }

 private:
  void Note(const CEL_Element& element, const std::string& name, std::string_view field, std::string_view our,
            std::string_view their) {
    conflicts.push_back(
        {std::string(element.KindText()), name, std::string(field), std::string(our), std::string(their)});
  }

  // Settings, functions and the texts of lists.
  void MergeSettings();
  void MergeHeads();
  void MergeHeads(const MergeNode& node);

  // Elements.
  void MergeClasses();
  void MergeElement(MergeNode& node);
  void MergeBoth(MergeNode& node);
  void Make(MergeNode& node);
  void MakeClass(MergeNode& node);
  void Replace(MergeNode& node);
  void SettleClasses();
  void KeepClass(MergeNode& specie);
  void KeepWhatIsUsed();
  void RemoveWhatIsGoing();
  void RestoreWhatIsUsed(const UndefinedUses& undefinedHere);
  void Erase(CEL_Element& element);
  CEL_Lagrange_Specie* MergedClassOf(const CEL_Element& element) const;

  void SetLinks();
  void MergeVisibility();

  TemplateCore& ours;
  TemplateState& state;
  const TemplateCore& base;
  const TemplateCore& theirs;
  std::vector<MergeConflict> conflicts;
  MergeNodes nodes;
  ValueMerge values;
  LinksToSet links;
  std::vector<std::unique_ptr<CEL_Element>> erased;  ///< the nodes name them
};

void Merging::MergeSettings() {
  const CEL_Miscanellous* their = theirs.GetMisc();
  const CEL_Miscanellous* before = base.GetMisc();
  if (their == nullptr) {
    if (before != nullptr && state.hasMisc) Note(state.misc, "", "", kKeptValue, kRemovedValue);
    return;
  }
  if (!state.hasMisc) {
    if (before != nullptr) {
      if (values.TheyChanged(*before, *their)) values.NoteTheirs(before, *their, "", kRemovedValue);
      return;
    }
    state.hasMisc = true;
    state.misc.Reset();
    values.Take(state.misc, *their, links);
    state.misc.documentRevision.SetInt(their->documentRevision.IntValue());
  } else {
    values.Merge(before, state.misc, *their, "", links);
  }
  const CEL_Miscanellous noSettings;
  MergeFunctions(state.misc, before == nullptr ? noSettings : *before, *their, values, conflicts);
}

void Merging::MergeHeads() {
  values.Merge(&base.Root(), state.root, theirs.Root(), state.root.symbol.TextOf(), links);
  ForEachHeadedCollection([this](const auto& row) {
    // The texts of another head lie in no file.
    if (row.writtenHead != row.listKind) return;
    values.Merge(&base.ListHead(row.listKind), state.ListHead(row.listKind), theirs.ListHead(row.listKind),
                 "", links);
  });
}

/// The texts of the lists of a class.
void Merging::MergeHeads(const MergeNode& node) {
  const auto headsOf = [](const CEL_Element& element) -> const auto& {
    return static_cast<const CEL_Lagrange_Specie&>(element).Heads();
  };
  for (std::size_t place = 0; place < CEL_Lagrange_Specie::kListCount; ++place) {
    const CEL_Element* before = node.base == nullptr ? nullptr : headsOf(*node.base)[place].get();
    values.Merge(before, *headsOf(*node.merged)[place], *headsOf(*node.theirs)[place], node.name, links);
  }
}

CEL_Lagrange_Specie* Merging::MergedClassOf(const CEL_Element& element) const {
  const MergeNode* specie = nodes.ClassOf(element);
  return specie == nullptr ? nullptr : static_cast<CEL_Lagrange_Specie*>(specie->merged);
}

/// First, so that members have a place to go to.
void Merging::MergeClasses() {
  for (MergeNode& node : nodes.All()) {
    const CEL_Element* their = node.theirs;
    if (their == nullptr || their->Kind() != ElementKind::Specie || node.isRefused) continue;
    if (node.base == nullptr && node.ours == nullptr) MakeClass(node);
    if (node.ours != nullptr && node.ours->Kind() == ElementKind::Specie) MergeHeads(node);
  }
}

void Merging::MakeClass(MergeNode& node) {
  const auto& from = static_cast<const CEL_Lagrange_Specie&>(*node.theirs);
  CEL_Lagrange_Specie& made = ours.AddSpecie();
  values.Take(made, from, links);
  made.symbol.SetText(node.name);
  made.horizontalVectors.clear();
  for (std::size_t place = 0; place < from.Heads().size(); ++place)
    made.Heads()[place]->TakeValuesOf(*from.Heads()[place]);
  values.Take(*made.verticalEquation, *from.verticalEquation, links);
  made.SetLoaded(true);
  node.merged = &made;
  if (MergeNode* movement = nodes.Of(from.verticalEquation.get()))
    movement->merged = made.verticalEquation.get();
}

void Merging::Make(MergeNode& node) {
  const CEL_Element& from = *node.theirs;
  if (node.merged != nullptr || node.isRefused) return;
  if (from.Kind() == ElementKind::Specie) {
    MakeClass(node);
    return;
  }
  const bool isMember = nodes.ClassOf(from) != nullptr;
  CEL_Lagrange_Specie* specie = MergedClassOf(from);
  if (from.Kind() == ElementKind::VerticalEquation || (isMember && specie == nullptr)) {
    values.NoteTheirs(nullptr, from, node.name, kRemovedValue);
    return;
  }
  CEL_Element* made = isMember ? specie->AddMember(from.Kind()) : ours.AddElement(from.Kind());
  values.Take(*made, from, links);
  if (!HasCaption(from)) made->symbol.SetText(node.name);
  if (from.Kind() == ElementKind::SpatialFunction) {
    auto& number = static_cast<CEL_Lagrange_Spatial_Function&>(*made).specieId;
    const auto* theirClass = static_cast<const CEL_Lagrange_Specie*>(nodes.ClassOf(from)->theirs);
    if (number.IntValue() == theirClass->Index()) number.SetInt(specie->Index());
  }
  made->SetLoaded(true);
  node.merged = made;
}

void Merging::MergeElement(MergeNode& node) {
  if (node.ours != nullptr && node.theirs != nullptr) {
    MergeBoth(node);
  } else if (node.ours != nullptr && node.base != nullptr) {
    const bool isChanged = node.base->Kind() != node.ours->Kind() ||
                           values.WeChanged(*node.base, *node.ours) ||
                           (!HasCaption(*node.base) && node.base->symbol.Text() != node.name);
    node.isGoing = !isChanged;
    if (isChanged) Note(*node.ours, node.name, "", kKeptValue, kRemovedValue);
  } else if (node.theirs != nullptr && node.base != nullptr) {
    const bool isRenamed = !HasCaption(*node.base) && node.base->symbol.Text() != node.theirs->symbol.Text();
    if (isRenamed || values.TheyChanged(*node.base, *node.theirs))
      values.NoteTheirs(node.base, *node.theirs, node.name, kRemovedValue);
  } else if (node.theirs != nullptr && node.isRefused) {
    values.NoteTheirs(nullptr, *node.theirs, node.name, kRemovedValue);
  } else if (node.theirs != nullptr) {
    Make(node);
  }
}

void Merging::MergeBoth(MergeNode& node) {
  const CEL_Element* before = node.base;
  CEL_Element& our = *node.ours;
  const CEL_Element& their = *node.theirs;
  if (nodes.AreInOneList(our, their)) {
    const bool isKnown = before != nullptr && before->Kind() == our.Kind();
    values.Merge(isKnown ? before : nullptr, our, their, node.name, links);
    return;
  }
  const bool isOursKept = before != nullptr && nodes.AreInOneList(*before, our);
  const bool isTheirsKept = before != nullptr && nodes.AreInOneList(*before, their);
  if (isOursKept && !values.WeChanged(*before, our)) {
    Replace(node);
  } else if (!isTheirsKept || values.TheyChanged(*before, their)) {
    Note(our, node.name, "Kind", our.KindText(), their.KindText());
    values.NoteTheirs(before, their, node.name, kKeptValue);
  }
}

/// An element of another kind, or in another class, takes the place of ours.
void Merging::Replace(MergeNode& node) {
  CEL_Element& former = *node.ours;
  node.merged = nullptr;
  Make(node);
  if (node.merged == nullptr) {
    node.merged = &former;
  } else {
    Erase(former);
  }
}

void Merging::Erase(CEL_Element& element) {
  if (MergeNode* node = nodes.Of(&element); node != nullptr && node->merged == &element)
    node->merged = nullptr;
  links.erase(&element);
  const auto eraseFrom = [this, &element](auto& sequence) {
    const auto place = std::find_if(sequence.begin(), sequence.end(),
                                    [&element](const auto& each) { return each.get() == &element; });
    if (place == sequence.end()) return;
    erased.push_back(std::move(*place));
    sequence.erase(place);
  };
  CEL_Lagrange_Specie* specie = MergedClassOf(element);
  if (specie != nullptr) {
    WithMemberList(element.Kind(),
                   [specie, &eraseFrom](const auto& list) { eraseFrom((*specie).*list.members); });
  } else {
    WithCollection(element.Kind(),
                   [this, &eraseFrom](const auto& row) { eraseFrom(state.collections.*row.elements); });
  }
}

/// A class goes with its members or stays with them.
void Merging::SettleClasses() {
  for (MergeNode& node : nodes.All()) {
    const CEL_Element* our = node.ours;
    if (our == nullptr || node.merged != our || node.isGoing) continue;
    MergeNode* specie = nodes.ClassOf(*our);
    if (specie != nullptr && specie->theirs == nullptr && specie->isGoing) KeepClass(*specie);
  }
  for (MergeNode& node : nodes.All()) {
    if (!node.isGoing) continue;
    const MergeNode* specie = nodes.ClassOf(*node.ours);
    if (specie != nullptr && specie->theirs == nullptr && !specie->isGoing) node.isGoing = false;
  }
}

void Merging::KeepClass(MergeNode& specie) {
  specie.isGoing = false;
  Note(*specie.ours, specie.name, "", kKeptValue, kRemovedValue);
}

/// What they removed and we newly use stays.
void Merging::KeepWhatIsUsed() {
  const UndefinedUses undefinedThere = UndefinedUsesOf(theirs, nodes);
  std::unordered_map<const CEL_Element*, const MergeNode*> byElement;
  for (const MergeNode& node : nodes.All()) byElement.emplace(node.merged, &node);
  const auto newUser = [&](const MergeNode& node) -> const MergeNode* {
    for (const std::uint32_t user : state.table.OfElement(*node.ours)->referencedBy) {
      const MergeNode* userNode = byElement.at(state.table.Used(user).element);
      if (!userNode->isGoing && !undefinedThere.contains({node.base->symbol.TextOf(), userNode}))
        return userNode;
    }
    return nullptr;
  };
  for (bool changed = true; changed;) {
    changed = false;
    for (MergeNode& node : nodes.All()) {
      if (!node.isGoing || HasCaption(*node.ours)) continue;
      const MergeNode* user = newUser(node);
      if (user == nullptr) continue;
      node.isGoing = false;
      changed = true;
      Note(*node.ours, node.name, "", "used by " + user->name, kRemovedValue);
      MergeNode* specie = nodes.ClassOf(*node.ours);
      if (specie != nullptr && specie->isGoing) KeepClass(*specie);
      SettleClasses();
    }
  }
}

void Merging::RemoveWhatIsGoing() {
  // A class has at least one horizontal movement.
  for (MergeNode& node : nodes.All()) {
    if (!node.isGoing || node.ours->Kind() != ElementKind::HorizontalVector) continue;
    const CEL_Lagrange_Specie* specie = MergedClassOf(*node.ours);
    if (specie == nullptr || nodes.ClassOf(*node.ours)->isGoing) continue;
    const auto goes = [this](const auto& each) {
      const MergeNode* other = nodes.Of(each.get());
      return other != nullptr && other->isGoing;
    };
    if (!std::all_of(specie->horizontalVectors.begin(), specie->horizontalVectors.end(), goes)) continue;
    node.isGoing = false;
    Note(*node.ours, node.name, "", kKeptValue, kRemovedValue);
  }
  // Members before their classes, which own them.
  for (const bool isClass : {false, true}) {
    for (MergeNode& node : nodes.All()) {
      if (node.isGoing && (node.ours->Kind() == ElementKind::Specie) == isClass &&
          node.ours->Kind() != ElementKind::VerticalEquation)
        Erase(*node.ours);
      if (node.isGoing && node.ours->Kind() == ElementKind::VerticalEquation) node.merged = nullptr;
    }
  }
}

/// What we removed and they newly use comes back.
void Merging::RestoreWhatIsUsed(const UndefinedUses& undefinedHere) {
  std::unordered_map<std::string, MergeNode*> removed;
  for (MergeNode& node : nodes.All()) {
    if (node.base != nullptr && node.ours == nullptr && node.theirs != nullptr && !HasCaption(*node.theirs))
      removed.emplace(node.theirs->symbol.TextOf(), &node);
  }
  for (bool changed = true; changed;) {
    changed = false;
    NumberSpecies(state.collections);
    ours.RebuildSymbolTable();
    std::unordered_map<Uid, const MergeNode*> byUid;
    for (const MergeNode& node : nodes.All()) {
      if (node.merged != nullptr) byUid.emplace(node.merged->GetUid(), &node);
    }
    std::vector<MergeNode*> needed;
    for (const auto& undefined : ours.UndefinedSymbols()) {
      const auto hit = removed.find(undefined->symbol);
      if (hit == removed.end() || hit->second->merged != nullptr) continue;
      for (const Uid uid : undefined->usedBy) {
        const MergeNode* user = byUid.at(uid);
        if (undefinedHere.contains({undefined->symbol, user})) continue;
        needed.push_back(hit->second);
        Note(*hit->second->theirs, hit->second->name, "", kRemovedValue, "used by " + user->name);
        break;
      }
    }
    const RebuildsOff later(state.flags);
    for (MergeNode* node : needed) {
      Make(*node);
      changed = changed || node->merged != nullptr;
      removed.erase(node->theirs->symbol.TextOf());
    }
  }
}

void Merging::SetLinks() {
  const NotificationsOff silent;
  static const NewNames kAsTheyAre;
  const auto isNumber = [](const std::string& text) {
    return !text.empty() && text.find_first_not_of("-0123456789") == std::string::npos;
  };
  for (const auto& [element, link] : links) {
    const SearchLink present = LinkOfSearch(ours, *element, kAsTheyAre);
    auto& search = static_cast<CEL_Lagrange_Spatial_Function&>(*element);
    if (present.variable != link.variable) {
      std::int32_t id = -1;
      ElementKind kind = ElementKind::None;
      if (isNumber(link.variable)) {
        id = KvfInteger(link.variable);
      } else {
        ours.FindElementBySymbol(link.variable, id, kind);
      }
      search.variableId.SetInt(id);
    }
    if (present.specie == link.specie) continue;
    std::int32_t number = isNumber(link.specie) ? KvfInteger(link.specie) : 0;
    for (const auto& specie : state.collections.species) {
      if (specie->symbol.Text() == link.specie) number = specie->Index();
    }
    search.lookFor.SetInt(number);
  }
  FillSearchChoices(state.collections);
  state.SettleSpatialTree();
  ours.RebuildSymbolTable();
}

void Merging::MergeVisibility() {
  if (!state.hasMisc) return;
  static const CEL_Visibility kNoGroups;
  CEL_Visibility& present = state.misc.Visibilities();
  const CEL_Visibility& before = base.GetMisc() == nullptr ? kNoGroups : base.GetMisc()->Visibilities();
  const CEL_Visibility& their = theirs.GetMisc() == nullptr ? before : theirs.GetMisc()->Visibilities();
  values.Merge(&before, present, their, "", links);
  const auto identitiesIn = [this](const CEL_Element* (*elementOf)(const MergeNode&)) {
    std::unordered_map<Uid, Uid> identities;
    for (const MergeNode& node : nodes.All()) {
      const CEL_Element* element = node.merged == nullptr ? nullptr : elementOf(node);
      if (element != nullptr) identities.emplace(element->GetUid(), node.merged->GetUid());
    }
    return [identities = std::move(identities)](Uid uid) {
      const auto hit = identities.find(uid);
      return hit == identities.end() ? Uid::None : hit->second;
    };
  };
  const auto ofBase = identitiesIn([](const MergeNode& node) {
    return node.ours == nullptr || node.theirs == nullptr ? nullptr : node.base;
  });
  const auto ofOurs = identitiesIn([](const MergeNode& node) -> const CEL_Element* { return node.ours; });
  const auto ofTheirs = identitiesIn([](const MergeNode& node) { return node.theirs; });
  std::vector<VisibilityGroup> merged =
      MergeGroups({before.groups, ofBase}, {present.groups, ofOurs}, {their.groups, ofTheirs}, conflicts);
  present.groups = std::move(merged);
  VisibilityGroups(state).Reenter();
}

}  // namespace

std::vector<MergeConflict> TemplateCore::Merge(const TemplateCore& base, const TemplateCore& theirs) {
  assert(history.UndoCount() == 0);
  const RecordingOff unrecorded(history);
  const MessagesAside aside;
  const ScannerRest rest;
  return Merging(*this, state, base, theirs).Run();
}

}  // namespace tessal
