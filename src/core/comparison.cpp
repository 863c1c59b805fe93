#include "core/comparison.h"

#include <algorithm>
#include <array>
#include <map>
#include <set>
#include <string_view>
#include <unordered_map>
#include <utility>

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

/// What is compared as one thing.
struct Item {
  std::string kind;
  std::string symbol;
  std::vector<std::pair<std::string, std::string>> fields;  ///< labels and values
  ListOfItem list{ElementKind::None, -1};                   ///< none for what has no place in a list
  std::string predecessor;                                  ///< in the list, by its symbol
};

using Items = std::vector<Item>;

std::string Label(const std::string& field) {
  return field == "Caption" ? "Kind" : field;
}

/// All items of a template, in its order.
class Listing final {
 public:
  explicit Listing(const TemplateCore& listed) : core(listed) {
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
      item.fields.emplace_back(prefix + Label(field.name), FieldText(field));
    }
  }

  /// A search refers to others by numbers, which change with every element before them.
  void NameReferences(const CEL_Lagrange_Spatial_Function& search, Item& item) const {
    const auto classPlace = static_cast<std::size_t>(search.lookFor.IntValue() - 1);
    for (auto& [label, value] : item.fields) {
      if (label == "Variable ID") value = search.VariableName();
      if (label == "Lookfor" && search.lookFor.IntValue() > 0 && classPlace < core.Species().size())
        value = core.Species()[classPlace]->symbol.Text();
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
      item.list = {element.Kind(), record.specieIndex};
      const bool isFirst = items.size() < 2 || items[items.size() - 2].list != item.list;
      if (!isFirst) item.predecessor = items[items.size() - 2].symbol;
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
        symbols.emplace(record.uid, record.element->FullSymbol());
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
  Items items;
  std::unordered_map<Uid, std::string> symbols;  ///< of all elements, when a level first asks
};

std::vector<FieldChange> CompareFields(const Item& former, const Item& later) {
  std::vector<FieldChange> changes;
  const auto valueIn = [](const Item& item, const std::string& label) {
    const auto hit = std::find_if(item.fields.begin(), item.fields.end(),
                                  [&label](const auto& field) { return field.first == label; });
    return hit == item.fields.end() ? nullptr : &hit->second;
  };
  for (const auto& [label, value] : later.fields) {
    const std::string* before = valueIn(former, label);
    if (before == nullptr ? !value.empty() : *before != value)
      changes.push_back({label, before == nullptr ? std::string() : *before, value});
  }
  for (const auto& [label, value] : former.fields) {
    if (valueIn(later, label) == nullptr && !value.empty()) changes.push_back({label, value, ""});
  }
  return changes;
}

/// Which of the numbers are outside a longest rising row of them: with those moved, all are in order.
std::vector<bool> OutOfOrder(const std::vector<std::size_t>& numbers) {
  constexpr auto kNone = static_cast<std::size_t>(-1);
  std::vector<std::size_t> ends;  // of the rows of each length, the place of the least last number
  std::vector<std::size_t> before(numbers.size(), kNone);
  for (std::size_t place = 0; place < numbers.size(); ++place) {
    const auto row = std::lower_bound(
        ends.begin(), ends.end(), place,
        [&numbers](std::size_t left, std::size_t right) { return numbers[left] < numbers[right]; });
    if (row != ends.begin()) before[place] = *(row - 1);
    if (row == ends.end()) {
      ends.push_back(place);
    } else {
      *row = place;
    }
  }
  std::vector<bool> outside(numbers.size(), true);
  for (std::size_t place = ends.empty() ? kNone : ends.back(); place != kNone; place = before[place])
    outside[place] = false;
  return outside;
}

/// The matching of the items of two templates.
class Comparison final {
 public:
  Comparison(Items formerItems, Items laterItems)
      : former(std::move(formerItems)), later(std::move(laterItems)), partners(later.size(), kNone) {
    Match();
    FindMoves();
  }

  std::vector<SymbolChange> Changes() const;

 private:
  static constexpr auto kNone = static_cast<std::size_t>(-1);

  /// What is the same for an item in both templates. An element may change its kind.
  static std::string KeyOf(const Item& item) {
    const bool isElement = item.list.first != ElementKind::None;
    return (isElement ? std::string() : item.kind) + '\n' + item.symbol;
  }

  void Match() {
    std::unordered_map<std::string, std::vector<std::size_t>> places;
    // From the end, so that the first of a name is taken first.
    for (std::size_t place = former.size(); place-- > 0;) places[KeyOf(former[place])].push_back(place);
    isMatched.assign(former.size(), false);
    for (std::size_t place = 0; place < later.size(); ++place) {
      const auto hit = places.find(KeyOf(later[place]));
      if (hit == places.end() || hit->second.empty()) continue;
      partners[place] = hit->second.back();
      isMatched[hit->second.back()] = true;
      hit->second.pop_back();
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
    std::vector<FieldChange> changes = CompareFields(before, after);
    if (isMoved[place] && before.predecessor != after.predecessor) {
      changes.push_back({"Comes after", before.predecessor, after.predecessor});
    }
    return changes;
  }

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
    if (!isMatched[place]) changes.push_back({ChangeKind::Removed, item.kind, item.symbol, {}});
  }
  for (std::size_t place = 0; place < later.size(); ++place) {
    const Item& item = later[place];
    if (partners[place] == kNone) changes.push_back({ChangeKind::Added, item.kind, item.symbol, {}});
  }
  for (std::size_t place = 0; place < later.size(); ++place) {
    if (partners[place] == kNone) continue;
    std::vector<FieldChange> fields = FieldChanges(place);
    const Item& item = later[place];
    if (!fields.empty()) changes.push_back({ChangeKind::Changed, item.kind, item.symbol, std::move(fields)});
  }
  return changes;
}

}  // namespace

std::vector<SymbolChange> CompareBySymbol(const TemplateCore& former, const TemplateCore& later) {
  return Comparison(Listing(former).Take(), Listing(later).Take()).Changes();
}

}  // namespace tessal
