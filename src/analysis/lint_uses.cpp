// Rules about who uses whom.
#include <algorithm>
#include <array>
#include <limits>
#include <unordered_set>

#include "analysis/lint_rules.h"
#include "analysis/tree_nodes.h"
#include "core/template_core.h"
#include "elements/state_variable.h"
#include "expr/expression_shape.h"

namespace tessal {

namespace {

/// The kinds of a rule: those of the template, and of particle classes.
using Kinds = std::array<ElementKind, 2>;

bool IsOneOf(const Kinds& kinds, const SymbolRecord& record) {
  return std::find(kinds.begin(), kinds.end(), record.kind) != kinds.end();
}

/// Whether another element uses this one.
bool IsUsed(const SymbolRecord& record) {
  return std::any_of(record.referencedBy.begin(), record.referencedBy.end(),
                     [&record](std::uint32_t user) { return user != record.sequence; });
}

void FindUnused(const LintSubject& subject, const Kinds& kinds, const Message& message,
                LintFindings& findings) {
  for (const SymbolRecord& record : subject.Records()) {
    if (!IsOneOf(kinds, record) || IsUsed(record) || subject.HasEffect(record)) continue;
    findings.Add(record, {message, {record.element->symbol.Text()}});
  }
}

bool IsStateVariable(const SymbolRecord& record) {
  return record.kind == ElementKind::StateVariable || record.kind == ElementKind::SpecieStateVariable;
}

bool IsMovement(const SymbolRecord& record) {
  return record.kind == ElementKind::HorizontalVector || record.kind == ElementKind::VerticalEquation;
}

/// Marks, by record, what changes the model's state: what equations, movements and expressions that act by
/// themselves use, directly or through others.
std::vector<char> RecordsThatChangeSomething(const LintSubject& subject) {
  std::vector<char> marks(subject.Records().size());
  std::vector<std::uint32_t> open;
  const auto mark = [&](const SymbolRecord& record) {
    if (std::exchange(marks[record.sequence - 1], 1) == 0) open.push_back(record.sequence);
  };
  for (const SymbolRecord& record : subject.Records()) {
    if (IsStateVariable(record) || IsMovement(record) || subject.HasEffect(record)) mark(record);
  }
  while (!open.empty()) {
    const SymbolRecord& record = subject.Used(open.back());
    open.pop_back();
    for (const std::uint32_t used : record.references) mark(subject.Used(used));
  }
  return marks;
}

/// The names in expressions that change particles: what they change is among them.
std::unordered_set<std::string_view> NamesInModifications(const LintSubject& subject) {
  std::unordered_set<std::string_view> names;
  for (const LintExpression& expression : subject.Expressions()) {
    if (!subject.HasEffect(*expression.record)) continue;
    ForEachNode(*expression.tree, [&names](const ExpressionNode& node) {
      names.insert(node.Text());
      return true;
    });
  }
  return names;
}

bool IsZero(const ExpressionNode& tree) {
  return tree.Kind() == NodeKind::Number && tree.Text().find_first_not_of("0.") == std::string_view::npos;
}

/// Whether water carries the state variable, which changes it too.
bool IsTransported(const SymbolRecord& record) {
  constexpr std::string_view kFixed = "FIXED";
  return record.kind == ElementKind::StateVariable &&
         static_cast<const CEL_StateVariable&>(*record.element).transport.Text() != kFixed;
}

/// The components of the graph of uses in which every element depends on every other, of the elements whose
/// value is computed from others' at the same time. After Tarjan, R. (1972), SIAM Journal on Computing 1(2),
/// 146-160, without recursion.
class CycleSearch final {
 public:
  explicit CycleSearch(const LintSubject& searched)
      : subject(searched),
        numbers(searched.Records().size()),
        lowest(numbers.size()),
        isOpen(numbers.size()) {}

  template <class Visitor>
  void ForEachCycle(Visitor visit) {
    for (const SymbolRecord& record : subject.Records()) {
      if (!IsComputed(record) || numbers[record.sequence - 1] != 0) continue;
      Enter(record);
      while (!path.empty()) Step(visit);
    }
  }

 private:
  struct Frame {
    const SymbolRecord* record;
    std::size_t next = 0;
  };

  static bool IsComputed(const SymbolRecord& record) {
    return record.kind == ElementKind::Auxiliary || IsProcess(record);
  }

  void Enter(const SymbolRecord& record) {
    const std::size_t place = record.sequence - 1;
    numbers[place] = lowest[place] = ++count;
    isOpen[place] = 1;
    members.push_back(&record);
    path.push_back({&record});
  }

  template <class Visitor>
  void Step(Visitor& visit) {
    Frame& frame = path.back();
    const std::size_t place = frame.record->sequence - 1;
    if (frame.next < frame.record->references.size()) {
      const SymbolRecord& used = subject.Used(frame.record->references[frame.next++]);
      if (!IsComputed(used)) return;
      if (numbers[used.sequence - 1] == 0) {
        Enter(used);
      } else if (isOpen[used.sequence - 1] != 0) {
        lowest[place] = std::min(lowest[place], numbers[used.sequence - 1]);
      }
      return;
    }
    path.pop_back();
    if (!path.empty()) {
      std::size_t& above = lowest[path.back().record->sequence - 1];
      above = std::min(above, lowest[place]);
    }
    if (lowest[place] == numbers[place]) Close(subject.Records()[place], visit);
  }

  template <class Visitor>
  void Close(const SymbolRecord& first, Visitor& visit) {
    std::vector<const SymbolRecord*> component;
    do {
      component.push_back(members.back());
      members.pop_back();
      isOpen[component.back()->sequence - 1] = 0;
    } while (component.back() != &first);
    const auto usesItself = [&first] {
      return std::find(first.references.begin(), first.references.end(), first.sequence) !=
             first.references.end();
    };
    if (component.size() > 1 || usesItself()) visit(component);
  }

  const LintSubject& subject;
  std::vector<std::size_t> numbers;  ///< in the order of the walk, from 1; by record
  std::vector<std::size_t> lowest;
  std::vector<char> isOpen;
  std::vector<const SymbolRecord*> members;
  std::vector<Frame> path;
  std::size_t count = 0;
};

std::string ListOf(std::vector<const SymbolRecord*>& records) {
  constexpr std::size_t kMostNames = 8;
  std::sort(records.begin(), records.end(), [](const SymbolRecord* left, const SymbolRecord* right) {
    return left->sequence < right->sequence;
  });
  std::string list;
  for (std::size_t place = 0; place < std::min(records.size(), kMostNames); ++place) {
    if (place > 0) list += ", ";
    list += records[place]->element->symbol.Text();
  }
  if (records.size() > kMostNames) list += ", ...";
  return list;
}

}  // namespace

void FindUnusedConstants(const LintSubject& subject, const Message& message, LintFindings& findings) {
  FindUnused(subject, {ElementKind::Constant, ElementKind::SpecieConstant}, message, findings);
}

void FindUnusedForcings(const LintSubject& subject, const Message& message, LintFindings& findings) {
  FindUnused(subject, {ElementKind::Forcing, ElementKind::SpecieForcing}, message, findings);
}

void FindUnusedAuxiliaries(const LintSubject& subject, const Message& message, LintFindings& findings) {
  FindUnused(subject, {ElementKind::Auxiliary, ElementKind::ArithmeticExpression}, message, findings);
}

void FindUnusedProcesses(const LintSubject& subject, const Message& message, LintFindings& findings) {
  FindUnused(subject, {ElementKind::Process, ElementKind::Process}, message, findings);
}

void FindUnusedSearches(const LintSubject& subject, const Message& message, LintFindings& findings) {
  FindUnused(subject, {ElementKind::SpatialFunction, ElementKind::SpatialFunction}, message, findings);
}

void FindProcessesOutsideEquations(const LintSubject& subject, const Message& message,
                                   LintFindings& findings) {
  const std::vector<char> changesSomething = RecordsThatChangeSomething(subject);
  for (const SymbolRecord& record : subject.Records()) {
    if (record.kind != ElementKind::Process || changesSomething[record.sequence - 1] != 0) continue;
    // One that nothing uses has a finding of its own.
    if (IsUsed(record)) findings.Add(record, {message, {record.element->symbol.Text()}});
  }
}

void FindRepeatedProcesses(const LintSubject& subject, const Message& message, LintFindings& findings) {
  std::unordered_set<std::string_view> met;
  for (const LintExpression& expression : subject.Expressions()) {
    if (!IsStateVariable(*expression.record)) continue;
    met.clear();
    const ExpressionNode* repeated = nullptr;
    ForEachNode(*expression.tree, [&](const ExpressionNode& node) {
      if (node.Kind() == NodeKind::Identifier && repeated == nullptr) {
        const SymbolRecord* used = subject.Symbols().Find(node.Text());
        if (used != nullptr && IsProcess(*used) && !met.insert(node.Text()).second) repeated = &node;
      }
      // What is in a branch or an argument may well be there a second time.
      return node.Kind() == NodeKind::Arithmetic || node.Kind() == NodeKind::Negate;
    });
    if (repeated != nullptr) findings.Add(expression, *repeated, {message, {repeated->Text()}});
  }
}

void FindUnchangedStates(const LintSubject& subject, const Message& message, LintFindings& findings) {
  const std::unordered_set<std::string_view> modified = NamesInModifications(subject);
  for (const LintExpression& expression : subject.Expressions()) {
    const SymbolRecord& record = *expression.record;
    if (!IsStateVariable(record) || !IsZero(*expression.tree) || IsTransported(record)) continue;
    const std::string_view symbol = record.element->symbol.Text();
    if (!modified.contains(symbol)) findings.Add(record, {message, {symbol}}, expression.field);
  }
}

void FindAliases(const LintSubject& subject, const Message& message, LintFindings& findings) {
  for (const LintExpression& expression : subject.Expressions()) {
    if (expression.tree->Kind() != NodeKind::Identifier) continue;
    const SymbolRecord& record = *expression.record;
    const SymbolRecord* used = subject.Symbols().Find(expression.tree->Text());
    if (used == nullptr || used == &record || used->kind != record.kind) continue;
    if (used->referencedBy.size() != 1 || (record.kind != ElementKind::Auxiliary && !IsProcess(record)))
      continue;
    findings.Add(record, {message, {record.element->symbol.Text(), used->element->symbol.Text()}},
                 expression.field);
  }
}

void FindCycles(const LintSubject& subject, const Message& message, LintFindings& findings) {
  CycleSearch(subject).ForEachCycle([&](std::vector<const SymbolRecord*>& cycle) {
    const std::string list = ListOf(cycle);
    findings.Add(*cycle.front(), {message, {list}});
  });
}

}  // namespace tessal
