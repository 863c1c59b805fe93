#include "core/merge_nodes.h"

#include <algorithm>
#include <utility>

#include "core/merge_kept_text.h"
#include "core/template_core.h"

namespace tessal {

namespace {

template <class Map>
auto PartnerIn(const Map& partners, const CEL_Element* element) {
  const auto hit = partners.find(element);
  return hit == partners.end() ? nullptr : hit->second;
}

/// The element of ours that the matching, which only reads, found in it.
CEL_Element* Ours(const CEL_Element* found) {
  return const_cast<CEL_Element*>(found);  // NOLINT(cppcoreguidelines-pro-type-const-cast)
}

std::string SymbolOf(const CEL_Element* element) {
  return element == nullptr ? std::string() : element->symbol.TextOf();
}

void NoteSymbols(std::vector<MergeConflict>& conflicts, const MergeNode& node, std::string theirs) {
  const std::string our = SymbolOf(node.ours);
  conflicts.push_back({std::string(node.ours->KindText()), our, "Symbol", our, std::move(theirs)});
}

}  // namespace

MergeNodes::MergeNodes(TemplateCore& oursCore, const TemplateCore& baseCore, const TemplateCore& theirsCore)
    : ours(oursCore), base{baseCore, {}}, theirs{theirsCore, {}}, classes(ClassesOf(oursCore)) {
  classes.merge(ClassesOf(baseCore));
  classes.merge(ClassesOf(theirsCore));
  const ElementMatch toOurs = MatchElements(baseCore, oursCore);
  const ElementMatch toTheirs = MatchElements(baseCore, theirsCore);
  for (const CEL_Element* element : ElementsOf(baseCore))
    AddNode(element, Ours(PartnerIn(toOurs.later, element)), PartnerIn(toTheirs.later, element));
  for (CEL_Element* element : ElementsOf(oursCore)) {
    if (!toOurs.former.contains(element)) AddNode(nullptr, element, nullptr);
  }
  std::vector<CEL_Element*> added = ElementsOf(theirsCore);
  std::erase_if(added, [&toTheirs](const CEL_Element* element) { return toTheirs.former.contains(element); });
  PairWhatBothAdded(added);
}

void MergeNodes::AddNode(const CEL_Element* inBase, CEL_Element* inOurs, const CEL_Element* inTheirs) {
  MergeNode& node = nodes.emplace_back();
  node.base = inBase;
  node.ours = node.merged = inOurs;
  node.theirs = inTheirs;
  for (const CEL_Element* element : {inBase, static_cast<const CEL_Element*>(inOurs), inTheirs}) {
    if (element != nullptr) nodeOf.emplace(element, &node);
  }
}

void MergeNodes::PairWhatBothAdded(const std::vector<CEL_Element*>& theirsNew) {
  static const NewNames kAsTheyAre;
  std::unordered_map<std::string, std::vector<MergeNode*>> waiting;
  const auto keyOf = [this](const TemplateCore& core, const CEL_Element& element) {
    if (!HasCaption(element)) return element.symbol.TextOf();
    const auto specie = classes.find(&element);
    return std::to_string(NumberOf(element.Kind())) + '\n' +
           (specie == classes.end() ? "" : specie->second->symbol.TextOf()) + '\n' +
           ContentOf(core, element, kAsTheyAre);
  };
  for (auto node = nodes.rbegin(); node != nodes.rend() && node->base == nullptr; ++node)
    waiting[keyOf(ours, *node->ours)].push_back(&*node);
  for (const CEL_Element* element : theirsNew) {
    const auto hit = waiting.find(keyOf(theirs.core, *element));
    if (hit == waiting.end() || hit->second.empty()) {
      AddNode(nullptr, nullptr, element);
      continue;
    }
    hit->second.back()->theirs = element;
    nodeOf.emplace(element, hit->second.back());
    hit->second.pop_back();
  }
}

MergeNode* MergeNodes::Of(const CEL_Element* element) const {
  return PartnerIn(nodeOf, element);
}

MergeNode* MergeNodes::ClassOf(const CEL_Element& element) const {
  const auto specie = classes.find(&element);
  return specie == classes.end() ? nullptr : Of(specie->second);
}

bool MergeNodes::AreInOneList(const CEL_Element& one, const CEL_Element& other) const {
  return one.Kind() == other.Kind() && ClassOf(one) == ClassOf(other);
}

void MergeNodes::SettleNames(std::vector<MergeConflict>& conflicts) {
  ChooseNames(conflicts);
  KeepNamesApart(conflicts);
  NoteNames();
  RenameOurs();
}

void MergeNodes::ChooseNames(std::vector<MergeConflict>& conflicts) {
  for (MergeNode& node : nodes) {
    const CEL_Element* present = node.ours != nullptr ? node.ours : node.theirs;
    if (present == nullptr) continue;
    node.name = HasCaption(*present) ? present->FullSymbol() : present->symbol.TextOf();
    if (HasCaption(*present) || node.base == nullptr || node.ours == nullptr || node.theirs == nullptr)
      continue;
    const MergedText name = MergeTexts(SymbolOf(node.base), SymbolOf(node.ours), SymbolOf(node.theirs));
    node.name = name.text;
    if (name.isConflict) NoteSymbols(conflicts, node, SymbolOf(node.theirs));
  }
}

/// What one side renames or adds may have a symbol that the other has given away.
void MergeNodes::KeepNamesApart(std::vector<MergeConflict>& conflicts) {
  std::unordered_map<std::string, int> taken;
  const auto isNamed = [](const MergeNode& node) { return node.ours != nullptr && !HasCaption(*node.ours); };
  for (const MergeNode& node : nodes) {
    if (isNamed(node)) ++taken[node.name];
  }
  // Who keeps its own symbol may take that of one that was to be renamed.
  for (bool changed = true; changed;) {
    changed = false;
    for (MergeNode& node : nodes) {
      if (!isNamed(node) || node.name == node.ours->symbol.Text() || taken[node.name] == 1) continue;
      NoteSymbols(conflicts, node, node.name);
      --taken[node.name];
      node.name = SymbolOf(node.ours);
      ++taken[node.name];
      changed = true;
    }
  }
  for (MergeNode& node : nodes) {
    if (node.ours != nullptr || node.theirs == nullptr || node.base != nullptr) continue;
    if (HasCaption(*node.theirs) || taken[node.name]++ == 0) continue;
    node.isRefused = true;
    conflicts.push_back({std::string(node.theirs->KindText()), node.name, "Symbol",
                         "another element of this symbol", node.name});
  }
}

void MergeNodes::NoteNames() {
  const auto note = [](NewNames& names, const CEL_Element* element, const MergeNode& node) {
    if (element == nullptr || HasCaption(*element) || node.name.empty()) return;
    if (element->symbol.Text() != node.name) names.emplace(element->symbol.TextOf(), node.name);
  };
  for (const MergeNode& node : nodes) {
    note(base.names, node.base, node);
    note(oursNames, node.ours, node);
    note(theirs.names, node.theirs, node);
  }
}

void MergeNodes::RenameOurs() {
  if (oursNames.empty()) return;
  const NotificationsOff silent;
  for (const MergeNode& node : nodes) {
    if (node.ours == nullptr) continue;
    if (!HasCaption(*node.ours)) node.ours->symbol.SetText(node.name);
    node.ours->ForEachExpression([this](const PropertyRow&, CEL_Property& expression) {
      expression.SetText(ReplaceNames(expression.Text(), oursNames));
    });
  }
  const std::vector<Pool> pools = PoolsUnderNames(ours, oursNames);
  std::string failure;
  if (pools != PoolsOf(ours).pools) SetPools(ours, pools, failure);
  ours.RebuildSymbolTable();
}

}  // namespace tessal
