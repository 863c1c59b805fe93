#include "core/comparison.h"

#include <algorithm>
#include <array>
#include <map>
#include <set>
#include <string_view>
#include <unordered_map>
#include <utility>

#include "core/list_order.h"
#include "core/matching.h"
#include "core/rename.h"
#include "core/template_core.h"
#include "elements/element_field.h"
#include "keyfile/item_tree.h"
#include "keyfile/reader.h"
#include "platform/ascii.h"
#include "platform/text_stream.h"

namespace tessal {

namespace {

/// Fields that say nothing about what a modeller entered: the name itself, numbers that follow from places,
/// and the count of saves.
constexpr std::array<std::string_view, 4> kFieldsLeftOut = {"Symbol", "ID", "Specie ID", "Revision"};

/// The list that an element is in: its kind, and its particle class from 0 or -1.
using ListOfItem = std::pair<ElementKind, std::int32_t>;

struct ItemField {
  std::string label;
  std::string value;
  bool isExpression = false;
};

/// What is compared as one thing.
struct Item {
  std::string kind;
  std::string symbol;
  std::vector<ItemField> fields;
  const CEL_Element* element = nullptr;    ///< none for what has no record
  std::string specie;                      ///< the class that it belongs to
  ListOfItem list{ElementKind::None, -1};  ///< none for what has no place in a list
  std::string predecessor;                 ///< in the list, by its symbol
};

using Items = std::vector<Item>;

std::string Label(const std::string& field) {
  return field == "Caption" ? "Kind" : field;
}

std::string NewNameOf(const NewNames& newNames, std::string_view name) {
  const auto hit = newNames.find(name);
  return hit == newNames.end() ? std::string(name) : hit->second;
}

/// All items of a template, in its order. What names others has their new names.
class Listing final {
 public:
  Listing(const TemplateCore& listed, const NewNames& renamed) : core(listed), newNames(renamed) {
    AddTexts(core.Root(), core.Root().symbol.TextOf());
    AddSettings();
    ForEachHeadedCollection([this](const auto& row) {
      // The texts of another head lie in no file.
      if (row.writtenHead == row.listKind) AddTexts(core.ListHead(row.listKind), "");
    });
    AddElements();
    AddFurtherSections();
  }

  Items Take() { return std::move(items); }

 private:
  Item& Add(std::string_view kind, std::string symbol) {
    Item& added = items.emplace_back();
    added.kind = kind;
    added.symbol = std::move(symbol);
    return added;
  }

  void AddTexts(const CEL_Element& element, std::string name) {
    AppendFields(element, "", Add(element.KindText(), std::move(name)));
  }

  static void AppendFields(const CEL_Element& element, const std::string& prefix, Item& item) {
    std::vector<ElementField> fields;
    element.GetFields(fields);
    for (const ElementField& field : fields) {
      if (std::find(kFieldsLeftOut.begin(), kFieldsLeftOut.end(), field.name) != kFieldsLeftOut.end())
        continue;
      item.fields.push_back(
          {prefix + Label(field.name), FieldText(field), field.kind == FieldKind::Expression});
    }
  }

  /// A search refers to others by numbers, which change with every element before them.
  void NameReferences(const CEL_Lagrange_Spatial_Function& search, Item& item) const {
    const auto classPlace = static_cast<std::size_t>(search.lookFor.IntValue() - 1);
    for (auto& [label, value, isExpression] : item.fields) {
      if (label == "Variable ID") value = NewNameOf(newNames, search.VariableName());
      if (label == "Lookfor" && search.lookFor.IntValue() > 0 && classPlace < core.Species().size())
        value = NewNameOf(newNames, core.Species()[classPlace]->symbol.Text());
    }
  }

  static void AppendListTexts(const CEL_Lagrange_Specie& specie, Item& item) {
    for (const auto& head : specie.Heads()) AppendFields(*head, std::string(head->KindText()) + ": ", item);
  }

  void AddElements() {
    const auto add = [this](const SymbolRecord& record) {
      const CEL_Element& element = *record.element;
      Item& item = Add(element.KindText(), element.FullSymbol());
      AppendFields(element, "", item);
      if (element.Kind() == ElementKind::SpatialFunction)
        NameReferences(static_cast<const CEL_Lagrange_Spatial_Function&>(element), item);
      if (element.Kind() == ElementKind::Specie)
        AppendListTexts(static_cast<const CEL_Lagrange_Specie&>(element), item);
      item.element = &element;
      item.list = {element.Kind(), record.specieIndex};
      if (record.specieIndex >= 0 && element.Kind() != ElementKind::Specie)
        item.specie = ClassOf(core.Elements(), record).symbol.TextOf();
      const bool isFirst = items.size() < 2 || items[items.size() - 2].list != item.list;
      if (!isFirst) item.predecessor = NewNameOf(newNames, items[items.size() - 2].symbol);
    };
    const CEL_Element* previous = nullptr;
    // The two records of a movement are side by side.
    for (const SymbolRecord& record : core.SymbolTable()) {
      if (record.element != previous) add(record);
      previous = record.element;
    }
  }

  void AddSettings() {
    const CEL_Miscanellous* settings = core.GetMisc();
    if (settings == nullptr) return;
    AddTexts(*settings, "");
    for (const auto& function : settings->ExternalFunctions()) {
      AppendFields(*function, "", Add(function->KindText(), function->publicName.TextOf()));
    }
    for (const VisibilityGroup& group : settings->Visibilities().groups) {
      Add(KindText(ElementKind::VisibilityGroup), group.name).fields = {{"Description", group.description}};
      for (const VisibilityLevel& level : group.levels) {
        Add("Visibility level", group.name + ": " + level.name).fields = {
            {"Description", level.description}, {"Included items", IncludedItems(level)}};
      }
    }
  }

  std::string IncludedItems(const VisibilityLevel& level) {
    if (symbols.empty()) {
      for (const SymbolRecord& record : core.SymbolTable())
        symbols.emplace(record.uid, NewNameOf(newNames, record.element->FullSymbol()));
    }
    std::set<std::string_view> names;
    for (const Uid uid : level.items) {
      const auto hit = symbols.find(uid);
      if (hit != symbols.end()) names.insert(hit->second);
    }
    std::string text;
    for (const std::string_view name : names) text.append(text.empty() ? "" : ", ").append(name);
    return text;
  }

  void AddFurtherSections() {
    if (core.KeptText().empty()) return;
    // A file of the format begins with a comment.
    CKvfItemTree sections;
    if (ParseKeyFileTree("// \r\n\r\n" + core.KeptText() + "\r\n", sections) == 0) return;
    for (const CKvfBaseItem& child : sections.Children()) {
      if (child.ItemKind() != CKvfBaseItem::kSection) continue;
      std::string text;
      child.AppendTo(text);
      Add("Further section", std::string(child.Name())).fields = {{"Text", std::move(text)}};
    }
  }

  const TemplateCore& core;
  const NewNames& newNames;
  Items items;
  std::unordered_map<Uid, std::string> symbols;  ///< of all elements, when a level first asks
};

std::vector<FieldChange> CompareFields(const Item& former, const Item& later, const NewNames& newNames) {
  std::vector<FieldChange> changes;
  const auto fieldIn = [](const Item& item, const std::string& label) {
    const auto hit = std::find_if(item.fields.begin(), item.fields.end(),
                                  [&label](const ItemField& field) { return field.label == label; });
    return hit == item.fields.end() ? nullptr : &*hit;
  };
  const auto isSame = [&newNames](const ItemField& before, const ItemField& after) {
    if (before.value == after.value) return true;
    return after.isExpression && !newNames.empty() && ReplaceNames(before.value, newNames) == after.value;
  };
  for (const ItemField& field : later.fields) {
    const ItemField* before = fieldIn(former, field.label);
    if (before == nullptr ? !field.value.empty() : !isSame(*before, field)) {
      changes.push_back(
          {field.label, before == nullptr ? std::string() : before->value, field.value, field.isExpression});
    }
  }
  for (const ItemField& field : former.fields) {
    if (fieldIn(later, field.label) == nullptr && !field.value.empty())
      changes.push_back({field.label, field.value, "", field.isExpression});
  }
  return changes;
}

/// The matching of the items of two templates.
class Comparison final {
 public:
  Comparison(Items formerItems, Items laterItems, const ElementMatch& elementMatch)
      : match(elementMatch),
        former(std::move(formerItems)),
        later(std::move(laterItems)),
        partners(later.size(), kNone),
        isMatched(former.size(), false) {
    MatchByName();
    MatchElements();
    FindMoves();
  }

  std::vector<SymbolChange> Changes() const;

 private:
  static constexpr auto kNone = static_cast<std::size_t>(-1);

  void Pair(std::size_t formerPlace, std::size_t laterPlace) {
    partners[laterPlace] = formerPlace;
    isMatched[formerPlace] = true;
  }

  /// Items that are no elements with a record: by kind and name.
  void MatchByName() {
    const auto keyOf = [](const Item& item) { return item.kind + '\n' + item.symbol; };
    std::unordered_map<std::string, std::vector<std::size_t>> places;
    // From the end, so that the first of a name is taken first.
    for (std::size_t place = former.size(); place-- > 0;) {
      if (former[place].element == nullptr) places[keyOf(former[place])].push_back(place);
    }
    for (std::size_t place = 0; place < later.size(); ++place) {
      if (later[place].element != nullptr) continue;
      const auto hit = places.find(keyOf(later[place]));
      if (hit == places.end() || hit->second.empty()) continue;
      Pair(hit->second.back(), place);
      hit->second.pop_back();
    }
  }

  void MatchElements() {
    std::unordered_map<const CEL_Element*, std::size_t> places;
    for (std::size_t place = 0; place < former.size(); ++place) {
      if (former[place].element != nullptr) places.emplace(former[place].element, place);
    }
    for (std::size_t place = 0; place < later.size(); ++place) {
      const auto partner = match.former.find(later[place].element);
      if (later[place].element != nullptr && partner != match.former.end())
        Pair(places.at(partner->second), place);
    }
  }

  void FindMoves() {
    isMoved.assign(later.size(), false);
    std::map<ListOfItem, std::vector<std::size_t>> lists;
    for (std::size_t place = 0; place < later.size(); ++place) {
      const ListOfItem& list = later[place].list;
      const bool isInBoth = partners[place] != kNone && former[partners[place]].list == list;
      if (isInBoth && list.first != ElementKind::None) lists[list].push_back(place);
    }
    for (const auto& [list, places] : lists) {
      std::vector<std::size_t> formerPlaces;
      for (const std::size_t place : places) formerPlaces.push_back(partners[place]);
      const std::vector<bool> outside = OutOfOrder(formerPlaces);
      for (std::size_t index = 0; index < places.size(); ++index) isMoved[places[index]] = outside[index];
    }
  }

  std::vector<FieldChange> FieldChanges(std::size_t place) const {
    const Item& before = former[partners[place]];
    const Item& after = later[place];
    std::vector<FieldChange> changes = CompareFields(before, after, match.renamed);
    if (isMoved[place] && before.predecessor != after.predecessor) {
      changes.push_back({"Comes after", before.predecessor, after.predecessor, false});
    }
    return changes;
  }

  /// Whether the partners have symbols, and different ones.
  bool IsRenamed(std::size_t place) const {
    const CEL_Element* element = later[place].element;
    return element != nullptr && !HasCaption(*element) &&
           former[partners[place]].element->symbol.Text() != element->symbol.Text();
  }

  const ElementMatch& match;
  Items former;
  Items later;
  std::vector<std::size_t> partners;  ///< for each later item its place among the former ones, or none
  std::vector<bool> isMatched;        ///< of the former items
  std::vector<bool> isMoved;          ///< of the later items
};

std::vector<SymbolChange> Comparison::Changes() const {
  std::vector<SymbolChange> changes;
  for (std::size_t place = 0; place < former.size(); ++place) {
    const Item& item = former[place];
    if (!isMatched[place])
      changes.push_back({ChangeKind::Removed, item.kind, item.symbol, {}, {}, item.specie});
  }
  for (std::size_t place = 0; place < later.size(); ++place) {
    const Item& item = later[place];
    if (partners[place] == kNone)
      changes.push_back({ChangeKind::Added, item.kind, item.symbol, {}, {}, item.specie});
  }
  for (std::size_t place = 0; place < later.size(); ++place) {
    if (partners[place] == kNone) continue;
    std::vector<FieldChange> fields = FieldChanges(place);
    const Item& item = later[place];
    if (IsRenamed(place)) {
      changes.push_back({ChangeKind::Renamed, item.kind, item.symbol, std::move(fields),
                         former[partners[place]].symbol, item.specie});
    } else if (!fields.empty()) {
      changes.push_back({ChangeKind::Changed, item.kind, item.symbol, std::move(fields), {}, item.specie});
    }
  }
  return changes;
}

}  // namespace

std::vector<SymbolChange> CompareBySymbol(const TemplateCore& former, const TemplateCore& later) {
  static const NewNames kAsTheyAre;
  const ElementMatch match = MatchElements(former, later);
  return Comparison(Listing(former, match.renamed).Take(), Listing(later, kAsTheyAre).Take(), match)
      .Changes();
}

}  // namespace tessal
