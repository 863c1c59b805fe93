// From a name to its definition and its uses, and its new name.
#include "cli/lsp/features.h"
#include "cli/lsp/symbol_places.h"
#include "core/rename.h"
#include "expr/scanner.h"

namespace tessal::cli {

namespace {

enum HighlightKind : int { kRead = 2, kWrite = 3 };

std::optional<NameAtPlace> NameOf(const LoadedDocument& document, const Json& params) {
  return NameAt(document, PositionIn(document, params));
}

/// The places of the name at a position; none where there is no name, or a word of the language.
std::vector<SymbolPlace> PlacesAt(const LoadedDocument& document, const Json& params) {
  const std::optional<NameAtPlace> name = NameOf(document, params);
  if (!name) return {};
  return PlacesOf(document, name->record == nullptr ? name->name : name->record->element->symbol.Text());
}

/// The name at a position that a rename may change. Raises why it may not.
NameAtPlace RenamedName(const LoadedDocument& document, const Json& params) {
  const std::optional<NameAtPlace> name = NameOf(document, params);
  if (!name) throw RequestFailure(kRequestFailed, "There is no symbol here.");
  if (name->record == nullptr) {
    throw RequestFailure(kRequestFailed,
                         "'" + std::string(name->name) + "' is no symbol of an element of this template.");
  }
  const CEL_Element& element = *name->record->element;
  if (!element.symbol.Editable() || !document.OffsetOf(element.symbol.Text()))
    throw RequestFailure(kRequestFailed, "'" + std::string(name->name) + "' is fixed.");
  return *name;
}

/// The new name at a place. In "2a", which does not parse, a new name `e5` would become part of a number.
std::string NewTextAt(std::string_view source, const SymbolPlace& place, const std::string& newName) {
  const auto start = static_cast<std::size_t>(place.part.data() - source.data());
  const bool followsDigit = start > 0 && source[start - 1] >= '0' && source[start - 1] <= '9';
  return place.role == SymbolPlace::Role::Use && followsDigit ? ' ' + newName : newName;
}

}  // namespace

std::size_t PositionIn(const LoadedDocument& document, const Json& params) {
  return document.OffsetOf(params.at("position"));
}

Json LocationOf(const LoadedDocument& document, std::string_view part) {
  return {{"uri", document.Document().uri}, {"range", document.RangeOf(part)}};
}

Json Definition(const LoadedDocument& document, const Json& params) {
  const std::optional<NameAtPlace> name = NameOf(document, params);
  if (!name || name->record == nullptr) return nullptr;
  const std::string_view definition = DefinitionOf(document, *name->record->element);
  return definition.empty() ? Json(nullptr) : LocationOf(document, definition);
}

Json References(const LoadedDocument& document, const Json& params) {
  const bool withDeclaration = params.at("context").at("includeDeclaration").get<bool>();
  Json locations = Json::array();
  for (const SymbolPlace& place : PlacesAt(document, params)) {
    if (place.role == SymbolPlace::Role::Use || withDeclaration)
      locations.push_back(LocationOf(document, place.part));
  }
  return locations;
}

Json Highlights(const LoadedDocument& document, const Json& params) {
  Json highlights = Json::array();
  for (const SymbolPlace& place : PlacesAt(document, params)) {
    highlights.push_back({{"range", document.RangeOf(place.part)},
                          {"kind", place.role == SymbolPlace::Role::Use ? kRead : kWrite}});
  }
  return highlights;
}

Json PrepareRename(const LoadedDocument& document, const Json& params) {
  const NameAtPlace name = RenamedName(document, params);
  return {{"range", document.RangeOf(name.name)}, {"placeholder", name.name}};
}

Json Rename(const LoadedDocument& document, const Json& params) {
  const auto& newName = params.at("newName").get_ref<const std::string&>();
  const NameAtPlace name = RenamedName(document, params);
  const std::string refusal = RenameRefusal(document.Core(), newName);
  if (!refusal.empty()) throw RequestFailure(kRequestFailed, refusal);
  Json edits = Json::array();
  for (const SymbolPlace& place : PlacesOf(document, name.record->element->symbol.Text())) {
    edits.push_back({{"range", document.RangeOf(place.part)},
                     {"newText", NewTextAt(document.Core().SourceText(), place, newName)}});
  }
  Json changes = Json::object();
  changes[document.Document().uri] = std::move(edits);
  return {{"changes", std::move(changes)}};
}

}  // namespace tessal::cli
