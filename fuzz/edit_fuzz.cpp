// Any sequence of edits leaves a template whole: its table is consistent, and it comes back from a file as it
// was.
#include <algorithm>
#include <array>
#include <cstdint>
#include <string>
#include <vector>

#include "choices.h"
#include "core/error_registry.h"
#include "core/template_core.h"
#include "expr/scanner.h"
#include "expr/user_function_names.h"
#include "support/template_content.h"
#include "template_file.h"

namespace {

using namespace tessal;
using fuzz::Choices;
using fuzz::Require;

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
  auto& groups = core.GetMisc()->Visibilities().groups;
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
      if (groups.empty()) break;
      VisibilityGroup& group = groups[choices.Pick(groups.size())];
      group.name = text;
      if (!group.levels.empty()) group.levels[choices.Pick(group.levels.size())].description = text;
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
void AnswerOffers(TemplateCore& core, Choices& choices) {
  while (const auto offer = core.NextOffer()) {
    const int choice = static_cast<int>(choices.Pick(CreationOffer::kChoiceCount + 1)) - 1;
    const CreateRequest* request = offer->RequestOf(choice);
    if (request != nullptr) core.CreateElement(*request);
  }
  SetNotifyChanges(true);
}

void Edit(TemplateCore& core, Choices& choices) {
  switch (choices.Pick(10)) {
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
    default:
      ChangeField(core, choices);
      break;
  }
}

void CheckTable(const TemplateCore& core) {
  std::uint32_t place = 0;
  for (const SymbolRecord& record : core.SymbolTable()) {
    Require(record.sequence == ++place, "sequences are places");
    for (const std::uint32_t used : record.references) {
      const auto& users = core.FindRecordBySequence(used)->referencedBy;
      Require(std::find(users.begin(), users.end(), record.sequence) != users.end(), "references are mutual");
    }
  }
}

std::string StartText(const std::string& path) {
  std::string failure;
  return ReadWholeFile(path, failure).value_or("");
}

/// The sections that a template carries over for others, with comments wherever they may be.
void LoadFurtherSections(TemplateCore& core) {
  const std::string path = fuzz::ScratchFile("start.tessal");
  static const bool kWritten =
      TemplateCore().SaveWrapper(path) &&
      ReplaceFile(path, StartText(path) +
                            "[FIRST] // at its head\r\n// in it\r\nA = 1, -0.25, 'it', |is| // after it\r\n"
                            "[INNER]\r\nB = TRUE\r\nEndSect // inner\r\nEndSect // FIRST\r\n")
          .empty();
  Require(kWritten && core.LoadWrapper(path), "the start is there");
  SetNotifyChanges(true);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  constexpr int kMostEdits = 60;
  ResetExpressionScanner();
  ResetUserFunctionNames();
  TemplateCore core;
  Choices choices(data, size);
  LoadFurtherSections(core);
  for (int edit = 0; edit < kMostEdits && !choices.Done(); ++edit) {
    Edit(core, choices);
    CheckTable(core);
  }
  ResetExpressionScanner();
  core.RebuildSymbolTable();
  Errors().ClearErrors();
  core.ValidateTemplate();
  const std::string path = fuzz::ScratchFile("edited.tessal");
  if (!core.SaveWrapper(path)) {
    Require(!Errors().Records().empty(), "a failed save says why");
    return 0;
  }
  const std::string content = test::TemplateContent(core);
  ResetExpressionScanner();
  TemplateCore again;
  Require(again.LoadWrapper(path), "what was saved loads");
  const std::string loaded = test::TemplateContent(again);
  if (loaded != content) std::fprintf(stderr, "%s\n-- becomes --\n%s\n", content.c_str(), loaded.c_str());
  Require(loaded == content, "and holds the same values");
  Require(content.find("// at its head") != std::string::npos, "among them the further sections");
  return 0;
}
