#include "core/template_script.h"

#include <algorithm>
#include <charconv>
#include <sstream>
#include <stdexcept>

#include "core/error_registry.h"
#include "core/loaded_template.h"
#include "core/rename.h"
#include "elements/version_stamp.h"
#include "expr/scanner.h"
#include "support/template_text.h"

namespace tessal::test {

namespace {

constexpr std::string_view kExample = "from examples/";
constexpr std::string_view kFile = "key file";

std::string YesNo(bool value) {
  return value ? "yes" : "no";
}

std::int32_t Number(const std::string& word) {
  std::int32_t number = 0;
  std::from_chars(word.data(), word.data() + word.size(), number);
  return number;
}

/// Words between blanks; one between double quotes may hold blanks.
std::vector<std::string> WordsOf(const std::string& text) {
  std::vector<std::string> words;
  std::size_t place = 0;
  while ((place = text.find_first_not_of(' ', place)) != std::string::npos) {
    const bool isQuoted = text[place] == '"';
    const std::size_t start = isQuoted ? place + 1 : place;
    const std::size_t end = std::min(text.find(isQuoted ? '"' : ' ', start), text.size());
    words.push_back(text.substr(start, end - start));
    place = std::min(end + 1, text.size());
  }
  return words;
}

/// Kinds that can be made, by the words of the scripts; their numbers are those of requests.
constexpr std::array<std::string_view, 14> kKinds = {"",
                                                     "state",
                                                     "constant",
                                                     "forcing",
                                                     "auxiliary",
                                                     "process",
                                                     "output",
                                                     "class",
                                                     "class.state",
                                                     "class.constant",
                                                     "class.forcing",
                                                     "class.search",
                                                     "class.expression",
                                                     "class.movement"};

std::int32_t KindOf(const std::string& word) {
  const auto hit = std::find(kKinds.begin(), kKinds.end(), word);
  return hit == kKinds.end() ? Number(word) : static_cast<std::int32_t>(hit - kKinds.begin());
}

/// The list of a class that holds members of the kind.
std::int32_t ClassListOf(std::int32_t kindNumber) {
  return kindNumber + kind::kSpecieStateVariableList - kind::kSpecieStateVariable;
}

CEL_Element& AddElement(TemplateCore& core, std::int32_t kindNumber, CEL_Lagrange_Specie* specie) {
  switch (kindNumber) {
    case 1:
      return core.AddStateVariable();
    case 2:
      return core.AddConstant();
    case 3:
      return core.AddForcing();
    case 4:
      return core.AddAuxiliary();
    case 5:
      return core.AddProcess();
    case 6:
      return core.AddDerivedOutput();
    case 7:
      return core.AddSpecie();
    case 8:
      return specie->AddStateVariable();
    case 9:
      return specie->AddConstant();
    case 10:
      return specie->AddForcing();
    case 11:
      return specie->AddSpatialFunction();
    case 12:
      return specie->AddArithmeticExpression();
    case 13:
      return specie->AddHorizontalVector();
    default:
      throw std::invalid_argument("no kind that can be made");
  }
}

}  // namespace

TemplateScript::TemplateScript(const Case& script) : path(folder.File("model.tessal")) {
  ResetExpressionScanner();
  Errors().Reset();
  SetNotifyChanges(true);
  if (script.input.starts_with(kExample)) {
    const std::string name = script.input.substr(kExample.size());
    folder.Write("model.tessal", ReadFile(std::string(TESSAL_SOURCE_DIR) + "/examples/" + name));
  } else if (script.input.starts_with(kFile)) {
    folder.Write("model.tessal",
                 script.input.size() > kFile.size() ? script.input.substr(kFile.size() + 1) + "\n" : "");
  } else if (!script.input.empty()) {
    folder.Write("model.tessal", TemplateFromNotation(script.input));
  }
}

TemplateScript::~TemplateScript() {
  SetNotifyChanges(false);
}

std::string TemplateScript::Answer(const CaseCall& call) {
  Words words = WordsOf(call.words);
  const std::string name = words.front();
  words.erase(words.begin());
  const auto operation = Operations().find(name);
  if (operation == Operations().end()) return "no such call\n";
  std::string answer;
  try {
    answer = operation->second(*this, words);
  } catch (const std::exception& failure) {
    answer = std::string("failure: ") + failure.what();
  }
  if (!answer.empty() && answer.back() != '\n') answer += '\n';
  return Shortened(std::move(answer));
}

/// The folder's name and the version differ from run to run or from build to build.
std::string TemplateScript::Shortened(std::string text) const {
  const auto replace = [&text](const std::string& part, std::string_view by) {
    for (std::size_t place; (place = text.find(part)) != std::string::npos;)
      text.replace(place, part.size(), by);
  };
  replace(folder.Path().string(), "FOLDER");
  replace(RealText(SoftwareVersion()), "VERSION");
  return text;
}

CEL_Element& TemplateScript::Element(const std::string& name) {
  std::uint32_t sequence = 0;
  if (core.FindSymbol(name, sequence)) return *core.GetElementBySequence(sequence);
  if (name == "setup") return core.Root();
  if (name == "settings" && core.GetMisc() != nullptr) return *core.GetMisc();
  const std::size_t list = name.find("list ");
  if (list == 0) return core.ListHead(KindOf(name.substr(5)) + kind::kStateVariableList - 1);
  if (list != std::string::npos) {
    auto& specie = dynamic_cast<CEL_Lagrange_Specie&>(Element(name.substr(0, list - 1)));
    return specie.Head(ClassListOf(KindOf(name.substr(list + 5))));
  }
  if (name.starts_with("function ")) {
    return *core.GetMisc()->ExternalFunctions().at(static_cast<std::size_t>(Number(name.substr(9)) - 1));
  }
  throw std::invalid_argument("no element " + name);
}

std::uint32_t TemplateScript::SequenceOf(const std::string& name) const {
  std::uint32_t sequence = 0;
  return core.FindSymbol(name, sequence) ? sequence : static_cast<std::uint32_t>(Number(name));
}

std::string TemplateScript::SymbolOf(std::uint32_t uid) const {
  std::string symbol;
  return core.GetSymbolOfUid(uid, symbol) ? symbol : "-";
}

std::string TemplateScript::Change(const std::function<std::string()>& change) {
  core.SetModified(false);
  std::string answer = change();
  if (core.Modified()) answer += answer.empty() || answer.ends_with('\n') ? "modified" : ", modified";
  return answer;
}

std::string TemplateScript::Load(const std::string& from) {
  core.SetModified(true);
  const bool loaded = core.LoadWrapper(from);
  std::string answer = (loaded ? "loaded" : "failed") + std::string(core.Modified() ? ", modified\n" : "\n");
  if (!NotifyChanges()) answer += "notifications stay off\n";
  return answer + Messages();
}

std::string TemplateScript::Table() const {
  const auto listed = [](const char* word, const std::vector<std::string>& names) {
    std::string text = names.empty() ? "" : std::string("  ") + word;
    for (const std::string& name : names) text += " " + name;
    return text;
  };
  std::string text;
  for (const SymbolRecord& record : core.SymbolTable()) {
    const auto symbols = [this](const std::vector<std::uint32_t>& sequences) {
      std::vector<std::string> names;
      for (const std::uint32_t sequence : sequences)
        names.push_back(core.RecordSymbol(*core.FindRecordBySequence(sequence)));
      return names;
    };
    const auto bySymbols = [this](const auto& uids) {
      std::vector<std::string> names;
      for (const auto uid : uids) names.push_back(SymbolOf(uid));
      return names;
    };
    const CEL_Element& element = *record.element;
    text += std::to_string(record.sequence) + " " + core.RecordSymbol(record) + ": " +
            std::string(element.KindText()) + " " + std::to_string(record.index);
    if (record.specieIndex >= 0) text += " of class " + std::to_string(record.specieIndex);
    text += ", scope " + std::to_string(record.scope) + ", spatial " + std::to_string(record.spatial) +
            ", \"" + record.text + "\"";
    if (element.id.IntValue() != static_cast<std::int32_t>(record.sequence))
      text += ", id " + element.id.TextOf();
    if (record.uid != element.GetUid()) text += ", of another identity";
    text += listed("uses", symbols(record.references)) + listed("used by", symbols(record.referencedBy));
    if (symbols(record.references) != bySymbols(record.referenceUids)) {
      text += listed("uses elements", bySymbols(record.referenceUids));
    }
    if (symbols(record.referencedBy) != bySymbols(record.referencedByUids)) {
      text += listed("used by elements", bySymbols(record.referencedByUids));
    }
    for (const auto& [group, level] : element.Visibility())
      text += "  in " + std::to_string(group) + "/" + std::to_string(level);
    text += "\n";
  }
  return text;
}

std::string TemplateScript::Undefined() const {
  std::string text;
  for (const auto& undefined : core.UndefinedSymbols()) {
    text += undefined->symbol + (undefined->asked ? " (asked)" : "") + ":";
    for (const auto uid : undefined->usedBy) text += " " + SymbolOf(uid);
    text += "\n";
  }
  return text;
}

std::string TemplateScript::Fields(const std::string& name) {
  std::vector<ElementField> fields;
  Element(name).GetFields(fields);
  std::string text;
  for (const ElementField& field : fields) {
    text += field.name + " = " + FieldText(field);
    for (const std::string& choice : field.choiceTexts)
      text += (&choice == field.choiceTexts.data() ? "  of " : " | ") + choice;
    text += "\n";
  }
  return text;
}

std::string TemplateScript::Set(const std::string& name, const std::string& label, const std::string& value) {
  CEL_Element& element = Element(name);
  std::vector<ElementField> fields;
  element.GetFields(fields);
  const ElementField* present = FindField(fields, label);
  if (present == nullptr) throw std::invalid_argument("no field " + label);
  ElementField field = *present;
  field.text = value;
  field.intValue = Number(value);
  field.boolValue = value == "yes";
  if (field.kind == FieldKind::Real) field.realValue = std::stod(value);
  return std::to_string(element.SetFields({field})) + " set";
}

std::string TemplateScript::Create(const Words& words) {
  CreateRequest request;
  request.kind = static_cast<std::uint32_t>(KindOf(words.at(0)));
  request.symbol = words.at(1) == "-" ? "" : words.at(1);
  if (words.size() > 2) {
    const auto list = ClassListOf(static_cast<std::int32_t>(request.kind));
    request.ownerId = dynamic_cast<CEL_Lagrange_Specie&>(Element(words.at(2))).Head(list).MessageUid();
  }
  const CreatedElement created = core.CreateElement(request);
  std::string answer = "created " + SymbolOf(created.uid);
  if (created.placed) answer += ", placed after " + SymbolOf(created.predecessor);
  return answer + (NotifyChanges() ? "" : ", notifications stay off");
}

/// Answers the offers from a list of `NAME=CHOICE`, No for a name without one; creates, and notes all of it.
std::string TemplateScript::Offer(const Words& words) {
  std::map<std::string, int> answers;
  for (const std::string& word : words) {
    const std::size_t equals = word.find('=');
    answers[word.substr(0, equals)] = Number(word.substr(equals + 1));
  }
  std::string notes;
  bool created = false;
  while (const auto offer = core.NextOffer()) {
    const std::string& name = offer->symbol;
    const bool isUsual =
        offer->question == "There are undefined symbols!\n\nDo you want to create symbol '" + name + "' ?";
    notes += (isUsual ? "" : offer->question) + name + (answers.contains(name) ? "" : " no") + "\n";
    if (!answers.contains(name)) continue;
    notes += "  one of " + std::to_string(offer->mask) + " for " + name + "\n";
    const CreateRequest* request = offer->RequestOf(answers[name]);
    if (request == nullptr) continue;
    const auto* specie = core.GetParentSpecie(request->ownerId);
    notes += "  creates " + request->symbol + ", " +
             std::string(kKinds.at(static_cast<std::size_t>(request->kind))) +
             (specie == nullptr ? "" : " of " + specie->symbol.Text()) + "\n";
    core.CreateElement(*request);
    created = true;
  }
  return notes + YesNo(created);
}

std::string TemplateScript::Groups() {
  if (core.GetMisc() == nullptr) return "no settings: '" + core.GroupText(0) + core.LevelText(1, 0) + "'\n";
  std::string text;
  const auto& groups = core.GetMisc()->Visibilities().groups;
  for (std::int32_t group = 0; group <= static_cast<std::int32_t>(groups.size()) + 1; ++group) {
    text += std::to_string(group) + ": " + core.GroupText(group) + " / " + core.GroupListText(group) + "\n";
    const bool exists = group >= 1 && group <= static_cast<std::int32_t>(groups.size());
    const auto levels =
        exists ? static_cast<std::int32_t>(groups[static_cast<std::size_t>(group - 1)].levels.size()) : 0;
    for (std::int32_t level = 0; level <= levels + 1; ++level) {
      const std::string number = std::to_string(level);
      text += "  " + number + ": " + core.LevelText(group, level) + " / " + core.LevelListText(group, level);
      for (const char* recursive : {"", "recursive"})
        text += " [" + Items({std::to_string(group), number, recursive}) + "]";
      text += "\n";
    }
  }
  return text;
}

std::string TemplateScript::Items(const Words& words) {
  std::vector<std::int32_t> items = {4711};
  core.CollectItems(Number(words.at(0)), Number(words.at(1)), items, words.back() == "recursive");
  std::string text;
  for (const std::int32_t item : items) text += (text.empty() ? "" : " ") + std::to_string(item);
  return text;
}

std::string TemplateScript::Lookups(const std::string& name) {
  const CEL_Element& element = Element(name);
  const auto uid = element.GetUid();
  std::string text = std::string(element.KindText());
  if (core.GetElement(uid) != &element) text += ", not found";
  if (core.GetElement(uid, element.Kind()) == nullptr) text += ", not of its kind";
  if (core.GetElement(uid, kind::kUnknown) != nullptr) text += ", of any kind";
  if (core.FindRecordByUid(uid) != core.RecordOfElement(element)) text += ", of two records";
  std::uint32_t sequence = 0;
  if (core.GetSequenceOfUid(uid, sequence)) text += ", number " + std::to_string(sequence);
  if (element.Parent() != nullptr) text += ", below " + element.Parent()->symbol.Text();
  if (element.ListHeader() != nullptr) text += ", headed";
  text += ", line " + std::to_string(element.SourceLine()) + (element.Loaded() ? "" : ", not loaded");
  if (core.SymbolExists(name)) text += ", exists";
  if (core.IsSymbolTakenByOther(uid, name)) text += ", taken";
  if (core.IsReferenced(uid)) text += ", referenced";
  std::vector<std::string> symbols = {"stale"};
  text += core.GetReferrerSymbols(uid, symbols) ? ", used by" : ", no referrers";
  for (const std::string& symbol : symbols) text += " " + symbol;
  std::vector<std::uint32_t> uids;
  if (core.GetReferrerUids(uid, uids)) text += " (" + std::to_string(uids.size()) + ")";
  if (const auto* specie = core.GetParentSpecie(uid)) text += ", list of " + specie->symbol.Text();
  std::int32_t id = -1;
  std::int32_t found = 0;
  text += core.FindElementBySymbol(name, id, found) ? ", by symbol " : ", not by symbol ";
  return text + std::to_string(id) + " " + std::to_string(found);
}

const std::map<std::string, TemplateScript::Operation>& TemplateScript::Operations() {
  using Script = TemplateScript;
  const auto changing = [](auto change) -> Operation {
    return [change](Script& script, const Words& words) {
      return script.Change([&] { return std::string(change(script, words)); });
    };
  };
  static const std::map<std::string, Operation> kOperations = {
      {"load", [](Script& s, const Words& w) { return s.Load(w.empty() ? s.path : s.folder.File(w[0])); }},
      {"load-own", [](Script& s, const Words&) { return s.Load(s.core.TemplateFileName()); }},
      {"load-nowhere", [](Script& s, const Words&) { return s.Load("/nowhere.tessal"); }},
      {"messages", [](Script&, const Words&) { return Messages(); }},
      {"counts", [](Script&, const Words&) {
         std::string text;
         for (std::uint32_t level = 0; level <= 5; ++level) text += std::to_string(Errors().GetErrorCount(level)) + " ";
         return text + "warnings " + std::to_string(Errors().ExpressionWarningCount());
       }},
      {"forget", [](Script&, const Words&) { return Errors().ClearErrors(), std::string(); }},
      {"table", [](Script& s, const Words&) { return s.Table(); }},
      {"order", [](Script& s, const Words&) {
         std::string text;
         for (const SymbolRecord& record : s.core.SymbolTable()) text += s.core.RecordSymbol(record) + "; ";
         return text;
       }},
      {"undefined", [](Script& s, const Words&) { return s.Undefined(); }},
      {"validate", [](Script& s, const Words&) { return YesNo(s.core.ValidateTemplate()); }},
      {"parse", [](Script& s, const Words&) { return YesNo(s.core.ParseAllExpressions()); }},
      {"check-order", [](Script& s, const Words& w) {
         return YesNo(w.empty() ? s.core.CheckDeclarationOrder() : s.core.CheckElementOrder(s.UidOf(w[0])));
       }},
      {"scope-rule", [](Script& s, const Words&) { return YesNo(s.core.CheckScopeRule()); }},
      {"process-rule", [](Script& s, const Words&) { return YesNo(s.core.CheckProcessRule()); }},
      {"strict", [](Script& s, const Words& w) { return s.core.SetStrictScopeRule(Number(w.at(0))), std::string(); }},
      {"add", changing([](Script& s, const Words& w) {
         auto* specie = w.size() < 2 ? nullptr : &dynamic_cast<CEL_Lagrange_Specie&>(s.Element(w[1]));
         return AddElement(s.core, KindOf(w.at(0)), specie).symbol.Text();
       })},
      {"add-function", changing([](Script& s, const Words&) { return s.core.GetMisc()->AddExternalFunction().symbol.Text(); })},
      {"remove-function", changing([](Script& s, const Words& w) {
         return YesNo(s.core.GetMisc()->RemoveExternalFunction(static_cast<std::size_t>(Number(w.at(0)) - 1)));
       })},
      {"rebuilds", [](Script& s, const Words& w) { return s.core.SetRebuildEnabled(w.at(0) == "on"), std::string(); }},
      {"mark", [](Script& s, const Words&) { return s.core.SetModified(true), std::string(); }},
      {"rebuild", changing([](Script& s, const Words&) { return s.core.RebuildSymbolTable(), ""; })},
      {"can-delete", [](Script& s, const Words& w) { return YesNo(s.core.CanDelete(s.UidOf(w.at(0)))); }},
      {"delete", changing([](Script& s, const Words& w) { return YesNo(s.core.DeleteElement(s.UidOf(w.at(0)))); })},
      {"can-move", [](Script& s, const Words& w) { return YesNo(s.core.CanMove(s.UidOf(w.at(0)), s.UidOf(w.at(1)))); }},
      {"move", changing([](Script& s, const Words& w) {
         return YesNo(s.core.MoveElement(s.UidOf(w.at(0)), s.UidOf(w.at(2)), w[1] == "before"));
       })},
      {"move-before-first-user", changing([](Script& s, const Words& w) {
         std::uint32_t predecessor = 4711;
         const bool moved = s.core.MoveBeforeFirstUser(s.UidOf(w.at(0)), predecessor);
         return YesNo(moved) + " after " + s.SymbolOf(predecessor);
       })},
      {"create", changing([](Script& s, const Words& w) { return s.Create(w); })},
      {"offer", changing([](Script& s, const Words& w) { return s.Offer(w); })},
      {"rename", changing([](Script& s, const Words& w) {
         return YesNo(s.core.RenameSymbol(w.at(0), w.at(1), w.size() < 3));
       })},
      {"refusal", [](Script& s, const Words& w) { return RenameRefusal(s.core, w.at(0)); }},
      {"rename-failure", [](Script&, const Words& w) { return RenameFailure(w.at(0)); }},
      {"replace", [](Script&, const Words& w) { return ReplaceWord(w.at(0), w.at(1), w.at(2)); }},
      {"set", changing([](Script& s, const Words& w) { return s.Set(w.at(0), w.at(1), w.at(2)); })},
      {"fields", [](Script& s, const Words& w) { return s.Fields(w.at(0)); }},
      {"look", [](Script& s, const Words& w) { return s.Lookups(w.at(0)); }},
      {"all-builtins", [](Script& s, const Words& w) { return s.core.SetShowAllBuiltIns(w.at(0) == "yes"), YesNo(s.core.ShowAllBuiltIns()); }},
      {"refresh-searches", changing([](Script& s, const Words&) { return s.core.RefreshSearchFunctionChoices(), ""; })},
      {"groups", [](Script& s, const Words&) { return s.Groups(); }},
      {"items", [](Script& s, const Words& w) { return s.Items(w); }},
      {"add-group", changing([](Script& s, const Words&) { return std::to_string(s.core.AddVisibilityGroup()); })},
      {"remove-group", changing([](Script& s, const Words& w) { return s.core.RemoveVisibilityGroup(Number(w.at(0))), ""; })},
      {"add-level", changing([](Script& s, const Words& w) { return std::to_string(s.core.CreateLevel(Number(w.at(0)))); })},
      {"delete-level", changing([](Script& s, const Words& w) { return s.core.DeleteLevel(Number(w.at(0)), Number(w.at(1))), ""; })},
      {"add-item", changing([](Script& s, const Words& w) {
         return s.core.AddItemToLevel(Number(w.at(0)), Number(w.at(1)), s.SequenceOf(w.at(2))), "";
       })},
      {"remove-item", changing([](Script& s, const Words& w) {
         return s.core.RemoveItemFromLevel(Number(w.at(0)), Number(w.at(1)), s.SequenceOf(w.at(2))), "";
       })},
      {"state", [](Script& s, const Words&) {
         const TemplateCore& core = s.core;
         std::ostringstream text;
         text << core.GetStateVariableCount() << " states " << core.GetConstantCount() << " constants "
              << core.GetForcingCount() << " forcings " << core.GetAuxiliaryCount() << " auxiliaries "
              << core.GetProcessCount() << " processes " << core.GetDerivedOutputCount() << " outputs "
              << core.GetSpecieCount() << " classes " << core.GetExternalFunctionCount() << " functions, named "
              << core.CountNamedElements() << ", revision " << core.GetDocumentRevision() << "\nfile '"
              << core.TemplateFileName() << "' saved to '" << core.SaveFileName() << "' kept "
              << core.KeptTree().Children().size() << (core.Modified() ? " modified" : "");
         return text.str();
       }},
      {"modified", [](Script& s, const Words&) { return YesNo(s.core.Modified()); }},
      {"clear", [](Script& s, const Words&) { return s.core.Clear(), std::string(); }},
      {"save", [](Script& s, const Words& w) {
         const std::string target = w.empty() ? s.path : w[0].starts_with("/") ? w[0] : s.folder.File(w[0]);
         s.core.SetModified(false);
         return std::string(s.core.SaveWrapper(target) ? "saved" : "failed") + (s.core.Modified() ? ", modified" : "");
       }},
      {"file", [](Script& s, const Words& w) {
         std::string text = ReadFile(w.empty() ? s.path : s.folder.File(w[0]));
         std::string shown;
         for (std::size_t place = 0; place < text.size(); ++place) {
           if (text.compare(place, 2, "\r\n") == 0) ++place;
           else if (text[place] == '\n') shown += "(no carriage return)";
           shown += text[place];
         }
         return shown;
       }},
      {"edit-file", [](Script& s, const Words& w) {
         std::string text = ReadFile(s.path);
         text.replace(text.find(w.at(0)), w[0].size(), w.at(1));
         s.folder.Write("model.tessal", text);
         return std::string();
       }},
  };
  return kOperations;
}

}  // namespace tessal::test
