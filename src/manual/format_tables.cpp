#include "manual/format_tables.h"

#include <algorithm>
#include <array>
#include <optional>
#include <stdexcept>

#include "core/template_core.h"
#include "elements/format_words.h"
#include "keyfile/item_tree.h"
#include "keyfile/keywords.h"
#include "keyfile/reader.h"

namespace tessal::manual {

namespace {

struct BaseRow {
  std::string_view keyword;
  PropertyPlace place;
};

/// The keywords that no class has in its table.
constexpr std::array<BaseRow, 8> kBaseRows = {{
    {key::kSymbol, &CEL_Element::symbol},
    {key::kName, &CEL_Element::symbol},
    {key::kId, &CEL_Element::id},
    {key::kDescription, &CEL_Element::description},
    {key::kOnlineHelp, &CEL_Element::onlineHelp},
    {key::kDocumentation, &CEL_Element::documentation},
    {key::kUnqType, &CEL_Element::unqType},
    {key::kUnqUnit, &CEL_Element::unqUnit},
}};

std::string_view TypeWord(ValueType type) {
  switch (type) {
    case ValueType::Real:
      return "real number";
    case ValueType::Integer:
      return "whole number";
    case ValueType::Expression:
      return "expression, in double quotes within the text";
    default:
      return "text";
  }
}

/// One element of each kind, and one visibility group with a level.
void FillWithAll(TemplateCore& core) {
  ForEachCollection([&core](const auto& row) { core.AddElement(row.kind); });
  CEL_Lagrange_Specie& specie = *core.Species().front();
  ForEachMemberList([&specie](const auto& list) { specie.AddMember(list.kind); });
  core.GetMisc()->AddExternalFunction();
  core.CreateLevel(core.AddVisibilityGroup());
  core.AddItemToLevel(1, 1, 1);
}

template <class Visitor>
void ForEachElement(TemplateCore& core, Visitor visit) {
  visit(*core.GetMisc());
  for (const auto& function : core.GetMisc()->ExternalFunctions()) visit(*function);
  ForEachCollection([&core, &visit](const auto& row) {
    for (const auto& element : core.Elements().*row.elements) visit(*element);
  });
  for (const auto& specie : core.Species()) specie->ForEachMember(visit);
}

std::string InFile(const CEL_Property& property, const CEL_Choice& choice) {
  if (property.Type() == ValueType::Boolean) return "'" + choice.display + "'";
  if (choice.kind == CEL_Choice::kNumber) return std::to_string(choice.intValue);
  return "'" + choice.fileText + "'";
}

class Reading final {
 public:
  explicit Reading(TemplateCore& template_) : core(template_) {}

  FormatTables Read() {
    std::string reason;
    const std::optional<std::string> text = core.CopyText(reason);
    CKvfItemTree tree;
    if (!text || ParseKeyFileTree(*text, tree) == 0) throw std::logic_error("the sample can not be read");
    ReadSections(tree, "");
    ForEachElement(core, [this](CEL_Element& element) { NoteProperties(element); });
    NoteSearchChoices();
    for (const KeywordEntry& entry : tables.keywords) {
      if (entry.meaning.empty()) throw std::logic_error("nobody has explained the keyword " + entry.name);
    }
    return std::move(tables);
  }

 private:
  void ReadSections(const CKvfSectionItem& around, const std::string& path) {
    for (CKvfBaseItem& item : around.Children()) {
      if (item.ItemKind() != CKvfBaseItem::kSection) continue;
      const SectionWord* word = WordOfSection(item.Name());
      if (word == nullptr) {
        throw std::logic_error("nobody has explained the section " + std::string(item.Name()));
      }
      const bool isKnown = std::any_of(
          tables.sections.begin(), tables.sections.end(),
          [&](const WrittenSection& each) { return each.name == word->name && each.path == path; });
      if (isKnown) continue;
      tables.sections.push_back({std::string(word->name), path, word->meaning, {}});
      ReadKeywords(static_cast<const CKvfSectionItem&>(item));
      std::string within = path;
      if (!within.empty()) within += " / ";
      within += word->name;
      if (word->IsNumbered()) within += 'N';
      ReadSections(static_cast<const CKvfSectionItem&>(item), within);
    }
  }

  void ReadKeywords(const CKvfSectionItem& section) {
    std::vector<WrittenKeyword>& keywords = tables.sections.back().keywords;
    // The keyword of an equation is a symbol.
    if (tables.sections.back().name == section::kStateVariableEquationPrefix) return;
    for (CKvfBaseItem& item : section.Children()) {
      if (item.ItemKind() != CKvfBaseItem::kKeyword) continue;
      std::string value;
      for (const KvfValue& each : static_cast<const CKvfKeyItem&>(item).Values()) {
        if (!value.empty()) value += ", ";
        each.AppendTo(value);
      }
      keywords.push_back({std::string(item.Name()), value});
      if (Find(item.Name()) != nullptr) continue;
      tables.keywords.push_back({std::string(item.Name()), {}, MeaningOfKeyword(item.Name()), {}});
    }
  }

  KeywordEntry* Find(std::string_view keyword) {
    const auto hit = std::find_if(tables.keywords.begin(), tables.keywords.end(),
                                  [keyword](const KeywordEntry& entry) { return entry.name == keyword; });
    return hit == tables.keywords.end() ? nullptr : &*hit;
  }

  void NoteProperties(const CEL_Element& element) {
    for (const PropertyRow& row : element.Rows()) {
      // What is written under a foreign keyword has the choices of its own.
      if (row.writtenAs.empty()) NoteProperty(row.keyword, element.*row.place);
    }
    for (const BaseRow& row : kBaseRows) NoteProperty(row.keyword, element.*row.place);
  }

  void NoteProperty(std::string_view keyword, const CEL_Property& property) {
    KeywordEntry* entry = Find(keyword);
    if (entry == nullptr) return;
    entry->type = TypeWord(property.Type());
    const std::string_view field = FieldOfKeyword(keyword);
    for (const CEL_Choice& choice : property.Choices()) {
      const std::string value = InFile(property, choice);
      const bool isKnown = std::any_of(entry->choices.begin(), entry->choices.end(),
                                       [&value](const KeywordChoice& each) { return each.value == value; });
      if (isKnown) continue;
      std::string meaning = MeaningOfChoice(field, choice.display);
      const bool saysMore =
          value.find(choice.display) == std::string::npos || value.size() > choice.display.size() + 2;
      if (saysMore) meaning.insert(0, choice.display + ". ");
      entry->choices.push_back({value, meaning});
    }
  }

  /// What a search offers follows from its framework and its purpose.
  void NoteSearchChoices() {
    CEL_Lagrange_Spatial_Function& search = *core.Species().front()->spatialFunctions.front();
    const std::vector<CEL_Choice> frameworks = search.framework.Choices();
    for (const CEL_Choice& framework : frameworks) {
      search.framework.SetText(framework.fileText);
      search.FollowValues();
      const std::vector<CEL_Choice> purposes = search.purpose.Choices();
      for (const CEL_Choice& purpose : purposes) {
        search.purpose.SetText(purpose.fileText);
        search.FollowValues();
        NoteProperties(search);
      }
    }
  }

  TemplateCore& core;
  FormatTables tables;
};

}  // namespace

FormatTables ReadFormat() {
  TemplateCore core;
  core.Clear();
  FillWithAll(core);
  return Reading(core).Read();
}

}  // namespace tessal::manual
