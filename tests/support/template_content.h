// Everything that a template's file holds, as text: two templates of the same content are the same to a user.
// For tests and fuzz targets alike.
#pragma once

#include <algorithm>
#include <string>
#include <vector>

#include "core/template_core.h"

namespace tessal::test {

/// What a file does not hold: the names of derived outputs, which their places give; the units of elements
/// without unit data; and the revision, which counts the saves.
inline bool IsInNoFile(const CEL_Element& element, const std::string& field) {
  switch (element.Kind()) {
    case ElementKind::DerivedOutput:
      return field == "Symbol";
    case ElementKind::SpecieForcing:
    case ElementKind::SpatialFunction:
    case ElementKind::ExternalFunction:
      return field.starts_with("UNQ ");
    case ElementKind::Miscellaneous:
      return field.starts_with("UNQ ") || field == "Symbol" || field == "ID" || field == "Revision";
    default:
      return false;
  }
}

inline std::string TextsOf(const CEL_Element& head) {
  return head.description.TextOf() + "|" + head.onlineHelp.TextOf() + "|" + head.documentation.TextOf() +
         "\n";
}

inline std::string FieldsOf(const CEL_Element& element) {
  std::vector<ElementField> fields;
  element.GetFields(fields);
  std::string text;
  for (const ElementField& field : fields) {
    if (!IsInNoFile(element, field.name)) text += field.name + "=" + FieldText(field) + "\n";
  }
  auto memberships = element.Visibility();
  std::sort(memberships.begin(), memberships.end());
  for (const auto& [group, level] : memberships) {
    text += "member of " + std::to_string(group) + "/" + std::to_string(level) + "\n";
  }
  return text;
}

/// The list heads. That of the auxiliaries is left out: a file holds the texts of the constants' in its
/// place.
inline std::string HeadsContent(const TemplateCore& core) {
  std::string text = TextsOf(core.Root());
  for (const auto& head : core.ListHeads()) {
    if (head->Kind() != ElementKind::AuxiliaryList) text += TextsOf(*head);
  }
  for (const auto& specie : core.Species()) {
    for (const auto& head : specie->Heads()) {
      if (head->Kind() < ElementKind::HorizontalVectorList) text += TextsOf(*head);
    }
  }
  return text;
}

inline std::string SettingsContent(TemplateCore& core) {
  CEL_Miscanellous* misc = core.GetMisc();
  if (misc == nullptr) return "no settings\n";
  std::string text = FieldsOf(*misc);
  if (!misc->ExternalFunctions().empty()) text += TextsOf(misc->ExternalFunctionHead());
  for (const auto& function : misc->ExternalFunctions()) text += FieldsOf(*function);
  const auto& groups = misc->Visibilities().groups;
  if (!groups.empty()) text += TextsOf(misc->Visibilities());
  for (std::size_t group = 0; group < groups.size(); ++group) {
    text += groups[group].name + "|" + groups[group].description + "\n";
    for (std::size_t level = 0; level < groups[group].levels.size(); ++level) {
      text += groups[group].levels[level].name + "|" + groups[group].levels[level].description + ":";
      std::vector<std::int32_t> items;
      core.CollectItems(static_cast<std::int32_t>(group + 1), static_cast<std::int32_t>(level + 1), items,
                        false);
      for (const std::int32_t item : items) text += " " + std::to_string(item);
      text += "\n";
    }
  }
  return text;
}

inline std::string TemplateContent(TemplateCore& core) {
  std::string text = HeadsContent(core) + SettingsContent(core);
  for (const SymbolRecord& record : core.SymbolTable()) text += FieldsOf(*record.element);
  return text + core.KeptText();
}

}  // namespace tessal::test
