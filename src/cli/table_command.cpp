// Prints the tables of a model for pages, spreadsheets, scripts and papers.
#include <algorithm>
#include <charconv>
#include <cmath>
#include <filesystem>
#include <nlohmann/json.hpp>

#include "cli/commands.h"
#include "cli/template_files.h"
#include "cli/template_messages.h"
#include "core/template_core.h"
#include "docgen/model_tables.h"
#include "docgen/table_text.h"
#include "expr/scanner.h"
#include "platform/text_encoding.h"

namespace tessal::cli {

namespace {

using Json = nlohmann::ordered_json;

/// A number as one, where JSON has it; else the text, or null for none.
Json ToJson(const std::string& cell, CellKind kind) {
  if (cell.empty()) return nullptr;
  double number = 0.0;
  const auto read = std::from_chars(cell.data(), cell.data() + cell.size(), number);
  const bool isNumber = kind == CellKind::Number && read.ec == std::errc() &&
                        read.ptr == cell.data() + cell.size() && std::isfinite(number);
  return isNumber ? Json(number) : Json(cell);
}

Json ToJson(const ModelTable& table) {
  Json columns = Json::array();
  for (const TableColumn& column : table.columns) columns.push_back(column.name);
  Json rows = Json::array();
  for (const auto& row : table.rows) {
    Json cells = Json::array();
    for (std::size_t column = 0; column < row.size(); ++column) {
      cells.push_back(ToJson(row[column], table.columns[column].kind));
    }
    rows.push_back(std::move(cells));
  }
  return {{"name", table.name},
          {"title", table.title},
          {"columns", columns},
          {"rows", rows},
          {"notes", table.notes}};
}

std::string TablesAsJson(std::span<const ModelTable> tables) {
  Json list = Json::array();
  for (const ModelTable& table : tables) list.push_back(ToJson(table));
  return Json{{"tables", list}}.dump() + "\n";
}

/// Leaves the table of that name alone. False, with the names on standard error, when there is none.
bool SelectOrComplain(std::vector<ModelTable>& tables, const std::string& name) {
  const auto hit = std::find_if(tables.begin(), tables.end(),
                                [&name](const ModelTable& table) { return table.name == name; });
  if (hit == tables.end()) {
    std::string names;
    for (const ModelTable& table : tables) names += (names.empty() ? "" : ", ") + table.name;
    Complain(OnOneLine("no table is called '" + name + "'; there are " + names));
    return false;
  }
  tables = {std::move(*hit)};
  return true;
}

std::string TextOf(const TableCall& call, const std::vector<ModelTable>& tables) {
  switch (call.format) {
    case Format::Csv:
      return TablesAsCsv(tables);
    case Format::Json:
      return TablesAsJson(tables);
    case Format::Latex:
      return call.isBody
                 ? TablesAsLatex(tables)
                 : TablesAsLatexDocument(tables, ToUtf8(std::filesystem::path(call.file).stem().string()));
    default:
      return TablesAsMarkdown(tables);
  }
}

}  // namespace

ExitCode RunTable(const TableCall& call) {
  TemplateCore& core = TheTemplate();
  if (!LoadOrComplain(core, call.file)) return kCallFault;
  const EndsWithoutMemory end;
  const ScannerRest rest;
  std::vector<ModelTable> tables = BuildModelTables(core);
  if (!call.only.empty() && !SelectOrComplain(tables, call.only)) return kCallFault;
  Print(ForTerminal(TextOf(call, tables)));
  return kFine;
}

}  // namespace tessal::cli
