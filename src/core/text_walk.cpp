#include "core/text_walk.h"

#include <vector>

#include "core/template_core.h"

namespace tessal {

namespace {

using Visitor = std::function<void(const TextOfTemplate&)>;

class TextWalk final {
 public:
  TextWalk(const TemplateCore& walked, const Visitor& visitor) : core(walked), visit(visitor) {}

  void Run() {
    VisitElement(core.Root());
    ForEachHeadedCollection([this](const auto& row) {
      // The texts of another head lie in no file.
      if (row.writtenHead == row.listKind) VisitElement(core.ListHead(row.listKind));
      for (const auto& element : core.Elements().*row.elements) VisitElement(*element);
    });
    VisitSettings();
    for (const auto& specie : core.Species()) VisitSpecie(*specie);
  }

 private:
  void VisitElement(const CEL_Element& element) {
    texts.clear();
    element.AppendTexts(texts);
    for (const ElementText& text : texts) {
      const bool isSymbol = text.property == &element.symbol;
      // Other elements have a caption there, which no file holds.
      if (isSymbol && (!element.symbol.Editable() || !HasSymbol(element.Kind()))) continue;
      const bool isExpression = text.property->Type() == ValueType::Expression;
      visit({{element.GetUid(), text.label},
             isSymbol       ? TextRole::Symbol
             : isExpression ? TextRole::Expression
                            : TextRole::Text,
             element.Kind(),
             &element,
             text.property->Text(),
             !text.property->Editable()});
    }
  }

  static bool HasSymbol(ElementKind kind) {
    return kind >= ElementKind::StateVariable && kind <= ElementKind::ArithmeticExpression;
  }

  void VisitSettings() {
    const CEL_Miscanellous* settings = core.GetMisc();
    if (settings == nullptr) return;
    VisitElement(*settings);
    for (const auto& function : settings->ExternalFunctions()) VisitElement(*function);
    std::int32_t group = 0;
    for (const VisibilityGroup& each : settings->Visibilities().groups) {
      VisitNamed({Uid::None, {}, ++group}, each);
      std::int32_t level = 0;
      for (const VisibilityLevel& of : each.levels) VisitNamed({Uid::None, {}, group, ++level}, of);
    }
  }

  template <class Named>
  void VisitNamed(TextPlace place, const Named& named) {
    place.field = kNameField;
    visit({place, TextRole::Text, ElementKind::VisibilityGroup, nullptr, named.name});
    place.field = kDescriptionField;
    visit({place, TextRole::Text, ElementKind::VisibilityGroup, nullptr, named.description});
  }

  void VisitSpecie(const CEL_Lagrange_Specie& specie) {
    VisitElement(specie);
    ForEachMemberList([this, &specie](const auto& list) {
      VisitElement(specie.Head(list.listKind));
      for (const auto& member : specie.*list.members) VisitElement(*member);
    });
    VisitElement(specie.Head(ElementKind::VerticalEquationList));
    VisitElement(*specie.verticalEquation);
  }

  const TemplateCore& core;
  const Visitor& visit;
  std::vector<ElementText> texts;
};

const VisibilityGroup* GroupAt(const TemplateCore& core, const TextPlace& place) {
  const CEL_Miscanellous* settings = core.GetMisc();
  if (settings == nullptr) return nullptr;
  const auto& groups = settings->Visibilities().groups;
  const auto index = static_cast<std::size_t>(place.group - 1);
  return index < groups.size() ? &groups[index] : nullptr;
}

const VisibilityLevel* LevelAt(const TemplateCore& core, const TextPlace& place) {
  const VisibilityGroup* group = GroupAt(core, place);
  const auto index = static_cast<std::size_t>(place.level - 1);
  return group != nullptr && index < group->levels.size() ? &group->levels[index] : nullptr;
}

template <class Named>
const std::string* TextOf(const Named* named, std::string_view field) {
  if (named == nullptr) return nullptr;
  return field == kNameField ? &named->name : &named->description;
}

const std::string* GroupText(const TemplateCore& core, const TextPlace& place) {
  return place.level > 0 ? TextOf(LevelAt(core, place), place.field)
                         : TextOf(GroupAt(core, place), place.field);
}

bool SetGroupText(TemplateCore& core, const TextPlace& place, std::string_view text) {
  const std::string* former = GroupText(core, place);
  if (former == nullptr) return false;
  if (*former == text) return true;
  if (place.field == kNameField) {
    return place.level > 0 ? core.SetLevelName(place.group, place.level, text)
                           : core.SetGroupName(place.group, text);
  }
  if (place.level > 0) {
    core.SetLevelDescription(place.group, place.level, text);
  } else {
    core.SetGroupDescription(place.group, text);
  }
  return true;
}

}  // namespace

void ForEachText(const TemplateCore& core, const Visitor& visit) {
  TextWalk(core, visit).Run();
}

std::string OwnerName(const TemplateCore& core, const TextOfTemplate& text) {
  if (text.element == nullptr) {
    const VisibilityGroup* group = GroupAt(core, text.place);
    const VisibilityLevel* level = LevelAt(core, text.place);
    const std::string name = group == nullptr ? std::string() : group->name;
    return level == nullptr ? name : name + ": " + level->name;
  }
  if (text.kind == ElementKind::ExternalFunction)
    return static_cast<const CEL_ExternalFunction*>(text.element)->publicName.TextOf();
  const std::string symbol = text.element->FullSymbol();
  return symbol.empty() ? std::string(text.element->KindText()) : symbol;
}

TextsByPlace::TextsByPlace(TemplateCore& indexed) : core(indexed) {
  const auto add = [this](CEL_Element& element) { elements.emplace(element.GetUid(), &element); };
  add(core.Root());
  for (const auto& head : core.ListHeads()) add(*head);
  if (CEL_Miscanellous* settings = core.GetMisc()) {
    add(*settings);
    for (const auto& function : settings->ExternalFunctions()) add(*function);
  }
  for (const SymbolRecord& record : core.SymbolTable()) add(*record.element);
  for (const auto& specie : core.Species()) {
    for (const auto& head : specie->Heads()) add(*head);
  }
}

CEL_Property* TextsByPlace::PropertyAt(const TextPlace& place) const {
  const auto element = elements.find(place.element);
  if (element == elements.end()) return nullptr;
  const PropertyPlace property = element->second->PlaceWithLabel(place.field);
  return property == nullptr ? nullptr : &(element->second->*property);
}

std::string TextsByPlace::TextAt(const TextPlace& place) const {
  if (place.group > 0) {
    const std::string* text = GroupText(core, place);
    return text == nullptr ? std::string() : *text;
  }
  const CEL_Property* property = PropertyAt(place);
  return property == nullptr ? std::string() : std::string(property->Text());
}

bool TextsByPlace::SetText(const TextPlace& place, std::string_view text) {
  if (place.group > 0) return SetGroupText(core, place, text);
  CEL_Property* property = PropertyAt(place);
  return property != nullptr && property->SetText(text);
}

}  // namespace tessal
