#include <nlohmann/json.hpp>

#include "cli/commands.h"
#include "cli/template_files.h"
#include "cli/template_messages.h"
#include "core/template_core.h"

namespace tessal::cli {

namespace {

using Json = nlohmann::ordered_json;

Json ToJson(const SymbolRecord& record, const TemplateCore& core) {
  return {{"sequence", record.sequence},
          {"symbol", JsonText(core.RecordSymbol(record))},
          {"kind", record.element->Kind()},
          {"kindText", record.element->KindText()},
          {"scope", record.scope},
          {"spatial", record.spatial},
          {"index", record.index},
          {"specie", record.specieIndex},
          {"text", JsonText(record.text)},
          {"references", record.references},
          {"referencedBy", record.referencedBy}};
}

}  // namespace

ExitCode RunSymbols(const std::string& file, Format format) {
  TemplateCore core;
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
              std::string(record.element->KindText()) + '\t' + OnOneLine(record.text));
  }
  return kFine;
}

}  // namespace tessal::cli
