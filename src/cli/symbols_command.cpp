#include <cmath>
#include <nlohmann/json.hpp>
#include <span>
#include <vector>

#include "cli/commands.h"
#include "cli/template_files.h"
#include "cli/template_messages.h"
#include "core/template_core.h"

namespace tessal::cli {

namespace {

using Json = nlohmann::ordered_json;

Json ListOf(std::span<const std::uint32_t> sequences) {
  return std::vector<std::uint32_t>(sequences.begin(), sequences.end());
}

/// The value of a field; null for an element that has none of that label.
Json ValueOf(const CEL_Element& element, std::string_view label) {
  const PropertyPlace place = element.PlaceWithLabel(label);
  if (place == nullptr) return nullptr;
  const CEL_Property& property = element.*place;
  if (property.Type() != ValueType::Real) return JsonText(std::string(property.Text()));
  // JSON has no number for those that are not finite.
  return std::isfinite(property.RealValue()) ? Json(property.RealValue()) : Json(nullptr);
}

Json ClassOf(const SymbolRecord& record, const TemplateCore& core) {
  if (record.specieIndex < 0) return nullptr;
  return JsonText(std::string(core.GetSpecie(static_cast<std::size_t>(record.specieIndex)).symbol.Text()));
}

Json LineOf(const CEL_Element& element) {
  return element.SourceLine() > 0 ? Json(element.SourceLine()) : Json(nullptr);
}

Json ToJson(const SymbolRecord& record, const TemplateCore& core) {
  return {{"sequence", record.sequence},
          {"symbol", JsonText(core.RecordSymbol(record))},
          {"kind", record.element->Kind()},
          {"kindText", record.element->KindText()},
          {"scope", record.scope},
          {"spatial", record.spatial},
          {"index", record.index},
          {"specie", record.specieIndex},
          {"text", JsonText(RecordText(record))},
          {"unit", ValueOf(*record.element, "Unit")},
          {"default", ValueOf(*record.element, "Default Value")},
          {"minimum", ValueOf(*record.element, "Min Value")},
          {"maximum", ValueOf(*record.element, "Max Value")},
          {"description", ValueOf(*record.element, "Description")},
          {"class", ClassOf(record, core)},
          {"line", LineOf(*record.element)},
          {"references", ListOf(record.references)},
          {"referencedBy", ListOf(record.referencedBy)}};
}

}  // namespace

ExitCode RunSymbols(const std::string& file, Format format) {
  TemplateCore& core = TheTemplate();
  if (!LoadOrComplain(core, file)) return kCallFault;
  if (format == Format::Json) {
    const EndsWithoutMemory end;
    Json table = Json::array();
    for (const SymbolRecord& record : core.SymbolTable()) table.push_back(ToJson(record, core));
    PrintLine(table.dump());
    return kFine;
  }
  for (const SymbolRecord& record : core.SymbolTable()) {
    PrintLine(std::to_string(record.sequence) + '\t' + OnOneLine(core.RecordSymbol(record)) + '\t' +
              std::string(record.element->KindText()) + '\t' + OnOneLine(RecordText(record)));
  }
  return kFine;
}

}  // namespace tessal::cli
