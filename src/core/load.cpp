// Loading a template file. The key-file library gives the values that the elements are built from; the
// reader of the item tree then reads the same file again for what the library cannot keep.
#include <exception>

#include "core/error_registry.h"
#include "core/template_core.h"
#include "elements/property_io.h"
#include "keyfile/keywords.h"
#include "keyfile/reader.h"

namespace tessal {

namespace {

constexpr std::string_view kLoadSymbol = "LOAD ";

/// Closes the library's file on every way out.
class OpenFile final {
 public:
  explicit OpenFile(const std::string& path) : handle(kvfLoadFile(path, 1)), error(kvfGetErrorGlb()) {}
  OpenFile(const OpenFile&) = delete;
  OpenFile& operator=(const OpenFile&) = delete;
  ~OpenFile() { kvfClose(&handle); }

  KvfHandle Handle() const { return handle; }
  int Error() const { return error; }

 private:
  KvfHandle handle;
  int error;
};

/// Switches rebuilds off, and on again on every way out.
class RebuildsOff final {
 public:
  explicit RebuildsOff(bool& rebuildSwitch) : enabled(rebuildSwitch) { enabled = false; }
  RebuildsOff(const RebuildsOff&) = delete;
  RebuildsOff& operator=(const RebuildsOff&) = delete;
  ~RebuildsOff() { enabled = true; }

 private:
  bool& enabled;
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
std::string TreeFailureText(const std::string& path) {
  if (!LastKeyError().empty()) return LastKeyError();
  // The reader calls such a file missing.
  return KeyFileSize(path) == 0 ? "the file is empty, or no regular file" : KeyFileFailureText();
}

/// A target that holds nothing stands for an empty template, and misses no key.
bool IsEmptyTarget(KvfNode target) {
  return kvfGetNoSections(target) == 0 && !HasKeyword(target, key::kDescription) &&
         !HasKeyword(target, key::kOnlineHelp) && !HasKeyword(target, key::kDocumentation);
}

}  // namespace

bool TemplateCore::LoadWrapper(const std::string& path) {
  // A copy: the path may be the template's own file name, which the load empties first.
  return Load(std::string(path));
}

bool TemplateCore::Load(const std::string& path) {
  const NotificationsOff silent;
  try {
    Clear();
    if (!ReadTemplate(path)) return false;
    if (!CheckIdRange()) AssignIds();
    RebuildSymbolTable();
    if (flags.strictScopeRule != 0) {
      CheckScopeRule();
    } else {
      CheckProcessRule();
    }
    ParseAllExpressions();
    ValidateTemplate();
    flags.modified = false;
    return true;
  } catch (const std::exception& failure) {
    // What was built so far stays; the reason must reach the user.
    Errors().ReportInFile(kLoadSymbol, 0, {"load-failed", {failure.what()}});
    return false;
  }
}

bool TemplateCore::ReadTemplate(const std::string& path) {
  {
    // Closed before the second reading: a large file need not lie in memory twice.
    const OpenFile file(path);
    if (file.Error() != kKvfOk || file.Handle() == 0) {
      ReportFailedLoad(file, path);
      return false;
    }
    saveFileName = path;
    templateFileName = path;
    if (!ReadSections(file.Handle(), 1)) return false;
  }
  keptTree.Clear();
  if (LoadKeyFileTree(path, keptTree) == 0) {
    Errors().ReportInFile(kNotKeptSymbol, 0, {"sections-not-kept", {TreeFailureText(path)}});
  }
  return true;
}

bool TemplateCore::ReadSections(KvfHandle file, int targetNumber) {
  int status = 0;
  const KvfNode target = kvfTargetByNameNum(file, section::kTarget, targetNumber);
  if (target != nullptr) {
    const RebuildsOff noRebuilds(flags.rebuildEnabled);
    if (!IsEmptyTarget(target)) root.Read(target, status);
    ReadMisc(target, status);
    ReadCollections(target, status);
    ReadEquations(target, status);
    ReadSpecies(target, status);
  }
  RebuildSymbolTable();
  if (hasMisc) ApplyVisibilityGroups();
  if (Errors().GetErrorCount(static_cast<std::uint32_t>(ErrorLevel::Fatal)) > 0) return false;
  flags.modified = false;
  return true;
}

void TemplateCore::ReadMisc(KvfNode target, int& status) {
  const KvfNode settings = kvfSectionByNameNum(target, section::kMisc, 1);
  hasMisc = settings != nullptr;
  if (hasMisc) misc.Read(settings, status);
}

template <class AddElement>
void TemplateCore::ReadCollection(KvfNode target, std::string_view name, ElementKind listKind, int& status,
                                  AddElement add) {
  const KvfNode list = kvfSectionByNameNum(target, name, 1);
  if (list == nullptr) return;
  ListHead(listKind).Read(list, status);
  const int count = kvfGetNoSections(list);
  for (int number = 1; number <= count; ++number) {
    CEL_Element& element = add();
    element.Read(kvfSectionByNum(list, number), status);
    element.SetLoaded(true);
  }
}

void TemplateCore::ReadCollections(KvfNode target, int& status) {
  ReadCollection(target, section::kStateVariables, ElementKind::StateVariableList, status,
                 [this]() -> CEL_Element& { return AddStateVariable(); });
  ReadCollection(target, section::kConstants, ElementKind::ConstantList, status,
                 [this]() -> CEL_Element& { return AddConstant(); });
  ReadCollection(target, section::kForcings, ElementKind::ForcingList, status,
                 [this]() -> CEL_Element& { return AddForcing(); });
  ReadCollection(target, section::kAuxiliaryVariables, ElementKind::AuxiliaryList, status,
                 [this]() -> CEL_Element& { return AddAuxiliary(); });
  ReadCollection(target, section::kProcesses, ElementKind::ProcessList, status,
                 [this]() -> CEL_Element& { return AddProcess(); });
  ReadCollection(target, section::kDerivedOutputs, ElementKind::DerivedOutputList, status,
                 [this]() -> CEL_Element& { return AddDerivedOutput(); });
  // The file holds no symbol for these: their place gives it.
  for (std::size_t place = 0; place < derivedOutputs.size(); ++place) {
    derivedOutputs[place]->symbol.SetText("Derived Output " + std::to_string(place + 1));
  }
}

void TemplateCore::ReadEquations(KvfNode target, int& status) {
  const KvfNode equations = kvfSectionByNameNum(target, section::kStateVariableEquations, 1);
  if (equations == nullptr) return;
  const int count = kvfGetNoSections(equations);
  if (static_cast<std::size_t>(count) > stateVariables.size()) {
    Errors().ReportInFile("", kvfGetLine(equations), {"surplus-equations"});
  }
  for (int number = 1; number <= count; ++number) {
    GetStateVariable(static_cast<std::size_t>(number - 1))
        .ReadEquation(kvfSectionByNum(equations, number), status);
  }
}

void TemplateCore::ReadSpecies(KvfNode target, int& status) {
  const KvfNode classes = kvfSectionByNameNum(target, section::kLagrange, 1);
  if (classes == nullptr) return;
  const int count = kvfGetNoSections(classes);
  for (int number = 1; number <= count; ++number) {
    CEL_Lagrange_Specie& specie = AddSpecie();
    specie.Read(kvfSectionByNum(classes, number), status);
    specie.SetLoaded(true);
  }
}

bool TemplateCore::CheckIdRange() {
  constexpr std::int32_t kSlotsOfVector = 2;
  auto slots = static_cast<std::int32_t>(CountNamedElements());
  for (const auto& specie : species) {
    slots += 1 + kSlotsOfVector * static_cast<std::int32_t>(specie->horizontalVectors.size()) + 1;
  }
  bool good = true;
  ForEachNamedElement([slots, &good](CEL_Element& element) {
    if (element.id.IntValue() <= slots) return;
    element.id.SetInt(slots);
    good = false;
  });
  return good;
}

void TemplateCore::AssignIds() {
  ResolveReferencesToNames();
  for (const SymbolRecord& record : symbolTable) {
    record.element->id.SetInt(static_cast<std::int32_t>(record.sequence));
  }
  NumberSpecies();
  ResolveNamesToReferences();
  flags.modified = true;
}

}  // namespace tessal
