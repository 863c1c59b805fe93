#include "core/template_script.h"
#include "core/pools.h"

#include <algorithm>
#include <charconv>
#include <iterator>
#include <sstream>
#include <stdexcept>

#include "core/comparison.h"
#include "core/completion.h"
#include "core/error_registry.h"
#include "core/expression_faults.h"
#include "core/loaded_template.h"
#include "core/rename.h"
#include "core/symbol_ranking.h"
#include "elements/version_stamp.h"
#include "expr/scanner.h"
#include "platform/number_text.h"
#include "support/template_text.h"

namespace tessal::test {

namespace {

constexpr std::string_view kExample = "from examples/";
constexpr const char* kModel = "model.tessal";
constexpr std::string_view kFile = "key file";

std::string YesNo(bool value) {
  return value ? "yes" : "no";
}

std::int32_t Number(const std::string& word) {
  std::int32_t number = 0;
  std::from_chars(word.data(), word.data() + word.size(), number);
  return number;
}

/// A place from 0 of a number from 1.
std::size_t Place(const std::string& word) {
  return static_cast<std::size_t>(Number(word) - 1);
}

/// How many messages there are of each level, from 0 for all, and how many warnings of expressions.
std::string Counts() {
  std::string text;
  for (std::uint32_t level = 0; level <= 5; ++level)
    text += std::to_string(Errors().GetErrorCount(level)) + " ";
  return text + "warnings " + std::to_string(Errors().ExpressionWarningCount());
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

ElementKind KindOf(const std::string& word) {
  const auto hit = std::find(kKinds.begin(), kKinds.end(), word);
  return static_cast<ElementKind>(hit == kKinds.end() ? Number(word) : hit - kKinds.begin());
}

/// The list that holds elements of the kind: a head of the template or of a class.
ElementKind ListOf(ElementKind kind) {
  const bool isMember = kind >= ElementKind::SpecieStateVariable;
  const auto place = static_cast<std::size_t>(
      NumberOf(kind) - NumberOf(isMember ? ElementKind::SpecieStateVariable : ElementKind::StateVariable));
  return KindAfter(isMember ? ElementKind::SpecieStateVariableList : ElementKind::StateVariableList, place);
}

/// The pattern, and after so many words what is said of it.
FindQuery QueryOf(const std::vector<std::string>& words, std::size_t options) {
  FindQuery query;
  query.pattern.text = words.at(0);
  for (std::size_t place = options; place < words.size(); ++place) {
    const std::string& word = words[place];
    query.pattern.isRegex |= word == "regex";
    query.pattern.wholeSymbols |= word == "whole";
    query.pattern.ignoreCase |= word == "nocase";
    if (word == "expressions") query.in = FindIn::Expressions;
    if (word == "texts") query.in = FindIn::Texts;
  }
  return query;
}

std::string FoundLine(const FoundText& found) {
  std::string text = found.text;
  for (auto match = found.matches.rbegin(); match != found.matches.rend(); ++match) {
    text.insert(match->start + match->length, 1, '>').insert(match->start, 1, '<');
  }
  return found.owner + ": " + std::string(found.place.field) + ": " + text;
}

std::string FoundLines(const std::vector<FoundText>& found) {
  std::string text = std::to_string(CountMatches(found)) + "\n";
  for (const FoundText& each : found) text += FoundLine(each) + "\n";
  return text;
}

std::string Ranked(const TemplateCore& core, const std::string& letters) {
  std::string names;
  for (const SymbolRecord* record : SymbolsByRank(core, letters, 8)) names += NameToGoTo(*record) + " ";
  return names + "\n";
}

CEL_Element& AddElement(TemplateCore& core, ElementKind kind, CEL_Lagrange_Specie* specie) {
  CEL_Element* added = specie == nullptr ? core.AddElement(kind) : specie->AddMember(kind);
  if (added == nullptr) throw std::invalid_argument("no kind that can be made");
  return *added;
}

/// What is offered at the bar in an expression of an element: the first rows, with the group that each is of.
std::string Offered(const TemplateCore& core, const CEL_Element& user, std::string expression) {
  constexpr std::array<std::string_view, 7> kGroups = {"symbol",  "function", "user function", "verb",
                                                       "keyword", "built-in", "property"};
  const std::size_t caret = expression.find('|');
  expression.erase(caret, 1);
  const CaretContext context = ContextAt(expression, caret);
  const std::string typed = expression.substr(context.word.start, caret - context.word.start);
  std::string rows;
  constexpr std::size_t kShown = 6;
  const std::vector<Completion> matching = Matching(CompletionsFor(core, user, context.place), typed);
  for (const Completion& row : std::span(matching).first(std::min(kShown, matching.size()))) {
    rows +=
        std::string(row.text) + ", " + std::string(kGroups.at(static_cast<std::size_t>(row.group))) + "\n";
  }
  return matching.size() <= kShown ? rows
                                   : rows + "and " + std::to_string(matching.size() - kShown) + " more\n";
}

/// What is wrong with a text as the expression of an element, at the offset where it is.
std::string FaultsIn(const TemplateCore& core, const CEL_Element& user, const std::string& expression) {
  std::string rows;
  for (const ExpressionFault& fault : FindExpressionFaults(core, user, expression)) {
    rows += std::to_string(fault.at.start) + "-" + std::to_string(fault.at.start + fault.at.length) + " " +
            fault.plain + (fault.words.empty() ? "" : " [" + fault.words + "]") + "\n";
  }
  return rows.empty() ? "none" : rows;
}

}  // namespace

TemplateScript::TemplateScript(const Case& script) {
  ResetExpressionScanner();
  Errors().Reset();
  SetNotifyChanges(true);
  if (script.input.starts_with(kExample)) {
    const std::string name = script.input.substr(kExample.size());
    folder.Write(kModel, ReadFile(std::string(TESSAL_SOURCE_DIR) + "/examples/" + name));
  } else if (script.input.starts_with(kFile)) {
    folder.Write("model.tessal",
                 script.input.size() > kFile.size() ? script.input.substr(kFile.size() + 1) + "\n" : "");
  } else if (!script.input.empty()) {
    folder.Write(kModel, TemplateFromNotation(script.input));
  }
}

TemplateScript::~TemplateScript() {
  SetNotifyChanges(false);
}

std::string TemplateScript::Answer(const CaseCall& call) {
  Words words = WordsOf(call.words);
  const std::string name = words.front();
  words.erase(words.begin());
  std::string answer;
  try {
    if (const auto question = Questions().find(name); question != Questions().end()) {
      answer = question->second(*this, words);
    } else {
      core.SetModified(false);
      answer = Changes().at(name)(*this, words);
      if (core.Modified()) answer += answer.empty() || answer.ends_with('\n') ? "modified" : ", modified";
    }
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
  replace(PlainNumberText(SoftwareVersion()), "VERSION");
  return text;
}

CEL_Element& TemplateScript::Element(const std::string& name) {
  std::uint32_t sequence = 0;
  if (core.FindSymbol(name, sequence)) return *core.GetElementBySequence(sequence);
  if (name == "setup") return core.Root();
  if (name == "settings" && core.GetMisc() != nullptr) return *core.GetMisc();
  const std::size_t list = name.find("list ");
  if (list == 0) return core.ListHead(ListOf(KindOf(name.substr(5))));
  if (list != std::string::npos) {
    return ClassIn({name.substr(0, list - 1)}, 0)->Head(ListOf(KindOf(name.substr(list + 5))));
  }
  if (name.starts_with("function ")) {
    return *core.GetMisc()->ExternalFunctions().at(Place(name.substr(9)));
  }
  throw std::invalid_argument("no element " + name);
}

std::uint32_t TemplateScript::SequenceOf(const std::string& name) const {
  std::uint32_t sequence = 0;
  return core.FindSymbol(name, sequence) ? sequence : static_cast<std::uint32_t>(Number(name));
}

std::string TemplateScript::SymbolOf(Uid uid) const {
  std::string symbol;
  return core.GetSymbolOfUid(uid, symbol) ? symbol : "-";
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
    const auto symbols = [this](std::span<const std::uint32_t> sequences) {
      std::vector<std::string> names(sequences.size());
      std::transform(sequences.begin(), sequences.end(), names.begin(), [this](std::uint32_t sequence) {
        return core.RecordSymbol(*core.FindRecordBySequence(sequence));
      });
      return names;
    };
    const auto bySymbols = [this](const auto& uids) {
      std::vector<std::string> names(uids.size());
      std::transform(uids.begin(), uids.end(), names.begin(), [this](Uid uid) { return SymbolOf(uid); });
      return names;
    };
    const CEL_Element& element = *record.element;
    text += std::to_string(record.sequence) + " " + core.RecordSymbol(record) + ": " +
            std::string(element.KindText()) + " " + std::to_string(record.index);
    if (record.specieIndex >= 0) text += " of class " + std::to_string(record.specieIndex);
    text += ", scope " + std::to_string(static_cast<int>(record.scope)) + ", spatial " +
            std::to_string(static_cast<int>(record.spatial)) + ", \"" + RecordText(record) + "\"";
    if (element.id.IntValue() != static_cast<std::int32_t>(record.sequence))
      text += ", id " + element.id.TextOf();
    if (record.uid != element.GetUid()) text += ", of another identity";
    text += listed("uses", symbols(record.references)) + listed("used by", symbols(record.referencedBy));
    std::vector<Uid> users;
    core.GetReferrerUids(record.uid, users);
    if (symbols(record.referencedBy) != bySymbols(users)) {
      text += listed("used by elements", bySymbols(users));
    }
    for (const auto& [group, level] : element.Visibility())
      text += "  in " + std::to_string(group) + "/" + std::to_string(level);
    text += "\n";
  }
  return text;
}

std::string TemplateScript::Order() const {
  std::string text;
  for (const SymbolRecord& record : core.SymbolTable()) text += core.RecordSymbol(record) + "; ";
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

std::string TemplateScript::Compare() const {
  const MessagesAside aside;
  TemplateCore file;
  file.LoadWrapper(folder.File(kModel));
  std::string text;
  for (const SymbolChange& change : CompareBySymbol(file, core)) {
    text += "-+*~"[static_cast<std::size_t>(change.change)];
    text += " " + change.kind + " '" + change.symbol + "'";
    text += (change.formerSymbol.empty() ? "" : " was '" + change.formerSymbol + "'") + "\n";
    for (const FieldChange& field : change.fields)
      text += "    " + field.field + ": '" + field.before + "' -> '" + field.after + "'\n";
  }
  return text + (NotifyChanges() ? "" : "notifications stay off");
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
  request.kind = KindOf(words.at(0));
  request.symbol = words.at(1) == "-" ? "" : words.at(1);
  if (words.size() > 2) {
    request.ownerId = ClassIn(words, 2)->Head(ListOf(KindOf(words[0]))).GetUid();
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
             (specie == nullptr ? ""
                                : " of " + specie->symbol.TextOf() + ", " +
                                      std::string(core.GetElement(request->ownerId)->KindText())) +
             "\n";
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

/// The properties that may not be edited, of those that something locks.
std::string TemplateScript::Locks(const std::string& name) {
  std::string text;
  const auto note = [&text](const char* label, const CEL_Property& property) {
    if (!property.Editable()) text += std::string(text.empty() ? "" : ", ") + label;
  };
  CEL_Element& element = Element(name);
  note("symbol", element.symbol);
  note("type", element.unqType);
  note("number", element.unqUnit);
  if (const auto* input = dynamic_cast<CEL_Input*>(&element)) {
    note("scope", input->scope);
    note("variation", input->spatialVariation);
    note("unit", input->unit);
    note("default", input->defaultValue);
    note("minimum", input->minValue);
    note("maximum", input->maxValue);
  }
  if (const auto* variable = dynamic_cast<CEL_StateVariable*>(&element)) note("unit", variable->unit);
  if (const auto* value = dynamic_cast<CEL_SpecieValue*>(&element)) note("unit", value->unit);
  if (const auto* function = dynamic_cast<CEL_ExternalFunction*>(&element)) {
    note("parameters", function->parameters);
  }
  return text.empty() ? "none" : text;
}

/// What a level includes, and what could be added to it.
std::string TemplateScript::LevelItems(const Words& words) {
  const std::int32_t group = Number(words.at(0));
  const std::int32_t level = Number(words.at(1));
  std::string text = "included";
  for (const std::int32_t item : core.IncludedItems(group, level)) text += " " + std::to_string(item);
  text += ", available";
  for (const std::int32_t item : core.AvailableItems(group, level)) text += " " + std::to_string(item);
  return text;
}

std::string TemplateScript::Lookups(const std::string& name) {
  const CEL_Element& element = Element(name);
  const auto uid = element.GetUid();
  std::string text = std::string(element.KindText());
  if (core.GetElement(uid) != &element) text += ", not found";
  if (core.GetElement(uid, element.Kind()) == nullptr) text += ", not of its kind";
  if (core.GetElement(uid, ElementKind::Unknown) != nullptr) text += ", of any kind";
  if (core.FindRecordByUid(uid) != core.RecordOfElement(element)) text += ", of two records";
  std::uint32_t sequence = 0;
  if (core.GetSequenceOfUid(uid, sequence)) text += ", number " + std::to_string(sequence);
  if (element.Parent() != nullptr) text += ", below " + element.Parent()->symbol.TextOf();
  if (element.ListHeader() != nullptr) text += ", headed";
  text += ", line " + std::to_string(element.SourceLine()) + (element.Loaded() ? "" : ", not loaded");
  if (core.SymbolExists(name)) text += ", exists";
  if (core.IsSymbolTakenByOther(uid, name)) text += ", taken";
  if (core.IsReferenced(uid)) text += ", referenced";
  std::vector<std::string> symbols = {"stale"};
  text += core.GetReferrerSymbols(uid, symbols) ? ", used by" : ", no referrers";
  for (const std::string& symbol : symbols) text += " " + symbol;
  std::vector<Uid> uids;
  if (core.GetReferrerUids(uid, uids)) text += " (" + std::to_string(uids.size()) + ")";
  if (const auto* specie = core.GetParentSpecie(uid)) text += ", list of " + specie->symbol.TextOf();
  std::int32_t id = -1;
  auto found = ElementKind::None;
  text += core.FindElementBySymbol(name, id, found) ? ", by symbol " : ", not by symbol ";
  return text + std::to_string(id) + " " + std::to_string(NumberOf(found));
}

std::string TemplateScript::State() const {
  std::ostringstream text;
  text << core.GetStateVariableCount() << " states " << core.GetConstantCount() << " constants "
       << core.GetForcingCount() << " forcings " << core.GetAuxiliaryCount() << " auxiliaries "
       << core.GetProcessCount() << " processes " << core.GetDerivedOutputCount() << " outputs "
       << core.GetSpecieCount() << " classes " << core.GetExternalFunctionCount() << " functions, named "
       << core.CountNamedElements() << ", revision " << core.GetDocumentRevision() << "\nfile '"
       << core.TemplateFileName() << "' saved to '" << core.SaveFileName() << "' kept "
       << std::ranges::distance(core.KeptTree().Children()) << (core.Modified() ? " modified" : "")
       << (core.GetMisc() == nullptr ? " without settings" : "");
  return text.str();
}

std::string TemplateScript::Account() const {
  constexpr std::array<const char*, 4> kKinds = {"absent", "unread", "changed", "dropped"};
  std::string text;
  for (const AccountEntry& entry : core.Account().Entries()) {
    const bool canBeTaken = entry.value || entry.ofVisibility;
    text += std::to_string(entry.line) + " " + std::string(entry.code) + " " +
            kKinds.at(static_cast<std::size_t>(entry.kind)) + (canBeTaken ? "+" : "") + " " + entry.symbol +
            ": " + entry.text + "\n";
  }
  return text;
}

std::string TemplateScript::Save(const std::string& name) {
  core.SetModified(false);
  const bool saved = core.SaveWrapper(name.starts_with("/") ? name : folder.File(name));
  return std::string(saved ? "saved" : "failed") + (core.Modified() ? ", modified" : "");
}

/// The file's bytes, with a mark for each line feed that has no carriage return before it.
std::string TemplateScript::File(const std::string& name) const {
  const std::string text = ReadFile(folder.File(name));
  std::string shown;
  for (std::size_t place = 0; place < text.size(); ++place) {
    const bool isLineEnd = text.compare(place, 2, "\r\n") == 0;
    if (text[place] == '\n') shown += "(no carriage return)";
    if (isLineEnd) ++place;
    shown += text[place];
  }
  return shown;
}

std::string TemplateScript::EditFile(const std::string& part, const std::string& by) {
  std::string text = ReadFile(folder.File(kModel));
  text.replace(text.find(part), part.size(), by);
  folder.Write(kModel, text);
  return {};
}

CEL_Lagrange_Specie* TemplateScript::ClassIn(const Words& words, std::size_t place) {
  return place < words.size() ? &dynamic_cast<CEL_Lagrange_Specie&>(Element(words[place])) : nullptr;
}

std::string TemplateScript::Lost(const std::string& oldSymbol, const std::string& newSymbol) const {
  std::string lines;
  for (const LostName& lost : LostByRename(core, oldSymbol, newSymbol)) lines += LossText(core, lost) + "\n";
  return lines;
}

std::string TemplateScript::MoveBeforeFirstUser(const std::string& name) {
  Uid predecessor = UidOf(name);
  const bool moved = core.MoveBeforeFirstUser(UidOf(name), predecessor);
  return YesNo(moved) + " after " + SymbolOf(predecessor);
}

/// Calls that only ask.
namespace {

std::string PoolLines(const TemplateCore& core) {
  const PoolsRead read = PoolsOf(core);
  std::string lines;
  for (const Pool& pool : read.pools) {
    lines += pool.name + " = " + pool.expression + ';';
    for (const std::string& process : pool.boundary) lines += ' ' + process;
    lines += pool.description.empty() ? "\n" : " (" + pool.description + ")\n";
  }
  for (const std::string& part : read.notPools) lines += "no pool: " + part + '\n';
  return lines;
}

/// A name, an expression, and the processes of the boundary.
std::string AddPool(TemplateCore& core, const std::vector<std::string>& words) {
  std::vector<Pool> pools = PoolsOf(core).pools;
  pools.push_back({words.at(0), words.at(1), {words.begin() + 2, words.end()}, {}});
  std::string failure;
  return SetPools(core, pools, failure) ? "yes" : failure;
}

}  // namespace

const std::map<std::string, TemplateScript::Operation>& TemplateScript::Questions() {
  using S = TemplateScript&;
  using W = const Words&;
  static const std::map<std::string, Operation> kQuestions = {
      {"load", [](S s, W w) { return s.Load(s.folder.File(w.empty() ? kModel : w[0])); }},
      {"load-own", [](S s, W) { return s.Load(s.core.TemplateFileName()); }},
      {"load-nowhere", [](S s, W) { return s.Load("/nowhere.tessal"); }},
      {"save", [](S s, W w) { return s.Save(w.empty() ? std::string(kModel) : w[0]); }},
      {"file", [](S s, W w) { return s.File(w.empty() ? std::string(kModel) : w[0]); }},
      {"edit-file", [](S s, W w) { return s.EditFile(w.at(0), w.at(1)); }},
      {"messages", [](S, W) { return Messages(); }},
      {"account", [](S s, W) { return s.Account(); }},
      {"counts", [](S, W) { return Counts(); }},
      {"forget", [](S, W) { return Errors().ClearErrors(), ""; }},
      {"table", [](S s, W) { return s.Table(); }},
      {"order", [](S s, W) { return s.Order(); }},
      {"undefined", [](S s, W) { return s.Undefined(); }},
      {"state", [](S s, W) { return s.State(); }},
      {"compare", [](S s, W) { return s.Compare(); }},
      {"fields", [](S s, W w) { return s.Fields(w.at(0)); }},
      {"look", [](S s, W w) { return s.Lookups(w.at(0)); }},
      {"groups", [](S s, W) { return s.Groups(); }},
      {"items", [](S s, W w) { return s.Items(w); }},
      {"tree", [](S s, W) { return YesNo(s.core.GetMisc()->buildSpatialTree.BoolValue()); }},
      {"locks", [](S s, W w) { return s.Locks(w.at(0)); }},
      {"level-items", [](S s, W w) { return s.LevelItems(w); }},
      {"modified", [](S s, W) { return YesNo(s.core.Modified()); }},
      {"mark", [](S s, W) { return s.core.SetModified(true), ""; }},
      {"clear", [](S s, W) { return s.core.Clear(), ""; }},
      {"validate", [](S s, W) { return YesNo(s.core.ValidateTemplate()); }},
      {"parse", [](S s, W) { return YesNo(s.core.ParseAllExpressions()); }},
      {"check-order", [](S s, W) { return YesNo(s.core.CheckDeclarationOrder()); }},
      {"check-order-of", [](S s, W w) { return YesNo(s.core.CheckElementOrder(s.UidOf(w.at(0)))); }},
      {"scope-rule", [](S s, W) { return YesNo(s.core.CheckScopeRule()); }},
      {"process-rule", [](S s, W) { return YesNo(s.core.CheckProcessRule()); }},
      {"strict", [](S s, W w) { return s.core.SetStrictScopeRule(Number(w.at(0))), ""; }},
      {"rebuilds", [](S s, W w) { return s.core.SetRebuildEnabled(w.at(0) == "on"), ""; }},
      {"all-builtins", [](S s, W w) { return s.core.SetShowAllBuiltIns(w.at(0) == "yes"), ""; }},
      {"complete", [](S s, W w) { return Offered(s.core, s.Element(w.at(0)), w.at(1)); }},
      {"faults", [](S s, W w) { return FaultsIn(s.core, s.Element(w.at(0)), w.at(1)); }},
      {"can-delete", [](S s, W w) { return YesNo(s.core.CanDelete(s.UidOf(w.at(0)))); }},
      {"can-move", [](S s, W w) { return YesNo(s.core.CanMove(s.UidOf(w.at(0)), s.UidOf(w.at(1)))); }},
      {"refusal", [](S s, W w) { return RenameRefusal(s.core, w.at(0)); }},
      {"rename-failure", [](S, W w) { return RenameFailure(w.at(0)); }},
      {"lost-by-rename", [](S s, W w) { return s.Lost(w.at(0), w.at(1)); }},
      {"find", [](S s, W w) { return FoundLines(FindTexts(s.core, QueryOf(w, 1)).found); }},
      {"uses", [](S s, W w) { return FoundLines(FindUses(s.core, w.at(0))); }},
      {"preview", [](S s, W w) { return s.Preview(w); }},
      {"pools", [](S s, W) { return PoolLines(s.core); }},
      {"beside", [](S s, W) { return s.core.KeptText(); }},
      {"rank", [](S s, W w) { return Ranked(s.core, w.empty() ? "" : w[0]); }},
      {"replace", [](S, W w) { return ReplaceWord(w.at(0), w.at(1), w.at(2)); }},
  };
  return kQuestions;
}

/// Calls that may change the template. Each is run with the mark of a change taken off, and says whether it
/// is back.
const std::map<std::string, TemplateScript::Operation>& TemplateScript::Changes() {
  using S = TemplateScript&;
  using W = const Words&;
  static const std::map<std::string, Operation> kChanges = {
      {"take-over", [](S s, W) { return YesNo(s.core.TakeOverPassedOver()); }},
      {"add", [](S s, W w) { return AddElement(s.core, KindOf(w.at(0)), s.ClassIn(w, 1)).symbol.TextOf(); }},
      {"add-function", [](S s, W) { return s.core.GetMisc()->AddExternalFunction().symbol.TextOf(); }},
      {"remove-function",
       [](S s, W w) { return YesNo(s.core.GetMisc()->RemoveExternalFunction(Place(w.at(0)))); }},
      {"rebuild", [](S s, W) { return s.core.RebuildSymbolTable(), ""; }},
      {"delete", [](S s, W w) { return YesNo(s.core.DeleteElement(s.UidOf(w.at(0)))); }},
      {"move",
       [](S s, W w) {
         return YesNo(s.core.MoveElement(s.UidOf(w.at(0)), s.UidOf(w.at(2)), w[1] == "before"));
       }},
      {"move-before-first-user", [](S s, W w) { return s.MoveBeforeFirstUser(w.at(0)); }},
      {"create", [](S s, W w) { return s.Create(w); }},
      {"offer", [](S s, W w) { return s.Offer(w); }},
      {"rename", [](S s, W w) { return YesNo(s.core.RenameSymbol(w.at(0), w.at(1), w.size() < 3)); }},
      {"rename-whole",
       [](S s, W w) { return YesNo(s.core.Rename(w.at(0), w.at(1), Rewriting::WholeNames)); }},
      {"apply", [](S s, W w) { return s.Apply(w); }},
      {"set", [](S s, W w) { return s.Set(w.at(0), w.at(1), w.at(2)); }},
      {"reset", [](S s, W w) { return s.Element(w.at(0)).Reset(), ""; }},
      {"add-pool", [](S s, W w) { return AddPool(s.core, w); }},
      {"refresh-searches", [](S s, W) { return s.core.RefreshSearchFunctionChoices(), ""; }},
      {"add-group", [](S s, W) { return std::to_string(s.core.AddVisibilityGroup()); }},
      {"remove-group", [](S s, W w) { return s.core.RemoveVisibilityGroup(Number(w.at(0))), ""; }},
      {"name-group", [](S s, W w) { return YesNo(s.core.SetGroupName(Number(w.at(0)), w.at(1))); }},
      {"describe-group", [](S s, W w) { return s.core.SetGroupDescription(Number(w.at(0)), w.at(1)), ""; }},
      {"name-level",
       [](S s, W w) { return YesNo(s.core.SetLevelName(Number(w.at(0)), Number(w.at(1)), w.at(2))); }},
      {"describe-level",
       [](S s, W w) { return s.core.SetLevelDescription(Number(w.at(0)), Number(w.at(1)), w.at(2)), ""; }},
      {"add-level", [](S s, W w) { return std::to_string(s.core.CreateLevel(Number(w.at(0)))); }},
      {"delete-level", [](S s, W w) { return s.core.DeleteLevel(Number(w.at(0)), Number(w.at(1))), ""; }},
      {"add-item",
       [](S s, W w) {
         return s.core.AddItemToLevel(Number(w.at(0)), Number(w.at(1)), s.SequenceOf(w.at(2))), "";
       }},
      {"remove-item",
       [](S s, W w) {
         return s.core.RemoveItemFromLevel(Number(w.at(0)), Number(w.at(1)), s.SequenceOf(w.at(2))), "";
       }},
  };
  return kChanges;
}

std::string TemplateScript::Preview(const Words& words) {
  ReplacePreview made = PreviewReplacements(core, QueryOf(words, 2), words.at(1));
  preview = std::move(made.replacements);
  std::string text = made.failure;
  for (const Replacement& each : preview) {
    constexpr std::array<std::string_view, 3> kObstacles = {"", " (a symbol)", " (locked)"};
    text += FoundLine(each.found) + " -> " + each.after;
    text.append(kObstacles[static_cast<std::size_t>(each.obstacle)])
        .append(each.isChosen ? "\n" : " not chosen\n");
  }
  return text;
}

std::string TemplateScript::Apply(const Words& unwanted) {
  for (const std::string& place : unwanted) preview.at(Place(place)).isChosen = false;
  const ReplaceOutcome outcome = ApplyReplacements(core, preview, EncodingOf(core.SourceText()));
  std::string text = std::to_string(outcome.applied) + "\n";
  for (const RefusedReplacement& each : outcome.refused)
    text += FoundLine(preview[each.place].found) + ": " + each.reason + "\n";
  return text;
}

}  // namespace tessal::test
