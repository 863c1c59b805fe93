#include "support/template_text.h"

#include <algorithm>
#include <array>
#include <random>
#include <sstream>
#include <stdexcept>

namespace tessal::test {

namespace {

/// A kind of line: where it goes, and its keywords, with the symbol for $S, the value for $V and the number
/// of the class for $N. Expressions are written between both kinds of quotes.
struct KindRow {
  std::string_view word;
  std::string_view section;  ///< the list; the elements of a kind without one are sections of their own
  std::string_view prefix;
  std::string_view keywords;
};

#define TESSAL_TEXTS "DESCRIPTION='';ONLINE_HELP='';DOCUMENTATION='';"
#define TESSAL_NAMED "SYMBOL='$S';ID=1;" TESSAL_TEXTS
#define TESSAL_BASE TESSAL_NAMED "UNQ_TYPE=999;UNQ_UNIT=0;"
#define TESSAL_INPUT \
  TESSAL_BASE        \
  "IS_USER_SPECIFIED='YES';BUILT_IN_ID=-1;SCOPE='NOT_SPECIFIED';SPATIAL_VARIATION='NONE';UNIT='m';"

constexpr std::array<KindRow, 17> kKinds = {{
    {"state", "STATE_VARIABLES", "STATE_VARIABLE_",
     TESSAL_BASE "SCOPE='WC';TRANSPORT='FIXED';UNIT='mg/l';DEFAULT_VALUE=1;MIN_VALUE=0;MAX_VALUE=10"},
    {"constant", "CONSTANTS", "CONSTANT_", TESSAL_INPUT "DEFAULT_VALUE=$V;MIN_VALUE=0;MAX_VALUE=100"},
    {"forcing", "FORCINGS", "FORCING_", TESSAL_INPUT "DEFAULT_VALUE=1;MIN_VALUE=0;MAX_VALUE=100"},
    {"auxiliary", "AUXILIARY_VARIABLES", "AUXILIARY_VARIABLE_",
     TESSAL_BASE "OUTPUT='YES';SCOPE='NOT_SPECIFIED';SPATIAL_VARIATION='HORISONTAL_AND_VERTICAL';UNIT='-';"
                 "EXPRESSION='\"$V\"'"},
    {"process", "PROCESSES", "PROCESS_",
     TESSAL_BASE "OUTPUT='YES';PROCESS_TYPE='TRANSFORMATION';SCOPE='WC';"
                 "SPATIAL_VARIATION='HORISONTAL_AND_VERTICAL';UNIT='-';EXPRESSION='\"$V\"';CONTROLID=-1;"
                 "CONTROLVALUE=0.8"},
    {"output", "DERIVED_OUTPUTS", "DERIVED_OUTPUT_",
     "ID=1;" TESSAL_TEXTS "UNQ_TYPE=999;UNQ_UNIT=0;SCOPE='NOT_SPECIFIED';"
     "SPATIAL_VARIATION='HORISONTAL_AND_VERTICAL';UNIT='-';FORMAT='INSTANTANEOUS';EXPRESSION='\"$V\"'"},
    {"class.state", "STATE_VARIABLES", "S",
     TESSAL_BASE "SPECIE=$N;UNIT='kg';DEFAULT_VALUE=1;MIN_VALUE=0;MAX_VALUE=10"},
    {"class.constant", "CONSTANTS", "C",
     TESSAL_BASE "SPATIAL_VARIATION='PER_SPECIE';UNIT='kg';DEFAULT_VALUE=$V;MIN_VALUE=0;MAX_VALUE=10"},
    {"class.forcing", "FORCINGS", "F",
     TESSAL_BASE "SCOPE='PER_SPECIE';SPATIAL_VARIATION='PER_SPECIE';UNIT='m';DEFAULT_VALUE=1;MIN_VALUE=0;"
                 "MAX_VALUE=10"},
    {"class.search", "SPATIAL_FUNCTIONS", "SPATIAL_FUNCTION_",
     TESSAL_BASE "FUNCTION_ID=100;VARIABLE_ID=$V;SPECIE_ID=$N;RADIUS=5;DIMENSION=2;"
                 "SPATIAL_VARIATION='PER_INDIVIDUAL';PURPOSE='MAGNITUDE';FRAMEWORK='EULER';PROPERTY='NONE';"
                 "MATH='MIN';LOOKFOR=-1"},
    {"class.expression", "ARITHMETICAL_EXPRESSIONS", "A",
     TESSAL_BASE "EXPRESSION_TYPE='AUXILIARY_VARIABLE';SPECIE=$N;OUTPUT='YES';"
                 "SPATIAL_VARIATION='PER_INDIVIDUAL';UNIT='-';EXPRESSION='\"$V\"'"},
    {"class.movement", "", "H",
     "EXPRESSION_HORIZONTAL_SPEED='\"$S\"';EXPRESSION_HORIZONTAL_DIRECTION='\"$V\"'"},
    {"class.descent", "", "VERTICAL", "EXPRESSION_VERTICAL_SPEED='\"$V\"'"},
    {"class", "", "SPECIE_",
     "NAME='$S';" TESSAL_TEXTS "SCOPE='WC';PROJECTION_TIME=0;FIELD_OF_VIEW=180;TRANSPORT='USER_SPECIFIED'"},
    {"settings", "", "MISC",
     TESSAL_TEXTS "TESSAL_VERSION=2017.0014;PARSER_VERSION=2017.001;RANDSEED=0;DEBUG_LEVEL=0;DEBUG_LOG='';"
                  "RANDOM_PARTICLE_DIR='NO';BUILD_SPATIAL_TREE='NO';CHECKSUM='0'"},
    {"function", "EXTERNAL_FUNCTIONS", "EXTERNAL_FUNCTION_",
     "SYMBOL='User $S';ID=1;" TESSAL_TEXTS "PUBLICNAME='$S';PARAMETERS=1;USED_AS='AS_MATH_FUNC';"
     "DLL='plugin.dll';ENTRYPOINT='entry'"},
    {"head", "", "", TESSAL_TEXTS},
}};

const KindRow& RowOf(std::string_view word) {
  const auto* const row =
      std::find_if(kKinds.begin(), kKinds.end(), [word](const KindRow& each) { return each.word == word; });
  if (row == kKinds.end()) throw std::invalid_argument("no kind of line: " + std::string(word));
  return *row;
}

std::string Replaced(std::string text, std::string_view part, const std::string& by) {
  for (std::size_t place = 0; (place = text.find(part, place)) != std::string::npos; place += by.size())
    text.replace(place, part.size(), by);
  return text;
}

std::string Lines(const Keywords& keywords) {
  std::string text;
  for (const auto& [name, value] : keywords) text += name + " = " + value + "\n";
  return text;
}

std::string Section(const std::string& name, const std::string& content) {
  return "[" + name + "]\n" + content + "EndSect  // " + name + "\n\n";
}

}  // namespace

TemplateText& TemplateText::Add(const std::string& kind, const std::string& symbol,
                                const std::string& value) {
  if (kind == "class") classes.emplace_back();
  const bool isInClass = kind.starts_with("class");
  Elements& elements = isInClass ? classes.back()[kind] : lists[kind == "head" ? symbol : kind];
  last = &elements.emplace_back();
  last->equation = Section("E", symbol + " = '\"" + value + "\"'\n");
  std::istringstream rows{std::string(RowOf(kind).keywords)};
  for (std::string row; std::getline(rows, row, ';');) {
    const std::size_t equals = row.find('=');
    const std::string number = std::to_string(classes.size());
    last->keywords.emplace_back(
        row.substr(0, equals),
        Replaced(Replaced(Replaced(row.substr(equals + 1), "$S", symbol), "$N", number), "$V", value));
  }
  return *this;
}

TemplateText& TemplateText::Specie(const std::string& name, const std::string& equation,
                                   const Keywords& expressions) {
  Add("class", name).Add("class.state", name + "_Mass", equation);
  for (const auto& [symbol, expression] : expressions) Add("class.expression", symbol, expression);
  return Add("class.movement", "0", "0");
}

TemplateText& TemplateText::With(const std::string& keyword, const std::string& value) {
  for (auto& [name, present] : last->keywords) {
    if (name != keyword) continue;
    present = value;
    return *this;
  }
  last->keywords.emplace_back(keyword, value);
  return *this;
}

TemplateText& TemplateText::Without(const std::string& keyword) {
  std::erase_if(last->keywords, [&keyword](const auto& entry) { return entry.first == keyword; });
  return *this;
}

TemplateText& TemplateText::Group(const std::string& name) {
  groups.emplace_back(name, "");
  return *this;
}

TemplateText& TemplateText::Level(const std::string& name, const std::string& items) {
  const std::string listed = items.empty() ? "ITEMCOUNT = 0\n" : "ITEMCOUNT = 1\nITEMS = " + items + "\n";
  groups.back().second +=
      Section("L", "LEVEL = '" + name + "'\nDESCRIPTION = '" + name + " text'\n" + listed);
  return *this;
}

std::string TemplateText::Members(const Lists& from, std::string_view kind) {
  const auto elements = from.find(kind);
  std::string content;
  for (std::size_t place = 0; elements != from.end() && place < elements->second.size(); ++place) {
    content += Section(std::string(RowOf(kind).prefix) + std::to_string(place + 1),
                       Lines(elements->second[place].keywords));
  }
  return content;
}

std::string TemplateText::Equations(const Lists& from, std::string_view kind) {
  const auto elements = from.find(kind);
  std::string content;
  for (std::size_t place = 0; elements != from.end() && place < elements->second.size(); ++place)
    content += elements->second[place].equation;
  return content;
}

std::string TemplateText::HeadOf(std::string_view list) const {
  const auto head = lists.find(list);
  return head == lists.end() ? "DESCRIPTION = ''\nONLINE_HELP = ''\nDOCUMENTATION = ''\n"
                             : Lines(head->second.back().keywords);
}

std::string TemplateText::ListOf(const Lists& from, std::string_view kind) const {
  const std::string section(RowOf(kind).section);
  const bool isInClass = kind.starts_with("class");
  return Section(section, HeadOf(isInClass ? "none" : section) + Members(from, kind));
}

std::string TemplateText::ClassText(const Lists& specie, const std::string& number) const {
  std::string content = Lines(specie.at("class").back().keywords);
  for (const char* kind :
       {"class.state", "class.constant", "class.forcing", "class.search", "class.expression"}) {
    if (specie.contains(kind)) content += ListOf(specie, kind);
  }
  content += Section("LAGRANGE_STATE_VARIABLE_EQUATIONS", Equations(specie, "class.state")) +
             Section("HORIZONTAL_VECTORS_SECTION", Members(specie, "class.movement"));
  if (specie.contains("class.descent")) {
    content += Section("VERTICAL_SPEED_EQUATION", Lines(specie.at("class.descent").back().keywords));
  }
  return Section("SPECIE_" + number, content);
}

std::string TemplateText::SettingsText() const {
  const auto settings = lists.find("settings");
  if (settings == lists.end()) return "";
  std::string content = Lines(settings->second.back().keywords) + furtherSettings;
  if (lists.contains("function")) content += ListOf(lists, "function");
  std::string all;
  for (const auto& [name, levels] : groups) {
    all += Section("G", "GROUP = '" + name + "'\nDESCRIPTION = '" + name + " text'\nLEVELS = 0\n" + levels);
  }
  if (!groups.empty()) {
    content += Section("VISIBILITY_GROUPS",
                       HeadOf("none") + "GROUPS = " + std::to_string(groups.size()) + "\n" + all);
  }
  return Section("MISC", content);
}

std::string TemplateText::Text() const {
  std::string content = HeadOf("") + SettingsText();
  for (const char* kind : {"state", "constant", "forcing", "auxiliary", "process", "output"}) {
    content += ListOf(lists, kind);
  }
  content += Section("STATE_VARIABLE_EQUATIONS", Equations(lists, "state"));
  std::string species;
  for (std::size_t place = 0; place < classes.size(); ++place) {
    species += ClassText(classes[place], std::to_string(place + 1));
  }
  if (!species.empty()) content += Section("LAGRANGE", species);
  return "\n" + before + Section("TESSAL_SETUP", content) + behind;
}

namespace {

std::string TakeWord(std::string& text) {
  const std::size_t end = std::min(text.find(' '), text.size());
  std::string word = text.substr(0, end);
  text.erase(0, std::min(end + 1, text.size()));
  return word;
}

void Change(TemplateText& text, std::istringstream changes) {
  for (std::string change; std::getline(changes, change, ';');) {
    change.erase(0, change.find_first_not_of(' '));
    const std::size_t equals = change.find('=');
    if (change.front() == '-') {
      text.Without(change.substr(1));
    } else {
      text.With(change.substr(0, equals), change.substr(equals + 1));
    }
  }
}

void AddLine(TemplateText& text, const std::string& kind, std::string rest) {
  if (kind == "settings") {
    text.Misc(Replaced(rest, " ", "\n") + "\n");
  } else if (kind == "before") {
    text.Before(rest + "\n");
  } else if (kind == "behind") {
    text.Behind(rest + "\n");
  } else if (kind == "group") {
    text.Group(rest);
  } else if (kind == "output" || kind == "class.descent") {
    text.Add(kind, "", rest);
  } else {
    const std::string symbol = TakeWord(rest);
    if (kind == "level") {
      text.Level(symbol, rest);
    } else {
      text.Add(kind, symbol, rest.empty() && kind.ends_with("constant") ? "1" : rest);
    }
  }
}

}  // namespace

std::string TemplateFromNotation(const std::string& lines) {
  TemplateText text;
  std::istringstream stream(lines);
  for (std::string line; std::getline(stream, line);) {
    const std::size_t bar = line.find(" | ");
    std::string rest = line.substr(0, bar);
    const std::string kind = TakeWord(rest);
    AddLine(text, kind, rest);
    if (bar != std::string::npos) Change(text, std::istringstream(line.substr(bar + 3)));
  }
  return text.Text();
}

std::string RandomTemplate(unsigned seed, int elements) {
  std::mt19937 random(seed);
  const auto pick = [&random](int count) {
    return static_cast<int>(random() % static_cast<unsigned>(count));
  };
  TemplateText text;
  text.Misc("DOCUMENT_REVISION = 3\n");
  const int quarter = elements / 4 + 1;
  for (int number = 0; number < quarter; ++number)
    text.Constant("c" + std::to_string(number), std::to_string(pick(100)));
  for (int number = 0; number < quarter / 2; ++number) text.Forcing("f" + std::to_string(number));
  for (int number = 0; number < quarter; ++number) {
    text.Auxiliary("aux" + std::to_string(number), "c" + std::to_string(pick(quarter)) + " * " +
                                                       std::to_string(pick(1000)) +
                                                       ".5e-3 + MAX(1, 2)\n  - 1");
    if (pick(3) == 0) text.With("DESCRIPTION", "|it's number " + std::to_string(number) + "|");
  }
  for (int number = 0; number < quarter; ++number) {
    text.Process("p" + std::to_string(number), "IF aux" + std::to_string(pick(quarter)) +
                                                   " > 0 THEN c0 ELSE aux" + std::to_string(pick(quarter)));
    if (pick(2) == 0) text.With("SCOPE", "'SED'").With("SPATIAL_VARIATION", "'HORISONTAL'");
  }
  for (int number = 0; number < quarter / 2 + 1; ++number) {
    text.StateVariable("S" + std::to_string(number), "p" + std::to_string(pick(quarter)));
  }
  text.DerivedOutput("S0 + c0");
  text.Specie("Fish", "Fish_grow", {{"Fish_aux", "c0*2"}, {"Fish_grow", "Fish_aux + Fish_Mass"}});
  text.Behind("[EXTRA] // kept\n// remark\nA = 1, 0.1, 'x', |y|\nEndSect // EXTRA\n");
  return text.Text();
}

}  // namespace tessal::test
