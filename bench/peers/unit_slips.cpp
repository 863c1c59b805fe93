#include "unit_slips.h"

#include <algorithm>
#include <cstdint>
#include <optional>
#include <string_view>
#include <utility>

#include "analysis/declared_values.h"
#include "analysis/symbol_index.h"
#include "analysis/unit_text.h"
#include "core/template_core.h"
#include "expr/node_span.h"

namespace tessal::bench {

namespace {

std::string Replaced(const std::string& text, std::size_t start, std::size_t length,
                     const std::string& with) {
  return std::string(text).replace(start, length, with);
}

constexpr std::string_view kUnitKey = "UNIT = '";

/// Where the units of the template's own elements are in its text: place and length.
std::vector<std::pair<std::size_t, std::size_t>> UnitPlaces(const std::string& text) {
  std::vector<std::pair<std::size_t, std::size_t>> places;
  const std::size_t end = std::min(text.find("[LAGRANGE]"), text.size());
  for (std::size_t start = text.find(kUnitKey); start < end; start = text.find(kUnitKey, start + 1)) {
    // Not the last letters of another keyword.
    if (start == 0 || text[start - 1] != ' ') continue;
    const std::size_t first = start + kUnitKey.size();
    places.emplace_back(first, text.find('\'', first) - first);
  }
  return places;
}

/// The text with another unit in a place.
UnitSlip WithUnit(const std::string& text, std::size_t start, std::size_t length, const std::string& unit) {
  return {text.substr(start, length).append(" -> ").append(unit), Replaced(text, start, length, unit)};
}

/// A word of a unit and one for the same quantity in another size.
constexpr std::pair<std::string_view, std::string_view> kOtherSizes[] = {
    {"/d", "/s"},   {"1/d", "1/s"}, {"mg/l", "kg/l"},  {"g/m2", "kg/m2"},     {"mmol", "mol"},
    {"m/d", "m/s"}, {"g ", "kg "},  {"W/m2", "kW/m2"}, {"mol/m3", "mmol/m3"}, {"1/m", "1/km"}};

bool HasDimension(const SymbolIndex& index, std::string_view symbol) {
  const SymbolRecord* record = index.Find(symbol);
  const auto unit = record == nullptr ? std::nullopt : DeclaredUnit(*record->element);
  const auto read = unit ? ReadUnitText(*unit) : std::nullopt;
  return read && !IsDimensionless(*read);
}

/// What goes when a factor is left out: the factor and the sign that joins it, as a place of the text. None
/// for a dividend, and where a bracket lies between the two.
std::optional<std::pair<std::size_t, std::size_t>> FactorWithSign(const ExpressionNode& product,
                                                                  std::int32_t slot, std::string_view text) {
  const LexemeSpan span = SpanOf(*product.Child(slot), text);
  const auto start = static_cast<std::size_t>(span.start);
  const std::size_t end = start + static_cast<std::size_t>(span.length);
  const std::size_t sign =
      slot == 1 ? text.find_first_not_of(' ', end) : text.find_last_not_of(' ', start == 0 ? 0 : start - 1);
  if (sign == std::string_view::npos || text.substr(sign, 1) != product.Text()) return std::nullopt;
  if (slot == 2) return std::pair(sign, end - sign);
  if (product.Text() == "/") return std::nullopt;
  return std::pair(start, sign + 1 - start);
}

/// Adds the slips of one expression, which begins at a place of the text.
void AddLeftOutFactors(const SymbolIndex& index, const std::string& user, const RecordExpression& expression,
                       const std::string& text, std::size_t start, std::vector<UnitSlip>& slips) {
  std::vector<const ExpressionNode*> open{expression.tree};
  while (!open.empty()) {
    const ExpressionNode& node = *open.back();
    open.pop_back();
    const bool isProduct = node.Kind() == NodeKind::Arithmetic && (node.Text() == "*" || node.Text() == "/");
    for (std::int32_t slot = node.ChildCount(); slot >= 1; --slot) {
      const ExpressionNode& child = *node.Child(slot);
      open.push_back(&child);
      if (!isProduct || child.Kind() != NodeKind::Identifier || !HasDimension(index, child.Text())) continue;
      const auto place = FactorWithSign(node, slot, expression.text);
      if (!place) continue;
      slips.push_back({user + " without " + std::string(child.Text()),
                       Replaced(text, start + place->first, place->second, "")});
    }
  }
}

}  // namespace

std::vector<UnitSlip> UnitsOfOtherDimensions(const std::string& text) {
  std::vector<UnitSlip> slips;
  for (const auto& [start, length] : UnitPlaces(text)) {
    const std::string unit = text.substr(start, length);
    const auto read = ReadUnitText(unit);
    if (!read) continue;
    const std::string other = HaveSameDimension(*read, *ReadUnitText("m")) ? "kg" : "m";
    slips.push_back(WithUnit(text, start, length, other));
  }
  return slips;
}

std::vector<UnitSlip> UnitsOfOtherSizes(const std::string& text) {
  std::vector<UnitSlip> slips;
  for (const auto& [start, length] : UnitPlaces(text)) {
    const std::string unit = text.substr(start, length);
    const auto read = ReadUnitText(unit);
    for (const auto& [word, other] : kOtherSizes) {
      if (!read || !unit.starts_with(word)) continue;
      const std::string changed = std::string(other) + unit.substr(word.size());
      const auto changedRead = ReadUnitText(changed);
      if (!changedRead || !HaveSameDimension(*read, *changedRead) || HaveSameFactor(*read, *changedRead))
        continue;
      slips.push_back(WithUnit(text, start, length, changed));
      break;
    }
  }
  return slips;
}

std::vector<UnitSlip> FactorsLeftOut(const std::string& path, const std::string& text) {
  TemplateCore core;
  if (!core.LoadWrapper(path)) return {};
  const SymbolIndex index(core);
  std::vector<UnitSlip> slips;
  for (const SymbolRecord& record : core.SymbolTable()) {
    const RecordExpression expression = ExpressionOf(record);
    if (expression.tree == nullptr || record.specieIndex >= 0) continue;
    constexpr std::string_view kBefore = "EXPRESSION = '\"";
    const std::size_t place = text.find(std::string(kBefore) + std::string(expression.text) + "\"'");
    if (place == std::string::npos) continue;
    AddLeftOutFactors(index, RecordSymbol(record), expression, text, place + kBefore.size(), slips);
  }
  return slips;
}

}  // namespace tessal::bench
