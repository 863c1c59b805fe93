// Loading a template file. The key-file library gives the values that the elements are built from. It also
// says whether the text keeps to the stricter grammar of the item tree: only where it may not, that reader
// checks it. Its tree is made when somebody asks for it.
#include <exception>
#include <new>

#include "core/error_registry.h"
#include "core/file_remains.h"
#include "core/search_functions.h"
#include "core/template_core.h"
#include "core/visibility_groups.h"
#include "elements/free_name.h"
#include "elements/list_section.h"
#include "elements/property_io.h"
#include "expr/scanner.h"
#include "keyfile/keywords.h"
#include "keyfile/reader.h"
#include "platform/file_replacement.h"
#include "platform/kvf_text.h"

namespace tessal {

namespace {

constexpr std::string_view kLoadSymbol = "LOAD ";

/// Closes the library's file on every way out.
class OpenFile final {
 public:
  explicit OpenFile(KvfHandle loaded) : handle(loaded), error(kvfGetErrorGlb()) {}
  OpenFile(const OpenFile&) = delete;
  OpenFile& operator=(const OpenFile&) = delete;
  ~OpenFile() { kvfClose(&handle); }

  KvfHandle Handle() const { return handle; }
  int Error() const { return error; }

 private:
  KvfHandle handle;
  int error;
};

/// Where the syntax error of a failed load lies.
struct SyntaxError {
  explicit SyntaxError(KvfHandle handle) { kvfGetSyntaxErr(handle, line, position, near); }

  int line = 0;
  int position = 0;
  std::string near;
};

/// Why the library loaded nothing.
Finding LoadFailure(int error, const SyntaxError& syntax, const std::string& path) {
  switch (error) {
    case kKvfCannotOpen:
      return {"file-not-opened", {path}};
    case kKvfTooLarge:
      return {"file-too-large", {path, std::to_string(kLargestFile)}};
    case kKvfSyntaxError:
      return {"file-syntax", {std::to_string(syntax.line), std::to_string(syntax.position), syntax.near}};
    case kKvfCannotInitialiseStream:
      return {"load-failed", {"Can not initalise iput stream"}};
    case kKvfCannotInitialiseParser:
      return {"load-failed", {"Can not initalise KVF parser!"}};
    case kKvfBadHandle:
      return {"load-failed", {"Bad handle passed to function!"}};
    case kKvfBadNode:
      return {"load-failed", {"Bad node passed to function!"}};
    default:
      return {"load-failed", {"unkown error occured!"}};
  }
}

void ReportFailedLoad(const OpenFile& file, const std::string& path) {
  const SyntaxError syntax(file.Handle());
  Errors().ReportInFile(kLoadSymbol, syntax.line, LoadFailure(file.Error(), syntax, path));
}

/// Why the item tree could not be read, in words for the modeller.
std::string TreeFailureText(bool isEmpty) {
  if (!LastKeyError().empty()) return LastKeyError();
  return isEmpty ? "the file is empty, or no regular file" : KeyFileFailureText();
}

/// A target that holds nothing is an empty template, and misses no key.
bool IsEmptyTarget(KvfNode target) {
  return kvfGetNoSections(target) == 0 && !HasKeyword(target, key::kDescription) &&
         !HasKeyword(target, key::kOnlineHelp) && !HasKeyword(target, key::kDocumentation);
}

/// The reading of one file into a template.
class Reading final {
 public:
  Reading(TemplateCore& target, TemplateState& targetState) : core(target), state(targetState) {}

  /// False when the file could not be read; the registry then holds the reason.
  bool LoadFile(const std::string& path);
  /// The same for the text of one.
  bool LoadText(std::string text);

 private:
  template <class Open>
  bool Load(const std::string& path, Open open);
  bool Read(const OpenFile& file, const std::string& path);
  /// Reports why the reader of the item tree refuses the text, where it does.
  void CheckStrictly(bool isCut);
  /// Whether the numbers of all elements are among those of the records; one that is not gets the last of
  /// them.
  bool CheckIdRange();
  /// A rebuild more, where it may find something else than the one after the sections.
  void RebuildUnlessSettled();
  bool ReadSections(KvfHandle file, int targetNumber);
  void ReadSettings(KvfNode target, ReadStatus& status);
  template <class Element>
  CEL_Element& AppendUnread(const Collection<Element>& row, ReadStatus& status);
  template <class Element>
  void ReadCollection(const Collection<Element>& row, KvfNode target, ReadStatus& status);
  void ReadTemplateEquations(KvfNode target, ReadStatus& status);

  TemplateCore& core;
  TemplateState& state;
  bool isSettled = false;
};

bool Reading::Read(const OpenFile& file, const std::string& path) {
  if (file.Error() != kKvfOk || file.Handle() == 0) {
    ReportFailedLoad(file, path);
    return false;
  }
  state.saveFileName = path;
  state.templateFileName = path;
  // First: texts of elements are views into it.
  state.source = kvfShareText(file.Handle());
  if (!ReadSections(file.Handle(), 1)) return false;
  if (!kvfIsStrict(file.Handle())) CheckStrictly(kvfGetBytesCut(file.Handle()) > 0);
  return true;
}

void Reading::CheckStrictly(bool isCut) {
  if (CheckKeyFileText(*state.source) != 0) return;
  const bool isEmpty = state.source->empty() && !isCut;
  Errors().ReportInFile(kNotKeptSymbol, 0, {"sections-not-kept", {TreeFailureText(isEmpty)}});
}

bool Reading::ReadSections(KvfHandle file, int targetNumber) {
  ReadStatus status(state.account);
  const KvfNode target = kvfTargetByNameNum(file, section::kTarget, targetNumber);
  if (target == nullptr) {
    state.account.Note(AccountKind::Absent, "", 0, {"section-absent", {section::kTarget}});
  } else {
    const RebuildsOff noRebuilds(state.flags);
    if (!IsEmptyTarget(target)) state.root.Read(target, status);
    ReadSettings(target, status);
    ForEachHeadedCollection(
        [this, target, &status](const auto& row) { ReadCollection(row, target, status); });
    // The file holds no symbol for these: their place gives it.
    std::size_t place = 0;
    for (const auto& output : state.collections.derivedOutputs) {
      output->symbol.SetText("Derived Output " + std::to_string(++place));
    }
    ReadTemplateEquations(target, status);
    WithCollection(ElementKind::Specie,
                   [this, target, &status](const auto& row) { ReadCollection(row, target, status); });
  }
  const ScannerStart start = ExpressionScannerStart();
  core.RebuildSymbolTable();
  // An open comment reaches the next rebuild's texts, and a search may find by its number what has it now.
  isSettled = ExpressionScannerStart() == start && !HasSearchFunction(state.collections);
  if (state.hasMisc) VisibilityGroups(state).TakeRecordNumbers();
  state.keptText = kvfTextBeside(file, target);
  NoteWhatNobodyRead(file, target, state);
  if (Errors().GetErrorCount(static_cast<std::uint32_t>(ErrorLevel::Fatal)) > 0) return false;
  state.flags.modified = false;
  return true;
}

void Reading::ReadSettings(KvfNode target, ReadStatus& status) {
  const KvfNode settings = kvfSectionByNameNum(target, section::kMisc, 1);
  state.hasMisc = settings != nullptr;
  if (state.hasMisc) state.misc.Read(settings, status);
}

/// Appends an element of a collection, to be read next.
template <class Element>
CEL_Element& Reading::AppendUnread(const Collection<Element>& row, ReadStatus& status) {
  const std::size_t number = (state.collections.*row.elements).size() + 1;
  // The file holds a symbol for most, which would take the place of a default name.
  if (row.kind == ElementKind::DerivedOutput || row.kind == ElementKind::Specie) {
    return core.AppendElement(row, NumberedName(row.symbolPrefix, number));
  }
  status.BeginUnnamed(row.symbolPrefix, number);
  return core.AppendElement(row, "");
}

template <class Element>
void Reading::ReadCollection(const Collection<Element>& row, KvfNode target, ReadStatus& status) {
  CEL_Element* head = row.HasHead() ? &state.ListHead(row.listKind) : nullptr;
  if (head != nullptr) status.NoteAbsentSection(target, row.section);
  ReadList(target, row.section, head, status,
           [this, &row, &status]() -> CEL_Element& { return AppendUnread(row, status); });
}

void Reading::ReadTemplateEquations(KvfNode target, ReadStatus& status) {
  if (!state.collections.stateVariables.empty()) {
    status.NoteAbsentSection(target, section::kStateVariableEquations);
  }
  const KvfNode equations = kvfSectionByNameNum(target, section::kStateVariableEquations, 1);
  if (equations == nullptr) return;
  if (static_cast<std::size_t>(kvfGetNoSections(equations)) > state.collections.stateVariables.size()) {
    Errors().ReportInFile("", kvfGetLine(equations), {"surplus-equations"});
  }
  ReadEquations(equations, state.collections.stateVariables, status);
}

bool Reading::CheckIdRange() {
  constexpr std::int32_t kSlotsOfVector = 2;
  auto slots = static_cast<std::int32_t>(core.CountNamedElements());
  for (const auto& specie : state.collections.species) {
    slots += 1 + kSlotsOfVector * static_cast<std::int32_t>(specie->horizontalVectors.size()) + 1;
  }
  bool good = true;
  ForEachNamedElement(state.collections, [slots, &good](CEL_Element& element) {
    if (element.id.IntValue() <= slots) return;
    element.id.SetInt(slots);
    good = false;
  });
  return good;
}

void Reading::RebuildUnlessSettled() {
  const bool isInRange = CheckIdRange();
  if (isInRange && isSettled) return;
  if (!isInRange) state.AssignIds();
  core.RebuildSymbolTable();
}

bool Reading::LoadFile(const std::string& path) {
  return Load(path, [&path] { return kvfLoadFile(path, 1); });
}

bool Reading::LoadText(std::string text) {
  return Load({}, [&text] { return kvfLoadText(std::move(text)); });
}

template <class Open>
bool Reading::Load(const std::string& path, Open open) {
  const NotificationsOff silent;
  try {
    core.Clear();
    const OpenFile file(open());
    if (!Read(file, path)) return false;
    RebuildUnlessSettled();
    state.SettleSpatialTree();
    state.flags.strictScopeRule ? core.CheckScopeRule() : core.CheckProcessRule();
    core.ParseAllExpressions();
    core.ValidateTemplate();
    state.flags.modified = false;
    return true;
  } catch (const std::bad_alloc&) {
    // What was being built may be in halves, and the report needs memory. Should that fail too, the exception
    // goes on.
    core.Clear();
    Errors().ReportInFile(kLoadSymbol, 0, {"out-of-memory"});
    return false;
  } catch (const std::exception& failure) {
    // What was built so far stays; the reason must reach the user.
    Errors().ReportInFile(kLoadSymbol, 0, {"load-failed", {failure.what()}});
    return false;
  }
}

}  // namespace

bool TemplateCore::LoadWrapper(const std::string& path) {
  // A copy: the path may be the template's own file name, which the load empties first.
  return Reading(*this, state).LoadFile(std::string(path));
}

bool TemplateCore::LoadText(std::string text) {
  return Reading(*this, state).LoadText(std::move(text));
}

bool TemplateCore::LoadCopy(const std::string& source, const std::string& path) {
  if (!LoadWrapper(source)) return false;
  state.templateFileName = path;
  state.saveFileName = path;
  return true;
}

}  // namespace tessal
