// The sections of a template as an editor lists and folds them.
#include <algorithm>
#include <string>

#include "cli/lsp/features.h"
#include "cli/lsp/symbol_places.h"
#include "keyfile/keywords.h"
#include "platform/ascii.h"

namespace tessal::cli {

namespace {

/// The format nests sections six deep; what a damaged file has below that is not listed.
constexpr std::size_t kDeepest = 16;

enum SymbolKind : int {
  kModule = 2,
  kNamespace = 3,
  kClass = 5,
  kMethod = 6,
  kField = 8,
  kInterface = 11,
  kFunction = 12,
  kVariable = 13,
  kConstant = 14,
  kEvent = 24,
  kOperator = 25
};

struct KindRow {
  ElementKind kind;
  SymbolKind shown;
};

constexpr KindRow kKinds[] = {
    {ElementKind::StateVariable, kVariable},
    {ElementKind::Constant, kConstant},
    {ElementKind::Forcing, kInterface},
    {ElementKind::Auxiliary, kFunction},
    {ElementKind::Process, kEvent},
    {ElementKind::DerivedOutput, kField},
    {ElementKind::Specie, kClass},
    {ElementKind::SpecieStateVariable, kVariable},
    {ElementKind::SpecieConstant, kConstant},
    {ElementKind::SpecieForcing, kInterface},
    {ElementKind::SpatialFunction, kMethod},
    {ElementKind::ArithmeticExpression, kFunction},
    {ElementKind::HorizontalVector, kOperator},
    {ElementKind::VerticalEquation, kOperator},
};

/// How deep each section lies.
std::vector<std::size_t> DepthsOf(const std::vector<OutlineSection>& sections) {
  std::vector<std::size_t> depths;
  depths.reserve(sections.size());
  for (const OutlineSection& section : sections)
    depths.push_back(section.parent ? depths[*section.parent] + 1 : 0);
  return depths;
}

Json SymbolOf(const LoadedDocument& document, std::size_t index) {
  const OutlineSection& section = document.Outline().Sections()[index];
  const std::string_view head = document.Text().substr(section.start, section.name.size() + 2);
  Json symbol = {{"name", section.name.empty() ? "[]" : section.name}, {"kind", kNamespace}};
  Json selection = document.RangeOf(section.start, section.start + head.size());
  const CEL_Element* element = document.ElementAt(section.start);
  const auto own = element == nullptr ? std::nullopt : document.SectionOf(*element);
  if (element != nullptr && !element->symbol.Text().empty() && own) {
    const bool isEquation = *own != index && document.Outline().Sections()[index].name.starts_with(
                                                 section::kStateVariableEquationPrefix);
    if (*own == index || isEquation) {
      symbol["name"] = element->FullSymbol();
      symbol["detail"] = isEquation ? "equation" : element->KindText();
      symbol["kind"] = SymbolKindOf(element->Kind());
      const auto place = document.OffsetOf(element->symbol.Text());
      if (*own == index && place) selection = document.RangeOf(element->symbol.Text());
    }
  }
  symbol["range"] = document.RangeOf(section.start, section.end);
  symbol["selectionRange"] = std::move(selection);
  return symbol;
}

}  // namespace

int SymbolKindOf(ElementKind kind) {
  const auto row = std::find_if(std::begin(kKinds), std::end(kKinds),
                                [kind](const KindRow& each) { return each.kind == kind; });
  return row == std::end(kKinds) ? kModule : row->shown;
}

Json DocumentSymbols(const LoadedDocument& document, const Json& /*params*/) {
  const auto& sections = document.Outline().Sections();
  const std::vector<std::size_t> depths = DepthsOf(sections);
  std::vector<Json> symbols(sections.size());
  Json top = Json::array();
  // From the last to the first: a section comes after the one that it lies in.
  for (std::size_t index = sections.size(); index-- > 0;) {
    if (depths[index] > kDeepest) continue;
    Json symbol = SymbolOf(document, index);
    if (symbols[index].is_array()) {
      std::reverse(symbols[index].begin(), symbols[index].end());
      symbol["children"] = std::move(symbols[index]);
    }
    Json& list = sections[index].parent ? symbols[*sections[index].parent] : top;
    list.push_back(std::move(symbol));
  }
  std::reverse(top.begin(), top.end());
  return top;
}

Json FoldingRanges(const LoadedDocument& document, const Json& /*params*/) {
  Json ranges = Json::array();
  for (const OutlineSection& section : document.Outline().Sections()) {
    const Json range = document.RangeOf(section.start, section.end);
    const auto startLine = range["start"]["line"].get<std::size_t>();
    const auto endLine = range["end"]["line"].get<std::size_t>();
    if (endLine > startLine) ranges.push_back({{"startLine", startLine}, {"endLine", endLine}});
  }
  return ranges;
}

Json SymbolsWith(const LoadedDocument& document, const std::string& query) {
  const std::string letters = UpperCase(query);
  Json symbols = Json::array();
  ForEachElement(document.Core(), [&](const CEL_Element& element) {
    const std::string name = element.FullSymbol();
    const std::string_view definition = DefinitionOf(document, element);
    if (definition.empty() || name.empty() || UpperCase(name).find(letters) == std::string::npos) return;
    symbols.push_back({{"name", name},
                       {"kind", SymbolKindOf(element.Kind())},
                       {"location", LocationOf(document, definition)},
                       {"containerName", element.KindText()}});
  });
  return symbols;
}

}  // namespace tessal::cli
