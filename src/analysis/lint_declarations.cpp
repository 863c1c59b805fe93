// Rules about what elements declare beside their expressions.
#include <algorithm>

#include "analysis/declared_values.h"
#include "analysis/lint_rules.h"
#include "core/template_core.h"
#include "elements/input_elements.h"
#include "expr/builtin_catalogue.h"
#include "platform/ascii.h"
#include "platform/number_text.h"

namespace tessal {

namespace {

bool IsInput(const SymbolRecord& record) {
  return record.kind == ElementKind::Constant || record.kind == ElementKind::Forcing;
}

/// Whether an input takes its data from the catalogue of built-ins.
bool IsBuiltIn(const SymbolRecord& record) {
  return IsInput(record) && !static_cast<const CEL_Input&>(*record.element).isUserSpecified.BoolValue();
}

bool IsConstant(const SymbolRecord& record) {
  return record.kind == ElementKind::Constant || record.kind == ElementKind::SpecieConstant;
}

bool IsBlank(std::string_view text) {
  return text.find_first_not_of(" \t\r\n") == std::string_view::npos;
}

/// What a fresh element has in the place of a unit is none.
bool IsNoUnit(std::string_view unit) {
  constexpr std::string_view kFresh = "undefined";
  return IsBlank(unit) || unit == kFresh;
}

}  // namespace

void FindDefaultsAtBounds(const LintSubject& subject, const Message& message, LintFindings& findings) {
  for (const SymbolRecord& record : subject.Records()) {
    if (!IsConstant(record) || IsBuiltIn(record)) continue;
    const std::optional<DeclaredValue> value = DeclaredValueOf(*record.element);
    if (!value || !(value->minimum < value->maximum)) continue;
    // Nothing and all of it are values that people choose: a loss that is switched off, a share of 1.
    if (value->value == 0.0 || value->value == 1.0) continue;
    const bool isLowest = value->value == value->minimum;
    if (!isLowest && value->value != value->maximum) continue;
    findings.Add(record, {message, {isLowest ? "minimum" : "maximum", PlainNumberText(value->value)}});
  }
}

void FindMissingUnits(const LintSubject& subject, const Message& message, LintFindings& findings) {
  for (const SymbolRecord& record : subject.Records()) {
    const std::optional<std::string_view> unit = DeclaredUnit(*record.element);
    if (unit && IsNoUnit(*unit)) findings.Add(record, Finding(message));
  }
}

void FindMissingDescriptions(const LintSubject& subject, const Message& message, LintFindings& findings) {
  for (const SymbolRecord& record : subject.Records()) {
    const bool isMovement =
        record.kind == ElementKind::HorizontalVector || record.kind == ElementKind::VerticalEquation;
    if (!isMovement && IsBlank(record.element->description.Text())) {
      findings.Add(record, Finding(message));
    }
  }
}

void FindMissingSources(const LintSubject& subject, const Message& message, LintFindings& findings) {
  for (const SymbolRecord& record : subject.Records()) {
    const CEL_Element& element = *record.element;
    if (!IsConstant(record) || IsBuiltIn(record)) continue;
    if (IsBlank(element.documentation.Text()) && IsBlank(element.onlineHelp.Text())) {
      findings.Add(record, Finding(message));
    }
  }
}

void FindDeprecatedBuiltins(const LintSubject& subject, const Message& message, LintFindings& findings) {
  for (const SymbolRecord& record : subject.Records()) {
    if (!IsBuiltIn(record)) continue;
    const std::int32_t id = static_cast<const CEL_Input&>(*record.element).builtInId.IntValue();
    CatalogueBuiltin row;
    if (IsDeprecatedBuiltin(id) && GetBuiltinById(id, row) == 0) {
      findings.Add(record, {message, {record.element->symbol.Text(), row.name}});
    }
  }
}

}  // namespace tessal
