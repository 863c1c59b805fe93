// What the rules of lint work on, and the rules by their themes. A rule reads the template, adds its
// findings, and knows nothing of other rules; `lint.cpp` has their table.
#pragma once

#include <cstdint>
#include <string_view>
#include <vector>

#include "analysis/analysis_finding.h"
#include "analysis/symbol_index.h"
#include "core/messages.h"

namespace tessal {

class ExpressionNode;
class TemplateCore;
struct SymbolRecord;

/// An expression that parses.
struct LintExpression {
  const SymbolRecord* record;
  std::string_view field;  ///< the label of its property
  std::string_view text;   ///< the quotes stripped
  const ExpressionNode* tree;
};

/// A template with what several rules need of it.
class LintSubject final {
 public:
  explicit LintSubject(const TemplateCore& core);

  const TemplateCore& Template() const { return symbols.Template(); }
  const std::vector<SymbolRecord>& Records() const;
  const SymbolRecord& Used(std::uint32_t sequence) const { return Records()[sequence - 1]; }
  const SymbolIndex& Symbols() const { return symbols; }
  /// In the order of their records.
  const std::vector<LintExpression>& Expressions() const { return expressions; }
  /// Whether the record's expression acts by itself, whoever uses its value: it changes particles, or calls
  /// what the engine or a plug-in computes.
  bool HasEffect(const SymbolRecord& record) const { return effects[record.sequence - 1] != 0; }

 private:
  SymbolIndex symbols;
  std::vector<LintExpression> expressions;
  std::vector<char> effects;  ///< by record
};

/// Takes the findings of a rule.
class LintFindings final {
 public:
  struct Entry {
    std::uint32_t sequence;
    AnalysisFinding finding;
  };

  void Add(const SymbolRecord& record, const Finding& finding, std::string_view field = {});
  /// About a part of an expression.
  void Add(const LintExpression& expression, const ExpressionNode& part, const Finding& finding);

  std::vector<Entry>& Entries() { return entries; }

 private:
  std::vector<Entry> entries;
};

/// The message is the one of the rule's row.
using LintRule = void (*)(const LintSubject& subject, const Message& message, LintFindings& findings);

bool IsProcess(const SymbolRecord& record);
/// Whether the element has a symbol that expressions use: no derived output and no movement.
bool HasUsableSymbol(const SymbolRecord& record);
/// The start of a text, on one line, for a message.
std::string Excerpt(std::string_view text);

// Who uses whom.
void FindUnusedConstants(const LintSubject& subject, const Message& message, LintFindings& findings);
void FindUnusedForcings(const LintSubject& subject, const Message& message, LintFindings& findings);
void FindUnusedAuxiliaries(const LintSubject& subject, const Message& message, LintFindings& findings);
void FindUnusedProcesses(const LintSubject& subject, const Message& message, LintFindings& findings);
void FindUnusedSearches(const LintSubject& subject, const Message& message, LintFindings& findings);
void FindProcessesOutsideEquations(const LintSubject& subject, const Message& message,
                                   LintFindings& findings);
void FindRepeatedProcesses(const LintSubject& subject, const Message& message, LintFindings& findings);
void FindUnchangedStates(const LintSubject& subject, const Message& message, LintFindings& findings);
void FindAliases(const LintSubject& subject, const Message& message, LintFindings& findings);
void FindCycles(const LintSubject& subject, const Message& message, LintFindings& findings);

// What expressions say.
void FindDivisionsByZero(const LintSubject& subject, const Message& message, LintFindings& findings);
void FindConstantExpressions(const LintSubject& subject, const Message& message, LintFindings& findings);
void FindEqualBranches(const LintSubject& subject, const Message& message, LintFindings& findings);
void FindRepeatedLiterals(const LintSubject& subject, const Message& message, LintFindings& findings);

// Symbols.
void FindSymbolsThatDifferByCase(const LintSubject& subject, const Message& message, LintFindings& findings);
void FindSymbolsThatDifferByDigit(const LintSubject& subject, const Message& message, LintFindings& findings);
void FindSymbolsOfFunctions(const LintSubject& subject, const Message& message, LintFindings& findings);

// What elements declare.
void FindDefaultsAtBounds(const LintSubject& subject, const Message& message, LintFindings& findings);
void FindMissingUnits(const LintSubject& subject, const Message& message, LintFindings& findings);
void FindMissingDescriptions(const LintSubject& subject, const Message& message, LintFindings& findings);
void FindMissingSources(const LintSubject& subject, const Message& message, LintFindings& findings);
void FindDeprecatedBuiltins(const LintSubject& subject, const Message& message, LintFindings& findings);

}  // namespace tessal
