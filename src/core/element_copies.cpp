#include "core/element_copies.h"

#include <algorithm>
#include <map>
#include <optional>
#include <set>
#include <unordered_set>
#include <utility>

#include "core/error_registry.h"
#include "core/rename.h"
#include "core/template_core.h"
#include "elements/free_name.h"
#include "expr/scanner.h"
#include "platform/ascii.h"
#include "platform/kvf2004.h"

namespace tessal {

namespace {

constexpr std::string_view kNoElements = "The text holds no elements of a template.";
constexpr std::string_view kNoClass = "There is no particle class to which the copied elements could belong.";

/// The target beside the template's that holds what a template file cannot say: by which names searches look
/// at what they have numbers for, and which classes are there for the sake of the members in them.
constexpr std::string_view kCopied = "COPIED_ELEMENTS";
constexpr std::string_view kShellPrefix = "PART_OF_CLASS_";
constexpr std::string_view kLinkPrefix = "SEARCH_";
constexpr std::string_view kLinkSymbol = "SYMBOL";
constexpr std::string_view kLinkVariable = "VARIABLE";
constexpr std::string_view kLinkClass = "CLASS";

/// What a search looks at, by names; empty for nothing.
struct SearchLink {
  std::string variable;
  std::string specie;
};
using SearchLinks = std::map<std::string, SearchLink, std::less<>>;  ///< by the symbol of the search

/// What the text of copied elements says beside the template file that it is.
struct Beside {
  SearchLinks links;
  std::set<std::string, std::less<>> shells;  ///< the names of the classes that were not copied themselves
};

/// Nobody hears of changes and nothing is rebuilt while many elements are made.
class Quiet final {
 public:
  explicit Quiet(TemplateCore& quietCore) : core(quietCore) { core.SetRebuildEnabled(false); }
  Quiet(const Quiet&) = delete;
  Quiet& operator=(const Quiet&) = delete;
  ~Quiet() { core.SetRebuildEnabled(true); }

 private:
  NotificationsOff silent;
  TemplateCore& core;
};

/// Its symbol is a caption that the place gives, not a name.
bool HasCaption(const CEL_Element& element) {
  return element.Kind() == ElementKind::DerivedOutput || element.Kind() == ElementKind::HorizontalVector;
}

SearchLink LinkOf(const TemplateCore& core, const CEL_Lagrange_Spatial_Function& function) {
  SearchLink link;
  const std::int32_t number = function.variableId.IntValue();
  const CEL_Element* variable =
      number < 1 ? nullptr : core.GetElementBySequence(static_cast<std::uint32_t>(number));
  if (variable != nullptr) link.variable = variable->symbol.TextOf();
  const auto sought = static_cast<std::size_t>(std::max(function.lookFor.IntValue(), 0));
  if (sought >= 1 && sought <= core.GetSpecieCount()) {
    link.specie = core.GetSpecie(sought - 1).symbol.TextOf();
  }
  return link;
}

/// The copying of elements from one template into another.
class Copying final {
 public:
  explicit Copying(TemplateCore& copyTarget) : target(copyTarget) {}

  /// A copy of an element at the end of its list; of a member, in the class.
  void Copy(const CEL_Element& from, CEL_Lagrange_Specie* specie) {
    CEL_Element* made = specie == nullptr ? target.AddElement(from.Kind()) : specie->AddMember(from.Kind());
    if (made == nullptr) return;
    Fill(from, *made);
    if (from.Kind() == ElementKind::Specie) {
      CopyMembers(static_cast<const CEL_Lagrange_Specie&>(from), static_cast<CEL_Lagrange_Specie&>(*made));
    }
    top.push_back(made);
  }

  /// Has the copies use each other, and the searches among them find what they look at. The table of the
  /// target must be up to date.
  void Connect(const SearchLinks& links) {
    const NotificationsOff silent;
    for (const auto& [element, original] : copies) {
      element->ForEachExpression([this](const PropertyRow&, CEL_Property& expression) {
        if (!newNames.empty()) expression.SetText(ReplaceNames(expression.Text(), newNames));
      });
      if (element->Kind() != ElementKind::SpatialFunction) continue;
      const auto link = links.find(original);
      Link(static_cast<CEL_Lagrange_Spatial_Function&>(*element),
           link == links.end() ? SearchLink() : link->second);
    }
  }

  const std::vector<CEL_Element*>& Top() const { return top; }

 private:
  void Fill(const CEL_Element& from, CEL_Element& made) {
    made.TakeValuesOf(from);
    copies.emplace_back(&made, from.symbol.TextOf());
    if (HasCaption(from)) return;
    const std::string former = from.symbol.TextOf();
    const std::string present = FreeSymbol(former);
    if (present != former) newNames.emplace(former, present);
    taken.insert(present);
    made.symbol.SetText(present);
  }

  void CopyMembers(const CEL_Lagrange_Specie& from, CEL_Lagrange_Specie& made) {
    for (std::size_t place = 0; place < from.Heads().size(); ++place) {
      made.Heads()[place]->TakeValuesOf(*from.Heads()[place]);
    }
    ForEachMemberList([this, &from, &made](const auto& list) {
      std::size_t place = 0;
      for (const auto& member : from.*list.members) {
        // A new class has its first movement.
        auto& members = made.*list.members;
        CEL_Element* copy = place < members.size() ? members[place].get() : made.AddMember(list.kind);
        ++place;
        Fill(*member, *copy);
      }
    });
    Fill(*from.verticalEquation, *made.verticalEquation);
    made.StampMembers();
  }

  /// The symbol itself, or its first letters with the next number that is free.
  std::string FreeSymbol(const std::string& symbol) const {
    const auto isTaken = [this](const std::string& name) {
      return taken.contains(name) || target.SymbolExists(name);
    };
    if (!isTaken(symbol)) return symbol;
    std::size_t digits = 0;
    while (digits < symbol.size() && IsAsciiDigit(symbol[symbol.size() - 1 - digits])) ++digits;
    const std::string stem = symbol.substr(0, symbol.size() - digits);
    constexpr std::size_t kMostDigits = 9;
    const bool counts = digits > 0 && digits <= kMostDigits && !stem.empty();
    const std::size_t next = counts ? std::stoul(symbol.substr(stem.size())) + 1 : 2;
    return FirstFreeName(counts ? stem : symbol, next, isTaken);
  }

  std::string NewNameOf(const std::string& name) const {
    const auto found = newNames.find(name);
    return found == newNames.end() ? name : found->second;
  }

  void Link(CEL_Lagrange_Spatial_Function& function, const SearchLink& link) const {
    constexpr std::int32_t kNothing = -1;
    std::int32_t id = kNothing;
    ElementKind kind = ElementKind::None;
    const bool isFound =
        !link.variable.empty() && target.FindElementBySymbol(NewNameOf(link.variable), id, kind);
    function.variableId.SetInt(isFound ? id : kNothing);
    if (link.specie.empty()) return;
    const std::string sought = NewNameOf(link.specie);
    std::int32_t number = 0;
    for (const auto& specie : target.Species()) {
      if (specie->symbol.Text() == sought) number = specie->Index();
    }
    function.lookFor.SetInt(number);
  }

  TemplateCore& target;
  NewNames newNames;
  std::unordered_set<std::string> taken;
  std::vector<std::pair<CEL_Element*, std::string>> copies;  ///< with the symbols of their originals
  std::vector<CEL_Element*> top;                             ///< those that are members of no copy
};

std::string TextBeside(const Beside& beside) {
  std::string text;
  if (beside.links.empty() && beside.shells.empty()) return text;
  KvfHandle file = kvfCreateInto([&text](std::string_view part) { text += part; }, "type = 2");
  kvfAddTarget(file, kCopied);
  const auto write = [file](std::string_view key, std::string_view value) {
    kvfAddKeyword(file, key);
    kvfAddString(file, value);
  };
  int number = 0;
  for (const auto& [symbol, link] : beside.links) {
    kvfAddSection(file, std::string(kLinkPrefix) + std::to_string(++number));
    write(kLinkSymbol, symbol);
    write(kLinkVariable, link.variable);
    write(kLinkClass, link.specie);
    kvfEndSection(file);
  }
  for (const std::string& shell : beside.shells) {
    kvfAddSection(file, std::string(kShellPrefix) + std::to_string(++number));
    write(kLinkClass, shell);
    kvfEndSection(file);
  }
  kvfEndSection(file);
  kvfFinish(file);
  kvfClose(&file);
  return text;
}

Beside BesideOf(const std::string& text) {
  Beside beside;
  KvfHandle file = kvfLoadText(text);
  const KvfNode target = file == 0 ? nullptr : kvfTargetByNameNum(file, kCopied, 1);
  const auto read = [](KvfNode section, std::string_view key) {
    std::string value;
    const KvfNode keyword = kvfKeywordByNameNum(section, key, 1);
    if (keyword != nullptr) kvfGetString(kvfParamByNum(keyword, 1), value);
    return value;
  };
  KvfNode section = target == nullptr ? nullptr : kvfFirstSection(target);
  for (; section != nullptr; section = kvfNextSection(section, target)) {
    std::string specie = read(section, kLinkClass);
    if (kvfGetNameGlb(section).starts_with(kShellPrefix)) {
      beside.shells.insert(std::move(specie));
    } else {
      beside.links.insert_or_assign(read(section, kLinkSymbol),
                                    SearchLink{read(section, kLinkVariable), std::move(specie)});
    }
  }
  kvfClose(&file);
  return beside;
}

/// Adds the links of a search, or of the searches of a class.
void AddLinks(const TemplateCore& core, const CEL_Element& element, SearchLinks& links) {
  if (const auto* function = dynamic_cast<const CEL_Lagrange_Spatial_Function*>(&element)) {
    links.insert_or_assign(function->symbol.TextOf(), LinkOf(core, *function));
  } else if (const auto* specie = dynamic_cast<const CEL_Lagrange_Specie*>(&element)) {
    specie->ForEachMember([&core, &links](const CEL_Element& member) { AddLinks(core, member, links); });
  }
}

/// The class of that name, which is made where there is none.
CEL_Lagrange_Specie& ShellOf(TemplateCore& fragment, const CEL_Lagrange_Specie& specie) {
  for (const auto& each : fragment.Species()) {
    if (each->symbol.Text() == specie.symbol.Text()) return *each;
  }
  CEL_Lagrange_Specie& shell = fragment.AddSpecie();
  shell.TakeValuesOf(specie);
  shell.symbol.SetText(specie.symbol.Text());
  shell.horizontalVectors.clear();
  return shell;
}

/// Calls the visitor with the elements of the identities, those of classes with them, in the template's
/// order.
template <class Visitor>
void ForEachToCopy(const TemplateCore& core, const std::vector<Uid>& uids, Visitor visit) {
  const std::set<Uid> wanted(uids.begin(), uids.end());
  ForEachHeadedCollection([&core, &wanted, &visit](const auto& row) {
    for (const auto& element : core.Elements().*row.elements) {
      if (wanted.contains(element->GetUid())) visit(*element, static_cast<CEL_Lagrange_Specie*>(nullptr));
    }
  });
  for (const auto& specie : core.Species()) {
    if (wanted.contains(specie->GetUid())) {
      visit(*specie, static_cast<CEL_Lagrange_Specie*>(nullptr));
      continue;
    }
    ForEachMemberList([&specie, &wanted, &visit](const auto& list) {
      for (const auto& member : (*specie).*list.members) {
        if (wanted.contains(member->GetUid())) visit(*member, specie.get());
      }
    });
  }
}

/// The class to which the members of one of the text's classes go; none when there is none.
CEL_Lagrange_Specie* ClassFor(TemplateCore& core, const CEL_Lagrange_Specie& shell, const CopyPlace& place) {
  for (const auto& specie : core.Species()) {
    if (specie->GetUid() == place.specie) return specie.get();
  }
  for (const auto& specie : core.Species()) {
    if (specie->symbol.Text() == shell.symbol.Text()) return specie.get();
  }
  return nullptr;
}

}  // namespace

bool CanCopy(const CEL_Element& element) {
  return element.Kind() != ElementKind::VerticalEquation && element.Kind() >= ElementKind::StateVariable &&
         element.Kind() <= ElementKind::HorizontalVector;
}

CopiedText TextOfElements(const TemplateCore& core, const std::vector<Uid>& uids) {
  const MessagesAside aside;
  const ScannerRest rest;
  TemplateCore fragment;
  Copying copying(fragment);
  Beside beside;
  {
    const Quiet quiet(fragment);
    ForEachToCopy(
        core, uids,
        [&core, &fragment, &copying, &beside](const CEL_Element& element, CEL_Lagrange_Specie* owner) {
          copying.Copy(element, owner == nullptr ? nullptr : &ShellOf(fragment, *owner));
          AddLinks(core, element, beside.links);
          if (owner != nullptr) beside.shells.insert(owner->symbol.TextOf());
        });
  }
  if (copying.Top().empty()) return {};
  const NotificationsOff silent;
  fragment.RebuildSymbolTable();
  copying.Connect(beside.links);
  fragment.RefreshSearchFunctionChoices();
  CopiedText result;
  std::optional<std::string> text = fragment.CopyText(result.refusal);
  if (text) result.text = *text + TextBeside(beside);
  return result;
}

PastedElements PasteElements(TemplateCore& core, const std::string& text, const CopyPlace& place) {
  TemplateCore fragment;
  {
    const MessagesAside aside;
    const ScannerRest rest;
    if (!fragment.LoadText(text)) return {{}, std::string(kNoElements)};
  }
  Beside beside = BesideOf(text);
  const EditStep step(core.History());
  Copying copying(core);
  PastedElements pasted;
  bool lacksClass = false;
  {
    const Quiet quiet(core);
    ForEachHeadedCollection([&fragment, &copying](const auto& row) {
      for (const auto& element : fragment.Elements().*row.elements) copying.Copy(*element, nullptr);
    });
    for (const auto& specie : fragment.Species()) {
      if (!beside.shells.contains(specie->symbol.Text())) {
        copying.Copy(*specie, nullptr);
        continue;
      }
      CEL_Lagrange_Specie* owner = ClassFor(core, *specie, place);
      lacksClass = lacksClass || owner == nullptr;
      if (owner == nullptr) continue;
      ForEachMemberList([&specie, &copying, owner](const auto& list) {
        for (const auto& member : (*specie).*list.members) copying.Copy(*member, owner);
      });
    }
  }
  if (lacksClass) pasted.refusal = kNoClass;
  if (copying.Top().empty()) {
    if (!lacksClass) pasted.refusal = kNoElements;
    return pasted;
  }
  const NotificationsOff silent;
  core.RebuildSymbolTable();
  SearchLinks links;
  for (const auto& specie : fragment.Species()) AddLinks(fragment, *specie, links);
  for (auto& [symbol, link] : beside.links) links.insert_or_assign(symbol, link);
  copying.Connect(links);
  core.RefreshSearchFunctionChoices();
  core.SetModified(true);
  core.RebuildSymbolTable();
  Uid predecessor = place.after;
  for (CEL_Element* element : copying.Top()) {
    element->SetLoaded(true);
    pasted.uids.push_back(element->GetUid());
    if (core.MoveElement(element->GetUid(), predecessor, false)) predecessor = element->GetUid();
  }
  return pasted;
}

PastedElements DuplicateElements(TemplateCore& core, const std::vector<Uid>& uids) {
  std::vector<Uid> originals;
  ForEachToCopy(core, uids, [&originals](const CEL_Element& element, const CEL_Lagrange_Specie*) {
    originals.push_back(element.GetUid());
  });
  const CopiedText copied = TextOfElements(core, originals);
  if (copied.text.empty()) return {{}, copied.refusal};
  const EditStep step(core.History(), {});
  PastedElements pasted = PasteElements(core, copied.text, {});
  if (pasted.uids.size() == originals.size()) {
    for (std::size_t place = 0; place < originals.size(); ++place) {
      core.MoveElement(pasted.uids[place], originals[place], false);
    }
  }
  return pasted;
}

}  // namespace tessal
