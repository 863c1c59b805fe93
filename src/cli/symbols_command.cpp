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
