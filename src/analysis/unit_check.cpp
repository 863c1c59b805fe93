#include "analysis/unit_check.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <map>
#include <span>
#include <unordered_map>
#include <utility>

#include "analysis/declared_values.h"
#include "analysis/unit_inference.h"
#include "analysis/unit_spelling.h"
#include "core/template_core.h"
#include "elements/element.h"

namespace tessal {

namespace {

/// The times that a rate may be per.
struct TimeUnit {
  std::string_view name;
  double seconds;
};
constexpr std::array<TimeUnit, 7> kTimes = {{{"day", 86400},
                                             {"second", 1},
                                             {"hour", 3600},
                                             {"minute", 60},
                                             {"week", 604800},
                                             {"month", 2629743.8312},
                                             {"year", 31556925.9747}}};

/// The longest part of an expression that a text quotes.
constexpr std::size_t kLongestQuote = 100;

std::string Quoted(std::string_view expression) {
  constexpr std::string_view kLeftOut = "...";
  std::string quote;
  for (const char character : expression) {
    const bool isBlank = character == '\n' || character == '\r' || character == '\t' || character == ' ';
    if (isBlank && quote.ends_with(' ')) continue;
    quote += isBlank ? ' ' : character;
  }
  if (quote.size() <= kLongestQuote) return quote;
  constexpr std::size_t kHalf = kLongestQuote / 2;
  return quote.substr(0, kHalf) + " " + std::string(kLeftOut) + " " + quote.substr(quote.size() - kHalf);
}

Finding FindingOf(const UnitClash& clash, const std::string& quote) {
  switch (clash.kind) {
    case UnitClash::Kind::Sum:
      return {"unit-sum", {quote, clash.left, clash.right}};
    case UnitClash::Kind::Comparison:
      return {"unit-comparison", {quote, clash.left, clash.right}};
    case UnitClash::Kind::Branches:
      return {"unit-branches", {quote, clash.left, clash.right}};
    case UnitClash::Kind::Assignment:
      return {"unit-assignment", {quote, clash.left, clash.right}};
    case UnitClash::Kind::Argument:
      break;
  }
  return {"unit-argument", {quote, clash.left, clash.argument, clash.function, clash.right}};
}

bool HasEquation(ElementKind kind) {
  return kind == ElementKind::StateVariable || kind == ElementKind::SpecieStateVariable;
}

/// What the unit of an equation is the element's unit divided by; none where it is no time.
struct RateOf {
  bool isRate = false;
  const TimeUnit* time = nullptr;  ///< none where the factor is open
};

RateOf RateIn(const Unit& rate, const Unit& unit) {
  Unit time = unit;
  MultiplyBy(time, rate, -1);
  Unit second;
  second.Power(BaseUnit::Second) = 1;
  if (!HaveSameDimension(time, second)) return {};
  if (!rate.hasUnnamedAmount && !unit.hasUnnamedAmount && !time.substances.empty()) return {};
  if (time.isFactorOpen) return {true};
  const auto* const row = std::find_if(kTimes.begin(), kTimes.end(), [&time](const TimeUnit& candidate) {
    return IsNear(std::log(candidate.seconds), time.logFactor);
  });
  if (row == kTimes.end()) return {};
  return {true, row};
}

class UnitChecker final {
 public:
  UnitChecker(const TemplateCore& checked, Substances substances)
      : core(checked), inference(checked, substances) {}

  UnitReport Check() {
    for (const SymbolRecord& record : core.SymbolTable()) CheckRecord(record);
    AddOddTimes();
    std::stable_sort(found.begin(), found.end(),
                     [](const Placed& one, const Placed& other) { return one.sequence < other.sequence; });
    report.findings.reserve(found.size());
    for (Placed& placed : found) report.findings.push_back(std::move(placed.finding));
    return std::move(report);
  }

 private:
  struct Placed {
    std::uint32_t sequence;
    UnitFinding finding;
  };
  /// An equation and the time that it is per.
  struct Equation {
    const SymbolRecord* record;
    const TimeUnit* time;
    std::string unit;
  };

  void CheckRecord(const SymbolRecord& record) {
    const CEL_Element& element = *record.element;
    const std::optional<std::string_view> declared = DeclaredUnit(element);
    const std::optional<Unit> unit = inference.DeclaredOf(element);
    if (declared && !unit) {
      report.unknown.push_back({element.GetUid(), RecordSymbol(record), std::string(*declared)});
    }
    const RecordExpression expression = ExpressionOf(record);
    if (expression.tree == nullptr) return;
    std::vector<UnitClash> clashes;
    const ExpressionUnit value = inference.Infer(expression, clashes);
    for (const UnitClash& clash : clashes) AddClash(record, expression.text, clash);
    if (!unit || !value.IsCertain()) return;
    if (HasEquation(record.kind)) {
      CheckEquation(record, expression, value, *unit);
    } else if (!AreSame(value.unit, *unit)) {
      const std::string shown = ShownUnit(value);
      const std::string other(*declared);
      AddWhole(record, expression, {"unit-result", {Quoted(expression.text), shown, other}}, shown, other);
    }
  }

  void CheckEquation(const SymbolRecord& record, const RecordExpression& expression,
                     const ExpressionUnit& value, const Unit& unit) {
    const RateOf rate = RateIn(value.unit, unit);
    const std::string shown = ShownUnit(value);
    const std::string declared(DeclaredUnit(*record.element).value_or(""));
    if (!rate.isRate) {
      AddWhole(record, expression, {"unit-equation", {Quoted(expression.text), shown, declared}}, shown,
               declared);
    } else if (rate.time != nullptr) {
      equations[record.specieIndex].push_back({&record, rate.time, shown});
    }
  }

  /// The equations of the template, and those of a class, are each integrated over one time.
  void AddOddTimes() {
    for (const auto& [owner, ofOwner] : equations) {
      std::map<const TimeUnit*, std::size_t> counts;
      for (const Equation& equation : ofOwner) ++counts[equation.time];
      const auto most =
          std::max_element(counts.begin(), counts.end(),
                           [](const auto& one, const auto& other) { return one.second < other.second; });
      // With as many of one as of the others nobody knows which are odd.
      if (most->second * 2 <= ofOwner.size()) continue;
      for (const Equation& equation : ofOwner) {
        if (equation.time != most->first) AddOddTime(equation, *most->first);
      }
    }
  }

  void AddOddTime(const Equation& equation, const TimeUnit& usual) {
    const RecordExpression expression = ExpressionOf(*equation.record);
    AddWhole(*equation.record, expression,
             {"unit-time", {Quoted(expression.text), equation.time->name, usual.name}}, equation.unit,
             "per " + std::string(usual.name));
  }

  void AddClash(const SymbolRecord& record, std::string_view text, const UnitClash& clash) {
    const std::string_view part = text.substr(clash.place.start, clash.place.length);
    Add(record, FindingOf(clash, Quoted(part)), clash.place, part, clash.left, clash.right);
  }

  void AddWhole(const SymbolRecord& record, const RecordExpression& expression, const Finding& finding,
                const std::string& left, const std::string& right) {
    Add(record, finding, {0, 0}, expression.text, left, right);
  }

  void Add(const SymbolRecord& record, const Finding& finding, LexemeSpan place, std::string_view expression,
           const std::string& left, const std::string& right) {
    UnitFinding added{FindingAbout(*record.element, finding), std::string(expression), left, right};
    added.finding.symbol = RecordSymbol(record);
    added.finding.field = record.element->LabelOf(*record.expression);
    added.finding.place = place;
    found.push_back({record.sequence, std::move(added)});
  }

  const TemplateCore& core;
  UnitInference inference;
  UnitReport report;
  std::vector<Placed> found;
  std::map<std::int32_t, std::vector<Equation>> equations;  ///< by class, the template's own first
};

}  // namespace

UnitReport CheckUnits(const TemplateCore& core, Substances substances) {
  return UnitChecker(core, substances).Check();
}

std::vector<UnitReading> ListUnits(const TemplateCore& core) {
  std::vector<UnitReading> readings;
  std::unordered_map<std::string_view, std::size_t> places;
  for (const SymbolRecord& record : core.SymbolTable()) {
    const std::optional<std::string_view> text = DeclaredUnit(*record.element);
    if (!text) continue;
    const auto [place, isNew] = places.emplace(*text, readings.size());
    if (isNew) {
      UnitReading reading{std::string(*text), {}, {}, 0};
      if (const std::optional<Unit> unit = ReadUnitText(*text)) {
        reading.read = InBaseUnits(*unit);
        reading.substance = SubstanceText(*unit);
      }
      readings.push_back(std::move(reading));
    }
    ++readings[place->second].uses;
  }
  return readings;
}

std::optional<std::string> InferredUnit(const TemplateCore& core, const CEL_Element& element) {
  const SymbolRecord* record = core.FindRecordByUid(element.GetUid());
  if (record == nullptr) return std::nullopt;
  UnitInference inference(core, Substances::Ignored);
  std::vector<UnitClash> clashes;
  const ExpressionUnit value = inference.Infer(ExpressionOf(*record), clashes);
  if (!value.IsCertain()) return std::nullopt;
  const std::optional<Unit> unit = inference.DeclaredOf(element);
  if (!unit) return ShownUnit(value);
  const std::string declared(DeclaredUnit(element).value_or(""));
  if (!HasEquation(record->kind)) return AreSame(value.unit, *unit) ? declared : ShownUnit(value);
  const RateOf rate = RateIn(value.unit, *unit);
  if (rate.time == nullptr || rate.time->name != "day") return ShownUnit(value);
  return declared + "/d";
}

}  // namespace tessal
