#include "expr/function_reference.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <numeric>
#include <utility>

#include "expr/carbonate/option_tables.h"
#include "expr/function_reference_rows.h"
#include "platform/ascii.h"
#include "platform/number_text.h"

namespace tessal {

namespace {

constexpr std::string_view kAny = "any";
constexpr std::string_view kUnknown = "unknown";
constexpr std::string_view kOfArgument = "as ";
constexpr char kPowerSign = '^';

std::vector<FunctionGroup> AllGroups() {
  std::vector<FunctionGroup> groups;
  for (const std::span<const FunctionGroup> part :
       {GeneralFunctionGroups(), SeaWaterFunctionGroups(), DeprecatedFunctionGroups()}) {
    groups.insert(groups.end(), part.begin(), part.end());
  }
  return groups;
}

std::optional<std::size_t> ArgumentNamed(const FunctionReference& function, std::string_view name) {
  const auto hit = std::find_if(function.arguments.begin(), function.arguments.end(),
                                [name](const ArgumentReference& argument) { return argument.name == name; });
  if (hit == function.arguments.end()) return std::nullopt;
  return static_cast<std::size_t>(hit - function.arguments.begin());
}

template <typename Options>
std::vector<std::string_view> SourcesOf(const Options& options) {
  std::vector<std::string_view> sources;
  sources.reserve(options.size());
  for (const auto& option : options) sources.push_back(option.source);
  return sources;
}

/// Takes a power into a rule: a number, or the name of the argument that has it.
bool ReadPower(const FunctionReference& function, std::string_view text, UnitRule& rule) {
  rule.powerArgument = ArgumentNamed(function, text);
  if (rule.powerArgument) return true;
  const char* end = text.data() + text.size();
  const auto read = std::from_chars(text.data(), end, rule.power);
  return read.ec == std::errc() && read.ptr == end;
}

std::string PowerInWords(const FunctionReference& function, const UnitRule& rule) {
  if (rule.powerArgument) {
    return ", to the power of " + std::string(function.arguments[*rule.powerArgument].name);
  }
  if (rule.power == 1) return {};
  return rule.power == 2 ? ", squared" : ", to the power of " + ShortestNumberText(rule.power);
}

/// How many letters must change, come or go to make one name of the other (Levenshtein 1966, Sov. Phys. Dokl.
/// 10:707-710).
std::size_t EditDistance(std::string_view from, std::string_view to) {
  std::vector<std::size_t> row(to.size() + 1);
  std::iota(row.begin(), row.end(), std::size_t{0});
  for (std::size_t line = 1; line <= from.size(); ++line) {
    std::size_t diagonal = std::exchange(row[0], line);
    for (std::size_t place = 1; place <= to.size(); ++place) {
      const bool same = UpperCase(from[line - 1]) == UpperCase(to[place - 1]);
      const std::size_t replaced = diagonal + (same ? 0 : 1);
      diagonal = row[place];
      row[place] = std::min({replaced, row[place] + 1, row[place - 1] + 1});
    }
  }
  return row.back();
}

}  // namespace

std::span<const FunctionGroup> FunctionGroups() {
  static const std::vector<FunctionGroup> kGroups = AllGroups();
  return kGroups;
}

const FunctionReference* ReferenceOfFunction(std::string_view name) {
  for (const FunctionGroup& group : FunctionGroups()) {
    for (const FunctionReference& function : group.functions) {
      if (EqualIgnoringCase(function.name, name)) return &function;
    }
  }
  return nullptr;
}

const FunctionGroup& GroupOfFunction(const FunctionReference& function) {
  const std::span<const FunctionGroup> groups = FunctionGroups();
  return *std::find_if(groups.begin(), groups.end(), [&function](const FunctionGroup& group) {
    return std::any_of(group.functions.begin(), group.functions.end(),
                       [&function](const FunctionReference& row) { return row.name == function.name; });
  });
}

std::vector<std::string_view> FormulaeOf(const FunctionReference& function) {
  struct Row {
    std::string_view name;
    std::vector<std::string_view> (*sources)();
  };
  static constexpr Row kRows[] = {
      {"SET_K1K2_OPTION", [] { return SourcesOf(kCarbonicAcidOptions); }},
      {"SET_KW_OPTION", [] { return SourcesOf(kWaterOptions); }},
      {"SET_KB_OPTION", [] { return SourcesOf(kBoricAcidOptions); }},
      {"SET_KS_OPTION", [] { return SourcesOf(kBisulphateOptions); }},
      {"SET_FH_OPTION", [] { return SourcesOf(kActivityOptions); }},
      {"SET_B_OPTION", [] { return SourcesOf(kBoronOptions); }},
  };
  for (const Row& row : kRows) {
    if (row.name == function.name) return row.sources();
  }
  return {};
}

std::string CallText(const FunctionReference& function) {
  std::string text(function.name);
  text += '(';
  for (const ArgumentReference& argument : function.arguments) {
    if (&argument != function.arguments.data()) text += ", ";
    text += argument.name;
  }
  return text += ')';
}

std::optional<UnitRule> RuleOfUnit(const FunctionReference& function, std::string_view unit) {
  if (unit == kAny) return UnitRule{.kind = UnitRule::Kind::Any};
  if (unit == kUnknown) return UnitRule{.kind = UnitRule::Kind::Unknown};
  if (!unit.starts_with(kOfArgument)) return UnitRule{.kind = UnitRule::Kind::Fixed, .unit = unit};
  UnitRule rule{.kind = UnitRule::Kind::OfArgument};
  const std::string_view name = unit.substr(kOfArgument.size());
  const std::size_t sign = name.find(kPowerSign);
  const std::optional<std::size_t> argument = ArgumentNamed(function, name.substr(0, sign));
  if (!argument) return std::nullopt;
  rule.argument = *argument;
  if (sign != std::string_view::npos && !ReadPower(function, name.substr(sign + 1), rule))
    return std::nullopt;
  return rule;
}

std::string UnitInWords(const FunctionReference& function, std::string_view unit) {
  const std::optional<UnitRule> rule = RuleOfUnit(function, unit);
  if (rule && rule->kind == UnitRule::Kind::Any) return "any unit";
  if (!rule || rule->kind != UnitRule::Kind::OfArgument) return std::string(unit);
  return "the unit of " + std::string(function.arguments[rule->argument].name) +
         PowerInWords(function, *rule);
}

std::vector<std::string_view> NearestNames(std::string_view typed, std::span<const std::string_view> names) {
  constexpr std::size_t kMostNames = 3;
  // About one letter in three may be wrong, none of a single one.
  const std::size_t farthest = (typed.size() + 1) / 3;
  std::vector<std::pair<std::size_t, std::string_view>> near;
  for (const std::string_view name : names) {
    const std::size_t shorter = std::min(name.size(), typed.size());
    if (std::max(name.size(), typed.size()) - shorter > farthest) continue;
    const std::size_t distance = EditDistance(typed, name);
    if (distance <= farthest) near.emplace_back(distance, name);
  }
  std::stable_sort(near.begin(), near.end(),
                   [](const auto& left, const auto& right) { return left.first < right.first; });
  if (near.size() > kMostNames) near.resize(kMostNames);
  std::vector<std::string_view> nearest;
  nearest.reserve(near.size());
  for (const auto& [distance, name] : near) nearest.push_back(name);
  return nearest;
}

}  // namespace tessal
