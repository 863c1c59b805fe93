#include "support/random_edits.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <map>
#include <string>
#include <vector>

#include "core/error_registry.h"
#include "core/pools.h"
#include "platform/file_replacement.h"
#include "support/template_content.h"

namespace tessal::test {

namespace {

using fuzz::Choices;

constexpr std::array<const char*, 12> kTexts = {
    "a",     "b + a", "Process_1", "a*(b-2)", "IF a > 1 THEN b ELSE Constant_1",
    "K",     "",      "it's",      "x!",      "MAX(a, StateVariable_1)",
    "a + ^", "[XPOS]"};
constexpr std::array<const char*, 8> kNames = {"a", "b", "K", "Mass", "new_name", "Fish", "SIN", "two words"};

Uid AnyUid(const TemplateCore& core, Choices& choices) {
  const auto& table = core.SymbolTable();
  return table.empty() ? Uid::None : table[choices.Pick(table.size())].element->GetUid();
}

void Add(TemplateCore& core, Choices& choices) {
  CreateRequest request;
  request.kind = KindAfter(ElementKind::StateVariable, choices.Pick(13));
  request.symbol = choices.Pick(2) == 0 ? "" : kNames[choices.Pick(kNames.size() - 1)];
  // A derived output has no symbol in the file: its place names it.
  const bool isUnnamed = request.kind == ElementKind::DerivedOutput;
  if (isUnnamed || core.SymbolExists(request.symbol)) request.symbol.clear();
  if (request.kind > ElementKind::Specie && core.GetSpecieCount() > 0) {
    const auto& specie = core.GetSpecie(choices.Pick(core.GetSpecieCount()));
    // Any list head names its class.
    request.ownerId = specie.Head(ElementKind::SpecieConstantList).GetUid();
  }
  core.CreateElement(request);
  SetNotifyChanges(true);
}

/// An element with values: one with a record, the settings, or a user function.
CEL_Element* AnyElement(TemplateCore& core, Choices& choices) {
  CEL_Miscanellous* misc = core.GetMisc();
  const auto& functions = misc->ExternalFunctions();
  switch (choices.Pick(4)) {
    case 0:
      return misc;
    case 1:
      return functions.empty() ? nullptr : functions[choices.Pick(functions.size())].get();
    default:
      return core.GetElement(AnyUid(core, choices));
  }
}

void ChangeField(TemplateCore& core, Choices& choices) {
  CEL_Element* element = AnyElement(core, choices);
  if (element == nullptr) return;
  std::vector<ElementField> fields;
  element->GetFields(fields);
  ElementField& field = fields[choices.Pick(fields.size())];
  // Names go through the rename, numbers of records through the table.
  if (field.name == "Symbol" || field.name == "Name" || field.name == "ID" || field.name == "Specie") return;
  // Versions are rounded to three decimals, which the stamps of a save have.
  if (field.name.ends_with(" version")) return;
  // A search function's loading gives up texts that are no choices.
  const auto& allowed = field.choiceTexts;
  field.text = allowed.empty() ? choices.AnyOf(kTexts) : choices.AnyOf(allowed);
  field.intValue = static_cast<std::int32_t>(choices.Pick(7)) - 2;
  field.realValue = static_cast<double>(choices.Pick(9)) - 4.5;
  field.boolValue = choices.Pick(2) == 0;
  element->SetFields({field});
}

/// The texts of the root, of a list head, or of a group.
void ChangeTexts(TemplateCore& core, Choices& choices) {
  const char* text = choices.AnyOf(kTexts);
  switch (choices.Pick(5)) {
    case 0:
      core.Root().onlineHelp.SetText(text);
      break;
    case 1:
      core.ListHead(KindAfter(ElementKind::StateVariableList, choices.Pick(6))).description.SetText(text);
      break;
    case 2:
      if (core.GetSpecieCount() == 0) break;
      core.GetSpecie(choices.Pick(core.GetSpecieCount()))
          .Head(KindAfter(ElementKind::SpecieStateVariableList, choices.Pick(5)))
          .documentation.SetText(text);
      break;
    case 3:
      core.GetMisc()->ExternalFunctionHead().description.SetText(text);
      break;
    default:
      core.SetGroupName(1, text);
      core.SetLevelDescription(1, 1, text);
      break;
  }
}

void ChangeGroups(TemplateCore& core, Choices& choices) {
  const auto group = static_cast<std::int32_t>(1 + choices.Pick(3));
  const auto level = static_cast<std::int32_t>(1 + choices.Pick(3));
  const auto sequence = static_cast<std::uint32_t>(1 + choices.Pick(core.SymbolTable().size() + 1));
  switch (choices.Pick(6)) {
    case 0:
      core.AddVisibilityGroup();
      break;
    case 1:
      core.RemoveVisibilityGroup(group);
      break;
    case 2:
      core.CreateLevel(group);
      break;
    case 3:
      core.DeleteLevel(group, level);
      break;
    case 4:
      core.AddItemToLevel(group, level, sequence);
      break;
    default:
      core.RemoveItemFromLevel(group, level, sequence);
      break;
  }
}

/// A user's answers to every name that nobody has defined, among them none and one that was not offered.
void ChangePools(TemplateCore& core, Choices& choices) {
  std::vector<Pool> pools = PoolsOf(core).pools;
  if (pools.size() > 2) pools.erase(pools.begin());
  const std::string name = choices.AnyOf(kNames);
  pools.push_back({name, name + " + 2*" + name, {choices.AnyOf(kNames)}, "of " + name});
  std::string failure;
  SetPools(core, pools, failure);
}

void AnswerOffers(TemplateCore& core, Choices& choices) {
  while (const auto offer = core.NextOffer()) {
    const int choice = static_cast<int>(choices.Pick(CreationOffer::kChoiceCount + 1)) - 1;
    const CreateRequest* request = offer->RequestOf(choice);
    if (request != nullptr) core.CreateElement(*request);
  }
  SetNotifyChanges(true);
}

}  // namespace

void EditAtRandom(TemplateCore& core, fuzz::Choices& choices) {
  switch (choices.Pick(12)) {
    case 0:
    case 1:
      Add(core, choices);
      break;
    case 2:
      core.DeleteElement(AnyUid(core, choices));
      break;
    case 3: {
      const Uid moved = AnyUid(core, choices);
      core.MoveElement(moved, AnyUid(core, choices), choices.Pick(2) == 0);
      break;
    }
    case 4: {
      const CEL_Element* renamed = core.GetElement(AnyUid(core, choices));
      if (renamed == nullptr || renamed->Kind() == ElementKind::DerivedOutput) break;
      core.RenameSymbol(renamed->symbol.TextOf(), choices.AnyOf(kNames), choices.Pick(2) == 0);
      break;
    }
    case 5:
      ChangeGroups(core, choices);
      break;
    case 6:
      if (core.GetMisc()->ExternalFunctions().size() < 3) {
        core.GetMisc()->AddExternalFunction().publicName.SetText(choices.AnyOf(kNames));
      } else {
        core.GetMisc()->RemoveExternalFunction(choices.Pick(4));
      }
      core.RefreshSearchFunctionChoices();
      break;
    case 7:
      ChangeTexts(core, choices);
      break;
    case 8:
      AnswerOffers(core, choices);
      break;
    case 9:
      ChangePools(core, choices);
      break;
    case 10:
      core.SetShowAllBuiltIns(choices.Pick(2) == 0);
      break;
    default:
      ChangeField(core, choices);
      break;
  }
}

namespace {

/// What a user can see of a template: its file, and its table.
struct Sight {
  std::string text;
  std::string table;
  bool operator==(const Sight&) const = default;
};

std::string TableOf(const TemplateCore& core) {
  std::string text;
  for (const SymbolRecord& record : core.SymbolTable()) {
    // The captions of these are in no file.
    const bool hasCaption =
        record.kind == ElementKind::DerivedOutput || record.kind == ElementKind::HorizontalVector;
    text += std::to_string(record.sequence) + " " + (hasCaption ? "" : core.RecordSymbol(record)) + ":";
    for (const std::uint32_t used : record.references) text += " " + std::to_string(used);
    text += " <";
    for (const std::uint32_t user : record.referencedBy) text += " " + std::to_string(user);
    text += "\n";
  }
  std::vector<std::string> undefined;
  for (const auto& name : core.UndefinedSymbols()) undefined.push_back(name->symbol);
  std::sort(undefined.begin(), undefined.end());
  for (const std::string& name : undefined) text += "? " + name + "\n";
  return text;
}

Sight SightOf(TemplateCore& core) {
  std::string reason;
  const auto text = core.CopyText(reason);
  return {text ? *text : "refused\n" + TemplateContent(core), TableOf(core)};
}

/// The first place where two texts differ, with what is around it.
std::string Difference(const std::string& expected, const std::string& found) {
  const std::ptrdiff_t kAround = 200;
  const auto place = std::mismatch(expected.begin(), expected.end(), found.begin(), found.end());
  const auto around = [kAround](const std::string& text, auto at) {
    return std::string(at - std::min(kAround, at - text.begin()), at + std::min(kAround, text.end() - at));
  };
  return "\n" + around(expected, place.first) + "\n-- becomes --\n" + around(found, place.second);
}

/// What is wrong with the table; empty when a load of the template's text gives the same.
std::string FaultOfTable(TemplateCore& core, const std::string& path) {
  std::string reason;
  const auto text = core.CopyText(reason);
  if (!text) return {};
  const std::string present = TableOf(core);
  core.RebuildSymbolTable();
  if (TableOf(core) != present) return "a rebuild changes the table" + Difference(present, TableOf(core));
  if (!ReplaceFile(path, *text).empty()) return "no file";
  const MessagesAside aside;
  TemplateCore fresh;
  if (!fresh.LoadWrapper(path)) return "the text does not load";
  SetNotifyChanges(true);
  return TableOf(fresh) == present ? "" : "a load gives another table" + Difference(present, TableOf(fresh));
}

std::string Difference(const Sight& expected, const Sight& found) {
  if (expected.text != found.text) return Difference(expected.text, found.text);
  return Difference(expected.table, found.table);
}

}  // namespace

std::string FaultOfHistory(TemplateCore& core, fuzz::Choices& choices, int mostEdits,
                           const std::string& path) {
  constexpr std::size_t kLoadedStep = 4;
  EditHistory& history = core.History();
  history.Start();
  std::map<std::size_t, Sight> sights{{0, SightOf(core)}};
  const auto check = [&core, &history, &sights, &path](std::string_view pass) {
    const std::size_t step = history.UndoCount();
    const auto expected = sights.find(step);
    std::string fault;
    if (core.Modified() == (step == 0)) fault = "wrong mark";
    if (fault.empty() && expected != sights.end() && expected->second != SightOf(core)) {
      fault = Difference(expected->second, SightOf(core));
    }
    if (fault.empty() && step % kLoadedStep == 0) fault = FaultOfTable(core, path);
    if (fault.empty()) return fault;
    return std::string(pass) + " to step " + std::to_string(step) + " next to '" +
           std::string(history.UndoName()) + "' and '" + std::string(history.RedoName()) + "': " + fault;
  };
  for (int edit = 0; edit < mostEdits && !choices.Done(); ++edit) {
    if (choices.Pick(2) == 0) {
      const EditStep act(history);
      EditAtRandom(core, choices);
      EditAtRandom(core, choices);
      core.RebuildSymbolTable();
    } else {
      EditAtRandom(core, choices);
      // A field that needs no rebuild may hold what one replaces.
      core.RebuildSymbolTable();
    }
    // An act may be several steps: what lies between them was seen by nobody.
    sights[history.UndoCount()] = SightOf(core);
  }
  std::string fault;
  while (fault.empty() && core.Undo()) fault = check("undo");
  while (fault.empty() && core.Redo()) fault = check("redo");
  return fault;
}

}  // namespace tessal::test
