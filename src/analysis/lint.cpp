#include "analysis/lint.h"

#include <algorithm>
#include <array>

#include "analysis/lint_rules.h"
#include "analysis/tree_nodes.h"
#include "core/template_core.h"
#include "expr/expression_shape.h"
#include "expr/function_catalogue.h"
#include "expr/node_span.h"

namespace tessal {

namespace {

struct RuleRow {
  Message message;
  LintRule find;
};

/// In the order in which an element's findings are listed.
constexpr std::array kRules = {
    RuleRow{"unused-constant", FindUnusedConstants},
    RuleRow{"unused-forcing", FindUnusedForcings},
    RuleRow{"unused-auxiliary", FindUnusedAuxiliaries},
    RuleRow{"unused-process", FindUnusedProcesses},
    RuleRow{"unused-search", FindUnusedSearches},
    RuleRow{"process-outside-equations", FindProcessesOutsideEquations},
    RuleRow{"process-repeated", FindRepeatedProcesses},
    RuleRow{"state-unchanged", FindUnchangedStates},
    RuleRow{"dependency-cycle", FindCycles},
    RuleRow{"division-by-zero", FindDivisionsByZero},
    RuleRow{"constant-expression", FindConstantExpressions},
    RuleRow{"equal-branches", FindEqualBranches},
    RuleRow{"repeated-literal", FindRepeatedLiterals},
    RuleRow{"alias", FindAliases},
    RuleRow{"symbols-differ-by-case", FindSymbolsThatDifferByCase},
    RuleRow{"symbols-differ-by-digit", FindSymbolsThatDifferByDigit},
    RuleRow{"symbol-of-function", FindSymbolsOfFunctions},
    RuleRow{"default-at-bound", FindDefaultsAtBounds},
    RuleRow{"built-in-deprecated", FindDeprecatedBuiltins},
    RuleRow{"no-unit", FindMissingUnits},
    RuleRow{"no-description", FindMissingDescriptions},
    RuleRow{"no-source", FindMissingSources},
};

bool Contains(const std::vector<std::string>& codes, std::string_view code) {
  return std::find(codes.begin(), codes.end(), code) != codes.end();
}

bool ActsByItself(const ExpressionNode& node) {
  if (IsDirectModification(node.Kind()) || node.Kind() == NodeKind::Interaction) return true;
  if (node.Kind() != NodeKind::Call) return false;
  const CatalogueFunction* function = FindFunction(node.Text());
  return function == nullptr || function->traits.needsEngine || function->traits.keepsState;
}

}  // namespace

LintSubject::LintSubject(const TemplateCore& core) : symbols(core), effects(core.SymbolTable().size()) {
  expressions.reserve(Records().size());
  for (const SymbolRecord& record : Records()) {
    const auto [text, tree] = ExpressionOf(record);
    if (tree == nullptr) continue;
    expressions.push_back({&record, record.element->LabelOf(*record.expression), text, tree});
    ForEachNode(*tree, [&](const ExpressionNode& node) {
      if (ActsByItself(node)) effects[record.sequence - 1] = 1;
      return effects[record.sequence - 1] == 0;
    });
  }
}

const std::vector<SymbolRecord>& LintSubject::Records() const {
  return Template().SymbolTable();
}

void LintFindings::Add(const SymbolRecord& record, const Finding& finding, std::string_view field) {
  entries.push_back({record.sequence, FindingAbout(*record.element, finding)});
  entries.back().finding.field = field;
}

void LintFindings::Add(const LintExpression& expression, const ExpressionNode& part, const Finding& finding) {
  Add(*expression.record, finding, expression.field);
  entries.back().finding.place = SpanOf(part, expression.text);
}

bool IsProcess(const SymbolRecord& record) {
  return record.kind == ElementKind::Process || record.kind == ElementKind::ArithmeticExpression;
}

bool HasUsableSymbol(const SymbolRecord& record) {
  return record.kind != ElementKind::DerivedOutput && record.kind != ElementKind::HorizontalVector &&
         record.kind != ElementKind::VerticalEquation;
}

std::string Excerpt(std::string_view text) {
  constexpr std::size_t kMost = 60;
  constexpr unsigned char kFirstPrintable = 0x20;
  std::string excerpt(text.substr(0, kMost));
  for (char& character : excerpt) {
    if (static_cast<unsigned char>(character) < kFirstPrintable) character = ' ';
  }
  if (text.size() > kMost) excerpt += "...";
  return excerpt;
}

std::span<const std::string_view> LintRules() {
  static const auto kCodes = [] {
    std::array<std::string_view, kRules.size()> codes;
    std::transform(kRules.begin(), kRules.end(), codes.begin(),
                   [](const RuleRow& rule) { return rule.message->code; });
    return codes;
  }();
  return kCodes;
}

std::vector<AnalysisFinding> Lint(const TemplateCore& core, const LintSelection& selection) {
  const LintSubject subject(core);
  LintFindings findings;
  for (const RuleRow& rule : kRules) {
    const std::string_view code = rule.message->code;
    const bool isSelected = selection.select.empty() || Contains(selection.select, code);
    if (isSelected && !Contains(selection.ignore, code)) rule.find(subject, rule.message, findings);
  }
  std::vector<LintFindings::Entry>& entries = findings.Entries();
  std::stable_sort(entries.begin(), entries.end(),
                   [](const LintFindings::Entry& left, const LintFindings::Entry& right) {
                     return left.sequence < right.sequence;
                   });
  std::vector<AnalysisFinding> sorted;
  sorted.reserve(entries.size());
  for (LintFindings::Entry& entry : entries) sorted.push_back(std::move(entry.finding));
  return sorted;
}

}  // namespace tessal
