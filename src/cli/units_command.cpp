// Checks the units of a template, and lists how they were read.
#include <nlohmann/json.hpp>

#include "analysis/unit_check.h"
#include "analysis/unit_database.h"
#include "cli/commands.h"
#include "cli/finding_report.h"
#include "cli/template_files.h"
#include "cli/template_messages.h"
#include "core/template_core.h"

namespace tessal::cli {

namespace {

using Json = nlohmann::ordered_json;

void PrintEntry(const std::string& symbol, const std::string& text) {
  PrintLine(ForTerminal(OnOneLine(symbol) + ": " + OnOneLine(text)));
}

void PrintText(const UnitReport& report) {
  for (const UnitFinding& unit : report.findings) PrintEntry(unit.finding.symbol, unit.finding.text);
  for (const UnknownUnit& unknown : report.unknown) {
    PrintEntry(unknown.symbol, Finding("unit-unknown", {unknown.unit}).text);
  }
}

void PrintJson(const UnitReport& report) {
  Json findings = Json::array();
  for (const UnitFinding& unit : report.findings) {
    findings.push_back({{"symbol", JsonText(unit.finding.symbol)},
                        {"code", unit.finding.message->code},
                        {"expression", JsonText(unit.expression)},
                        {"left", JsonText(unit.left)},
                        {"right", JsonText(unit.right)},
                        {"text", JsonText(unit.finding.text)}});
  }
  Json unknown = Json::array();
  for (const UnknownUnit& entry : report.unknown) {
    unknown.push_back({{"symbol", JsonText(entry.symbol)}, {"unit", JsonText(entry.unit)}});
  }
  PrintLine(Json{{"findings", std::move(findings)}, {"unknown", std::move(unknown)}}.dump());
}

void PrintForHosts(Format format, const std::string& path, const TemplateCore& core,
                   const UnitReport& report) {
  std::vector<AnalysisFinding> findings;
  for (const UnitFinding& unit : report.findings) findings.push_back(unit.finding);
  const FileReport file = ReportOf(path, core, findings);
  PrintReport(format, {&file, 1}, {"units", AnalysisMessages()});
}

void PrintList(const TemplateCore& core, Format format) {
  const std::vector<UnitReading> readings = ListUnits(core);
  if (format != Format::Json) {
    for (const UnitReading& reading : readings) {
      PrintLine(ForTerminal(OnOneLine(reading.text) + "\t" + reading.read + "\t" + reading.substance + "\t" +
                            std::to_string(reading.uses)));
    }
    return;
  }
  Json units = Json::array();
  for (const UnitReading& reading : readings) {
    const bool isRead = !reading.read.empty();
    units.push_back({{"text", JsonText(reading.text)},
                     {"read", isRead ? Json(reading.read) : Json()},
                     {"substance", reading.substance},
                     {"uses", reading.uses}});
  }
  PrintLine(Json{{"units", std::move(units)}}.dump());
}

}  // namespace

ExitCode RunUnits(const UnitsCall& call) {
  if (call.isList && call.format != Format::Text && call.format != Format::Json) {
    Complain("--list prints text or json");
    return kCallFault;
  }
  TemplateCore& core = TheTemplate();
  if (!LoadOrComplain(core, call.file)) return kCallFault;
  // The libraries of units and of JSON lose the exception.
  const EndsWithoutMemory end;
  if (!UnitDatabaseFailure().empty()) {
    Complain(UnitDatabaseFailure());
    return kCallFault;
  }
  if (call.isList) {
    PrintList(core, call.format);
    return kFine;
  }
  const UnitReport report = CheckUnits(core, call.isStrict ? Substances::Dimensions : Substances::Ignored);
  if (call.format == Format::Json) {
    PrintJson(report);
  } else if (call.format == Format::Text) {
    PrintText(report);
  } else {
    PrintForHosts(call.format, call.file, core, report);
  }
  return report.findings.empty() ? kFine : kContentFault;
}

}  // namespace tessal::cli
