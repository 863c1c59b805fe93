// What differs between two templates, by symbol and field.
#include <memory>
#include <nlohmann/json.hpp>

#include "cli/commands.h"
#include "cli/template_files.h"
#include "cli/template_messages.h"
#include "core/comparison.h"
#include "core/expression_difference.h"
#include "core/template_core.h"
#include "docgen/change_pages.h"

namespace tessal::cli {

namespace {

using Json = nlohmann::ordered_json;

constexpr std::string_view kPlaceField = "Comes after";

std::string_view WordOf(ChangeKind change) {
  switch (change) {
    case ChangeKind::Removed:
      return "removed";
    case ChangeKind::Added:
      return "added";
    case ChangeKind::Renamed:
      return "renamed";
    case ChangeKind::Changed:
      break;
  }
  return "changed";
}

/// Whether a line may have colour is one question; what is marked in it another.
std::string Marked(std::string_view text, const std::vector<TextPart>& parts, std::string_view colour) {
  const bool isColoured = WantsColour();
  const std::string open = isColoured ? "\x1b[" + std::string(colour) + "m" : "";
  return MarkedText(text, parts, open, isColoured ? "\x1b[0m" : "", OnOneLine);
}

/// What people call the item: of what has no symbol, the kind.
std::string NameOf(const SymbolChange& change) {
  return OnOneLine(change.symbol.empty() ? change.kind : change.symbol);
}

void PrintField(const SymbolChange& change, const FieldChange& field) {
  constexpr std::string_view kRed = "31";
  constexpr std::string_view kGreen = "32";
  if (field.field == kPlaceField) {
    const auto place = [](const std::string& former) {
      return former.empty() ? "first" : "after " + OnOneLine(former);
    };
    PrintLine("moved " + NameOf(change) + ": " + place(field.before) + " -> " + place(field.after));
    return;
  }
  ExpressionDifference difference;
  if (field.isExpression) difference = DifferenceOf(field.before, field.after);
  PrintLine("changed " + NameOf(change) + " " + field.field + ": " +
            Marked(field.before, difference.before, kRed) + " -> " +
            Marked(field.after, difference.after, kGreen));
}

void PrintText(const SymbolChange& change) {
  if (change.change == ChangeKind::Renamed) {
    PrintLine("renamed " + OnOneLine(change.formerSymbol) + " " + NameOf(change));
  } else if (change.change != ChangeKind::Changed) {
    PrintLine(std::string(WordOf(change.change)) + " " + NameOf(change) + " (" + OnOneLine(change.kind) +
              (change.specie.empty() ? "" : " of " + OnOneLine(change.specie)) + ")");
  }
  for (const FieldChange& field : change.fields) PrintField(change, field);
}

Json ToJson(const std::vector<TextPart>& parts) {
  Json list = Json::array();
  for (const TextPart& part : parts) list.push_back({part.start, part.end});
  return list;
}

Json ToJson(const FieldChange& field) {
  Json json = {
      {"field", JsonText(field.field)}, {"before", JsonText(field.before)}, {"after", JsonText(field.after)}};
  if (!field.isExpression) return json;
  const ExpressionDifference difference = DifferenceOf(field.before, field.after);
  json["removedParts"] = ToJson(difference.before);
  json["addedParts"] = ToJson(difference.after);
  return json;
}

Json ToJson(const SymbolChange& change) {
  Json fields = Json::array();
  for (const FieldChange& field : change.fields) fields.push_back(ToJson(field));
  Json json = {{"change", WordOf(change.change)},
               {"kind", JsonText(change.kind)},
               {"class", JsonText(change.specie)},
               {"symbol", JsonText(change.symbol)}};
  if (change.change == ChangeKind::Renamed) json["formerSymbol"] = JsonText(change.formerSymbol);
  json["fields"] = fields;
  return json;
}

void PrintJson(const std::vector<SymbolChange>& changes) {
  const EndsWithoutMemory end;
  Json list = Json::array();
  for (const SymbolChange& change : changes) list.push_back(ToJson(change));
  PrintLine(Json{{"changes", list}}.dump());
}

}  // namespace

ExitCode RunChanges(const std::string& former, const std::string& later, Format format) {
  TemplateCore& laterCore = TheTemplate();
  TemplateCore& formerCore = AnotherTemplate();
  if (!LoadOrComplain(formerCore, former) || !LoadOrComplain(laterCore, later)) return kCallFault;
  const std::vector<SymbolChange> changes = CompareBySymbol(formerCore, laterCore);
  switch (format) {
    case Format::Json:
      PrintJson(changes);
      break;
    case Format::Markdown:
      Print(ChangesMarkdown(changes, former, later));
      break;
    case Format::Html:
      Print(ChangesHtml(changes, former, later));
      break;
    default:
      for (const SymbolChange& change : changes) PrintText(change);
      break;
  }
  return changes.empty() ? kFine : kContentFault;
}

}  // namespace tessal::cli
