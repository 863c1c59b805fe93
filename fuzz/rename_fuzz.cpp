// Renames among names that collide: a rename that is taken changes one symbol and, in the expressions, only
// what its way to rewrite them may; one that is refused changes nothing. What nobody asked to lose keeps its
// meaning.
#include <algorithm>
#include <array>
#include <cstdint>
#include <set>
#include <string>
#include <string_view>
#include <vector>

#include "core/error_registry.h"
#include "core/rename.h"
#include "core/template_core.h"
#include "expr/scanner.h"
#include "expr/semantic_checks.h"
#include "expr/user_function_names.h"
#include "support/choices.h"
#include "template_file.h"

namespace {

using namespace tessal;
using fuzz::Choices;
using fuzz::Require;

constexpr std::array<const char*, 14> kNames = {"a", "a_1", "a2",  "aa",      "K",   "K1",   "e",
                                                "x", "e5",  "Oxy", "Oxy_sat", "Mix", "Fish", "Fish_Number"};
constexpr std::array<const char*, 8> kNoNames = {"", "two words", "1a", "SIN", "IF", "Mass", "a+b", "\xE9"};
constexpr std::array<const char*, 24> kOther = {
    "+", "*",  "(",    ")", "1e5 ", "2 ", "1.5 ",   " ", "/* a */", "\n",  "\"",  "'",
    "?", "/ ", "MAX(", ",", " IF ", "^",  " THEN ", ":", "::",      "->+", "[a]", "SIN("};

/// Mostly names that are defined. No comment is left open: what follows one depends on where the last scan
/// ended.
std::string AnyExpression(Choices& choices, const std::vector<std::string>& defined) {
  const auto anyName = [&choices, &defined] {
    return choices.Pick(4) == 0 ? std::string(choices.AnyOf(kNames)) : choices.AnyOf(defined);
  };
  const bool isSound = choices.Pick(3) != 0;
  std::string text;
  for (std::size_t count = choices.Pick(6); count > 0; --count) {
    if (isSound) {
      text += anyName() + " + ";
    } else {
      text += choices.Pick(2) == 0 ? anyName() : choices.AnyOf(kOther);
    }
  }
  return isSound ? text + "1" : text;
}

std::vector<std::string> SymbolsOf(const TemplateCore& core) {
  std::vector<std::string> symbols;
  for (const SymbolRecord& record : core.SymbolTable()) symbols.push_back(record.element->symbol.TextOf());
  return symbols;
}

/// Elements of all kinds, a class among them, under any of the names, also one name for several, and user
/// functions.
void Fill(TemplateCore& core, Choices& choices) {
  const NotificationsOff silent;
  core.AddSpecie().symbol.SetText(choices.AnyOf(kNames));
  for (std::size_t count = 2 + choices.Pick(8); count > 0; --count) {
    CreateRequest request;
    request.kind = KindAfter(ElementKind::StateVariable, choices.Pick(13));
    if (request.kind > ElementKind::Specie) {
      request.ownerId = core.GetSpecie(0).Head(ElementKind::SpecieConstantList).GetUid();
    }
    CEL_Element* made = core.GetElement(core.CreateElement(request).uid);
    SetNotifyChanges(false);
    if (made != nullptr && made->symbol.Editable()) made->symbol.SetText(choices.AnyOf(kNames));
  }
  for (std::size_t count = choices.Pick(4); count > 0; --count) {
    core.GetMisc()->AddExternalFunction().publicName.SetText(choices.AnyOf(kNames));
  }
  std::vector<std::string> defined = SymbolsOf(core);
  std::erase_if(defined, [](const std::string& symbol) { return !IsValidSymbolSpelling(symbol); });
  if (defined.empty()) defined.emplace_back(kNames[0]);
  for (const SymbolRecord& record : core.SymbolTable()) {
    record.element->ForEachExpression([&choices, &defined](const PropertyRow&, CEL_Property& property) {
      property.SetText(AnyExpression(choices, defined));
    });
  }
  core.RebuildSymbolTable();
}

/// What a rename may change, and what must stay.
struct State {
  std::string text;  ///< of a save
  std::vector<std::string> symbols;
  std::vector<std::string> expressions;
  std::vector<std::vector<std::uint32_t>> references;
  std::set<std::string> undefined;
};

State StateOf(TemplateCore& core) {
  State state;
  std::string reason;
  state.text = core.CopyText(reason).value_or(reason);
  state.symbols = SymbolsOf(core);
  for (const SymbolRecord& record : core.SymbolTable()) {
    state.references.emplace_back(record.references.begin(), record.references.end());
    record.element->ForEachExpression([&state](const PropertyRow&, const CEL_Property& property) {
      state.expressions.push_back(property.TextOf());
    });
  }
  for (const auto& name : core.UndefinedSymbols()) state.undefined.insert(name->symbol);
  return state;
}

bool IsDigit(char character) {
  return character >= '0' && character <= '9';
}

bool IsWordByte(char character) {
  const bool isLetter = (character >= 'a' && character <= 'z') || (character >= 'A' && character <= 'Z');
  return isLetter || IsDigit(character) || character == '_';
}

/// Words and what is between them, by turns. Digits begin no word: `2a` is a number and a name.
std::vector<std::string> PiecesOf(std::string_view text) {
  std::vector<std::string> pieces(1);
  for (const char character : text) {
    const bool wantsWord = pieces.size() % 2 == 0;
    const bool isWord = IsWordByte(character) && (wantsWord || !IsDigit(character));
    if (isWord != wantsWord) pieces.emplace_back();
    pieces.back() += character;
  }
  return pieces;
}

void RequireWholeWordsOnly(const State& before, const State& after, const std::string& oldName,
                           const std::string& newName) {
  for (std::size_t place = 0; place < before.expressions.size(); ++place) {
    const auto former = PiecesOf(before.expressions[place]);
    const auto later = PiecesOf(after.expressions[place]);
    Require(former.size() == later.size(), "a rename by whole names makes and joins no words");
    for (std::size_t piece = 0; piece < former.size(); ++piece) {
      const bool isRenamed = former[piece] == oldName && later[piece] == newName;
      Require(isRenamed || former[piece] == later[piece], "a rename by whole names changes nothing else");
    }
  }
}

/// For the reader of a finding, who asks for it with a variable of the environment.
void Print(const State& state) {
  for (std::size_t place = 0; place < state.symbols.size(); ++place) {
    std::fprintf(stderr, "%zu %s uses", place + 1, state.symbols[place].c_str());
    for (const std::uint32_t used : state.references[place]) std::fprintf(stderr, " %u", used);
    std::fprintf(stderr, "\n");
  }
  for (const std::string& text : state.expressions) std::fprintf(stderr, "  = %s\n", text.c_str());
  for (const std::string& name : state.undefined) std::fprintf(stderr, "undefined: %s\n", name.c_str());
}

/// Every use means what it did, and none but the known names are undefined. A name that nobody had defined
/// may mean something from now on.
void RequireSameMeaning(const State& before, const State& after, const std::set<std::string>& known) {
  for (std::size_t place = 0; place < before.references.size(); ++place) {
    for (const std::uint32_t used : before.references[place]) {
      const auto& uses = after.references[place];
      Require(std::find(uses.begin(), uses.end(), used) != uses.end(), "a use stays");
    }
  }
  Require(std::includes(known.begin(), known.end(), after.undefined.begin(), after.undefined.end()),
          "no name becomes undefined");
}

/// Undefined names, and what a rename by letters makes of them: it asks about none of them.
std::set<std::string> RenamedByLetters(std::set<std::string> names, const std::string& oldName,
                                       const std::string& newName) {
  for (const std::string& name : std::set<std::string>(names)) {
    names.insert(ReplaceInExpression(name, oldName, newName));
  }
  return names;
}

void CheckTaken(const State& before, const State& after, const std::string& oldName,
                const std::string& newName) {
  const auto renamed =
      std::find(before.symbols.begin(), before.symbols.end(), oldName) - before.symbols.begin();
  auto symbols = before.symbols;
  symbols[static_cast<std::size_t>(renamed)] = newName;
  Require(after.symbols == symbols, "the first element of the name has the new one, and no other");
}

/// False when the new name is none that an expression can hold: what comes after it would mean little.
bool Rename(TemplateCore& core, Choices& choices) {
  constexpr std::array<Rewriting, 3> kWays = {Rewriting::WholeNames, Rewriting::ByLetters, Rewriting::None};
  const Rewriting way = choices.AnyOf(kWays);
  const std::string oldName = choices.AnyOf(SymbolsOf(core));
  const std::string newName = choices.Pick(8) == 7 ? choices.AnyOf(kNoNames) : choices.AnyOf(kNames);
  core.SetModified(false);
  const State before = StateOf(core);
  const std::vector<LostName> lost = LostByRename(core, oldName, newName);
  const bool isValid = RenameRefusal(core, newName).empty();
  if (!core.Rename(oldName, newName, way)) {
    const State after = StateOf(core);
    Require(!core.Modified(), "a refused rename is no change");
    Require(after.text == before.text, "and a save writes the same");
    Require(after.symbols == before.symbols && after.references == before.references, "and the table stays");
    return true;
  }
  Require(core.Modified(), "a rename is a change");
  const State after = StateOf(core);
  if (std::getenv("TESSAL_FUZZ_PRINT") != nullptr) {
    std::fprintf(stderr, "%s to %s, way %d\n", oldName.c_str(), newName.c_str(), static_cast<int>(way));
    Print(before);
    Print(after);
  }
  CheckTaken(before, after, oldName, newName);
  if (way == Rewriting::None) Require(after.expressions == before.expressions, "the uses stay as they are");
  if (!isValid) return false;
  if (way == Rewriting::WholeNames) {
    RequireWholeWordsOnly(before, after, oldName, newName);
    RequireSameMeaning(before, after, before.undefined);
  } else if (way == Rewriting::ByLetters && lost.empty()) {
    RequireSameMeaning(before, after, RenamedByLetters(before.undefined, oldName, newName));
  }
  return true;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  constexpr int kMostRenames = 12;
  ResetExpressionScanner();
  ResetUserFunctionNames();
  Errors().Reset();
  Choices choices(data, size);
  TemplateCore core;
  // Settings, which user functions are part of, come with the first save.
  Require(core.SaveWrapper(fuzz::ScratchFile("start.tessal")), "the start is saved");
  Fill(core, choices);
  int count = 0;
  while (count < kMostRenames && !choices.Done() && Rename(core, choices)) ++count;
  return 0;
}
