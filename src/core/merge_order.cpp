#include "core/merge_order.h"

#include <algorithm>
#include <map>
#include <memory>
#include <unordered_map>

#include "core/list_order.h"
#include "core/template_core.h"

namespace tessal {

namespace {

using Elements = std::vector<const CEL_Element*>;

/// Calls the visitor with each list of a template: the place of it, and its sequence.
template <class Visitor>
void ForEachList(Collections& collections, Visitor visit) {
  ForEachCollection([&collections, &visit](const auto& row) {
    visit(static_cast<CEL_Lagrange_Specie*>(nullptr), collections.*row.elements);
  });
  for (const auto& specie : collections.species) {
    ForEachMemberList([&specie, &visit](const auto& list) { visit(specie.get(), (*specie).*list.members); });
  }
}

/// The elements of a template by their lists: the kind, and the node of the class.
using Lists = std::map<std::pair<ElementKind, const MergeNode*>, Elements>;

Lists ListsOf(const TemplateCore& core, const MergeNodes& nodes) {
  Lists lists;
  for (const CEL_Element* element : ElementsOf(core))
    lists[{element->Kind(), nodes.ClassOf(*element)}].push_back(element);
  return lists;
}

template <class Element>
void Reorder(Sequence<Element>& elements, const Elements& order) {
  std::unordered_map<const CEL_Element*, std::unique_ptr<Element>> owned;
  for (auto& element : elements) {
    const CEL_Element* key = element.get();
    owned.emplace(key, std::move(element));
  }
  elements.clear();
  for (const CEL_Element* element : order) elements.push_back(std::move(owned.at(element)));
}

/// Numbers for the nodes of one list.
class Numbering final {
 public:
  std::size_t NumberOf(const MergeNode& node) {
    const auto [hit, isNew] = numbers.emplace(&node, nodes.size());
    if (isNew) nodes.push_back(&node);
    return hit->second;
  }
  const MergeNode& At(std::size_t number) const { return *nodes[number]; }

 private:
  std::unordered_map<const MergeNode*, std::size_t> numbers;
  std::vector<const MergeNode*> nodes;
};

std::string NameBefore(const Elements& list, const CEL_Element* element) {
  const auto place = std::find(list.begin(), list.end(), element);
  return place == list.begin() || place == list.end() ? "(first)" : (*(place - 1))->FullSymbol();
}

/// The merged order of one list.
class ListMerge final {
 public:
  ListMerge(const MergeNodes& allNodes, const Elements& presentList, const Elements& baseList,
            const Elements& theirList, std::vector<MergeConflict>& conflictList)
      : nodes(allNodes),
        present(presentList),
        inBase(baseList),
        inTheirs(theirList),
        conflicts(conflictList) {}

  Elements Order(const std::unordered_map<const CEL_Element*, const MergeNode*>& nodeOfMerged) {
    ListOrder ours;
    for (const CEL_Element* element : present) {
      const MergeNode& node = *nodeOfMerged.at(element);
      const std::size_t number = numbering.NumberOf(node);
      isHere.push_back(true);
      if (node.ours == element) ours.push_back(number);
    }
    const MergedOrder merged = MergeOrders(OrderOf(inBase, true), ours, OrderOf(inTheirs, false));
    Elements order;
    for (const std::size_t number : merged.order) order.push_back(numbering.At(number).merged);
    for (const std::size_t number : merged.conflicts) {
      const MergeNode& node = numbering.At(number);
      conflicts.push_back({std::string(node.merged->KindText()), node.name, "Comes after",
                           NameBefore(present, node.merged), NameBefore(inTheirs, node.theirs)});
    }
    // Each is in one of the orders; what is left would be lost.
    for (const CEL_Element* element : present) {
      if (std::find(order.begin(), order.end(), element) == order.end()) order.push_back(element);
    }
    return order;
  }

 private:
  /// Those of an order that are in the merged list; of the base, those that both sides have there.
  ListOrder OrderOf(const Elements& list, bool isBase) {
    ListOrder order;
    for (const CEL_Element* element : list) {
      const MergeNode* node = nodes.Of(element);
      if (node == nullptr || node->merged == nullptr) continue;
      const std::size_t number = numbering.NumberOf(*node);
      if (number >= isHere.size()) continue;
      const bool isCommon = node->ours == node->merged && node->theirs != nullptr;
      if (!isBase || isCommon) order.push_back(number);
    }
    return order;
  }

  const MergeNodes& nodes;
  const Elements& present;
  const Elements& inBase;
  const Elements& inTheirs;
  std::vector<MergeConflict>& conflicts;
  Numbering numbering;
  std::vector<bool> isHere;
};

template <class Element>
Elements ElementsIn(const Sequence<Element>& sequence) {
  Elements elements;
  for (const auto& element : sequence) elements.push_back(element.get());
  return elements;
}

const MergeNode* NodeOfMerged(const std::unordered_map<const CEL_Element*, const MergeNode*>& nodes,
                              const CEL_Element* element) {
  const auto hit = nodes.find(element);
  return hit == nodes.end() ? nullptr : hit->second;
}

std::unordered_map<const CEL_Element*, const MergeNode*> NodesOfMerged(const MergeNodes& nodes) {
  std::unordered_map<const CEL_Element*, const MergeNode*> byElement;
  for (const MergeNode& node : nodes.All()) {
    if (node.merged != nullptr) byElement.emplace(node.merged, &node);
  }
  return byElement;
}

/// Calls the visitor with each use within one list, as the numbers of its records.
template <class Visitor>
void ForEachUseInList(const SymbolTable& table, Visitor visit) {
  for (const SymbolRecord& user : table.Records()) {
    for (const std::uint32_t used : user.references) {
      const SymbolRecord& record = table.Used(used);
      const bool isOneList = record.kind == user.kind && record.specieIndex == user.specieIndex;
      if (isOneList && record.element != user.element) visit(user, record);
    }
  }
}

/// Whether the order in this list matters: equations may use what comes after them.
bool IsOrdered(const SymbolRecord& record) {
  return record.kind != ElementKind::StateVariable && record.kind != ElementKind::SpecieStateVariable;
}

/// An order of a list in which who is used comes first, and who needs not move does not.
class DefinitionsFirst final {
 public:
  using Uses = std::unordered_map<const CEL_Element*, Elements>;

  DefinitionsFirst(const Elements& present, const Uses& itsUses) : uses(itsUses) {
    for (const CEL_Element* element : present) Place(element);
  }

  const Elements& Order() const { return order; }
  const Elements& InCircles() const { return circles; }

 private:
  enum class State : std::uint8_t { Fresh, Waiting, Placed };

  /// Without recursion: a chain of uses may be as long as the list.
  void Place(const CEL_Element* first) {
    std::vector<std::pair<const CEL_Element*, std::size_t>> waiting;
    const auto enter = [this, &waiting](const CEL_Element* element) {
      State& state = states[element];
      if (state == State::Waiting) circles.push_back(element);
      if (state != State::Fresh) return;
      state = State::Waiting;
      waiting.emplace_back(element, 0);
    };
    enter(first);
    while (!waiting.empty()) {
      const CEL_Element* element = waiting.back().first;
      const auto used = uses.find(element);
      const std::size_t next = waiting.back().second++;
      if (used != uses.end() && next < used->second.size()) {
        enter(used->second[next]);
        continue;
      }
      states[element] = State::Placed;
      order.push_back(element);
      waiting.pop_back();
    }
  }

  const Uses& uses;
  std::unordered_map<const CEL_Element*, State> states;
  Elements order;
  Elements circles;
};

}  // namespace

std::set<UseOfNodes> EarlyUses(const TemplateCore& core, const MergeNodes& nodes) {
  std::set<UseOfNodes> early;
  for (const SymbolRecord& user : core.SymbolTable()) {
    for (const std::uint32_t used : user.references) {
      const SymbolRecord* record = core.FindRecordBySequence(used);
      if (used > user.sequence) early.emplace(nodes.Of(user.element), nodes.Of(record->element));
    }
  }
  return early;
}

void MergeListOrders(TemplateState& state, MergeNodes& nodes, const TemplateCore& base,
                     const TemplateCore& theirs, std::vector<MergeConflict>& conflicts) {
  const Lists baseLists = ListsOf(base, nodes);
  const Lists theirLists = ListsOf(theirs, nodes);
  const auto byElement = NodesOfMerged(nodes);
  static const Elements kNone;
  const auto listIn =
      [](const Lists& lists, const std::pair<ElementKind, const MergeNode*>& key) -> const auto& {
    const auto hit = lists.find(key);
    return hit == lists.end() ? kNone : hit->second;
  };
  ForEachList(state.collections, [&](const CEL_Lagrange_Specie* specie, auto& sequence) {
    if (sequence.empty()) return;
    const std::pair<ElementKind, const MergeNode*> key{
        sequence.front()->Kind(), specie == nullptr ? nullptr : NodeOfMerged(byElement, specie)};
    const Elements present = ElementsIn(sequence);
    ListMerge merge(nodes, present, listIn(baseLists, key), listIn(theirLists, key), conflicts);
    Reorder(sequence, merge.Order(byElement));
  });
}

bool PutDefinitionsFirst(TemplateState& state, const MergeNodes& nodes, const std::set<UseOfNodes>& early,
                         std::vector<MergeConflict>& conflicts) {
  const auto byElement = NodesOfMerged(nodes);
  DefinitionsFirst::Uses uses;
  std::set<std::pair<ElementKind, std::int32_t>> broken;
  ForEachUseInList(state.table, [&](const SymbolRecord& user, const SymbolRecord& used) {
    if (!IsOrdered(user)) return;
    const UseOfNodes use{NodeOfMerged(byElement, user.element), NodeOfMerged(byElement, used.element)};
    if (early.contains(use)) return;
    uses[user.element].push_back(used.element);
    if (used.sequence > user.sequence) broken.emplace(user.kind, user.specieIndex);
  });
  if (broken.empty()) return false;
  ForEachList(state.collections, [&](const CEL_Lagrange_Specie* specie, auto& sequence) {
    if (sequence.empty()) return;
    const std::int32_t place = specie == nullptr ? -1 : specie->Index() - 1;
    if (!broken.contains({sequence.front()->Kind(), place})) return;
    const DefinitionsFirst sorted(ElementsIn(sequence), uses);
    for (const CEL_Element* element : sorted.InCircles()) {
      conflicts.push_back({std::string(element->KindText()), element->FullSymbol(), "Comes after",
                           "uses what uses it", "uses what uses it"});
    }
    Reorder(sequence, sorted.Order());
  });
  return true;
}

}  // namespace tessal
