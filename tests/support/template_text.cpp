#include "support/template_text.h"

#include <functional>
#include <random>
#include <sstream>
#include <stdexcept>

namespace tessal::test {

namespace {

std::string Quoted(const std::string& text) {
  return "'" + text + "'";
}

std::string Expression(const std::string& text) {
  return "'\"" + text + "\"'";
}

std::string Lines(const Keywords& keywords) {
  std::string text;
  for (const auto& [name, value] : keywords) text += name + " = " + value + "\n";
  return text;
}

std::string Section(const std::string& name, const std::string& content) {
  return "[" + name + "]\n" + content + "EndSect  // " + name + "\n\n";
}

const Keywords kHead = {{"DESCRIPTION", "''"}, {"ONLINE_HELP", "''"}, {"DOCUMENTATION", "''"}};

Keywords Base(const std::string& symbol) {
  Keywords keywords = {{"SYMBOL", Quoted(symbol)}, {"ID", "1"}};
  keywords.insert(keywords.end(), kHead.begin(), kHead.end());
  keywords.insert(keywords.end(), {{"UNQ_TYPE", "999"}, {"UNQ_UNIT", "0"}});
  return keywords;
}

Keywords Joined(Keywords keywords, const Keywords& more) {
  keywords.insert(keywords.end(), more.begin(), more.end());
  return keywords;
}

Keywords Input(const std::string& symbol, const std::string& value) {
  return Joined(Base(symbol), {{"IS_USER_SPECIFIED", "'YES'"},
                               {"BUILT_IN_ID", "-1"},
                               {"SCOPE", "'NOT_SPECIFIED'"},
                               {"SPATIAL_VARIATION", "'NONE'"},
                               {"UNIT", "'m'"},
                               {"DEFAULT_VALUE", value},
                               {"MIN_VALUE", "0"},
                               {"MAX_VALUE", "100"}});
}

}  // namespace

TemplateText& TemplateText::Add(Elements& elements, Element element) {
  elements.push_back(std::move(element));
  last = &elements;
  return *this;
}

TemplateText& TemplateText::StateVariable(const std::string& symbol, const std::string& equation) {
  return Add(stateVariables, {Joined(Base(symbol), {{"SCOPE", "'WC'"},
                                                    {"TRANSPORT", "'FIXED'"},
                                                    {"UNIT", "'mg/l'"},
                                                    {"DEFAULT_VALUE", "1"},
                                                    {"MIN_VALUE", "0"},
                                                    {"MAX_VALUE", "10"}}),
                              Section("E", symbol + " = " + Expression(equation) + "\n")});
}

TemplateText& TemplateText::Constant(const std::string& symbol, const std::string& value) {
  return Add(constants, {Input(symbol, value), ""});
}

TemplateText& TemplateText::Forcing(const std::string& symbol) {
  return Add(forcings, {Input(symbol, "1"), ""});
}

TemplateText& TemplateText::Auxiliary(const std::string& symbol, const std::string& expression) {
  return Add(auxiliaries, {Joined(Base(symbol), {{"OUTPUT", "'YES'"},
                                                 {"SCOPE", "'NOT_SPECIFIED'"},
                                                 {"SPATIAL_VARIATION", "'HORISONTAL_AND_VERTICAL'"},
                                                 {"UNIT", "'-'"},
                                                 {"EXPRESSION", Expression(expression)}}),
                           ""});
}

TemplateText& TemplateText::Process(const std::string& symbol, const std::string& expression) {
  return Add(processes, {Joined(Base(symbol), {{"OUTPUT", "'YES'"},
                                               {"PROCESS_TYPE", "'TRANSFORMATION'"},
                                               {"SCOPE", "'WC'"},
                                               {"SPATIAL_VARIATION", "'HORISONTAL_AND_VERTICAL'"},
                                               {"UNIT", "'-'"},
                                               {"EXPRESSION", Expression(expression)},
                                               {"CONTROLID", "-1"},
                                               {"CONTROLVALUE", "0.8"}}),
                         ""});
}

TemplateText& TemplateText::DerivedOutput(const std::string& expression) {
  Add(derivedOutputs, {Joined(Base(""), {{"SCOPE", "'NOT_SPECIFIED'"},
                                         {"SPATIAL_VARIATION", "'HORISONTAL_AND_VERTICAL'"},
                                         {"UNIT", "'-'"},
                                         {"FORMAT", "'INSTANTANEOUS'"},
                                         {"EXPRESSION", Expression(expression)}}),
                       ""});
  return Without("SYMBOL");
}

TemplateText& TemplateText::Specie(const std::string& name, const std::string& equation,
                                   const Keywords& expressions) {
  Class(name).ClassState(name + "_Mass", equation);
  for (const auto& [symbol, expression] : expressions) ClassExpression(symbol, expression);
  return ClassMovement("0", "0");
}

TemplateText& TemplateText::Class(const std::string& name) {
  return Add(classes.emplace_back().itself,
             {Joined(Joined({{"NAME", Quoted(name)}}, kHead), {{"SCOPE", "'WC'"},
                                                               {"PROJECTION_TIME", "0"},
                                                               {"FIELD_OF_VIEW", "180"},
                                                               {"TRANSPORT", "'USER_SPECIFIED'"}}),
              ""});
}

TemplateText& TemplateText::ClassState(const std::string& symbol, const std::string& equation) {
  return Add(classes.back().states, {Joined(Base(symbol), {{"SPECIE", std::to_string(classes.size())},
                                                           {"UNIT", "'kg'"},
                                                           {"DEFAULT_VALUE", "1"},
                                                           {"MIN_VALUE", "0"},
                                                           {"MAX_VALUE", "10"}}),
                                     Section("E", symbol + " = " + Expression(equation) + "\n")});
}

TemplateText& TemplateText::ClassConstant(const std::string& symbol, const std::string& value) {
  return Add(classes.back().constants, {Joined(Base(symbol), {{"SPATIAL_VARIATION", "'PER_SPECIE'"},
                                                              {"UNIT", "'kg'"},
                                                              {"DEFAULT_VALUE", value},
                                                              {"MIN_VALUE", "0"},
                                                              {"MAX_VALUE", "10"}}),
                                        ""});
}

TemplateText& TemplateText::ClassForcing(const std::string& symbol) {
  return Add(classes.back().forcings, {Joined(Base(symbol), {{"SCOPE", "'PER_SPECIE'"},
                                                             {"SPATIAL_VARIATION", "'PER_SPECIE'"},
                                                             {"UNIT", "'m'"},
                                                             {"DEFAULT_VALUE", "1"},
                                                             {"MIN_VALUE", "0"},
                                                             {"MAX_VALUE", "10"}}),
                                       ""});
}

TemplateText& TemplateText::ClassSearch(const std::string& symbol, const std::string& variable) {
  return Add(classes.back().searches, {Joined(Base(symbol), {{"FUNCTION_ID", "100"},
                                                             {"VARIABLE_ID", variable},
                                                             {"SPECIE_ID", std::to_string(classes.size())},
                                                             {"RADIUS", "5"},
                                                             {"DIMENSION", "2"},
                                                             {"SPATIAL_VARIATION", "'PER_INDIVIDUAL'"},
                                                             {"PURPOSE", "'MAGNITUDE'"},
                                                             {"FRAMEWORK", "'EULER'"},
                                                             {"PROPERTY", "'NONE'"},
                                                             {"MATH", "'MIN'"},
                                                             {"LOOKFOR", "-1"}}),
                                       ""});
}

TemplateText& TemplateText::ClassExpression(const std::string& symbol, const std::string& expression) {
  return Add(classes.back().expressions, {Joined(Base(symbol), {{"EXPRESSION_TYPE", "'AUXILIARY_VARIABLE'"},
                                                                {"SPECIE", std::to_string(classes.size())},
                                                                {"OUTPUT", "'YES'"},
                                                                {"SPATIAL_VARIATION", "'PER_INDIVIDUAL'"},
                                                                {"UNIT", "'-'"},
                                                                {"EXPRESSION", Expression(expression)}}),
                                          ""});
}

TemplateText& TemplateText::ClassMovement(const std::string& speed, const std::string& direction) {
  return Add(classes.back().movements, {{{"EXPRESSION_HORIZONTAL_SPEED", Expression(speed)},
                                         {"EXPRESSION_HORIZONTAL_DIRECTION", Expression(direction)}},
                                        ""});
}

TemplateText& TemplateText::ClassDescent(const std::string& speed) {
  return Add(classes.back().descent, {{{"EXPRESSION_VERTICAL_SPEED", Expression(speed)}}, ""});
}

TemplateText& TemplateText::With(const std::string& keyword, const std::string& value) {
  for (auto& [name, present] : last->back().keywords) {
    if (name != keyword) continue;
    present = value;
    return *this;
  }
  last->back().keywords.emplace_back(keyword, value);
  return *this;
}

TemplateText& TemplateText::Without(const std::string& keyword) {
  std::erase_if(last->back().keywords, [&keyword](const auto& entry) { return entry.first == keyword; });
  return *this;
}

TemplateText& TemplateText::Misc(const std::string& content) {
  hasSettings = true;
  furtherSettings = content;
  return Add(settings, {Joined(kHead, {{"TESSAL_VERSION", "2017.0014"},
                                       {"PARSER_VERSION", "2017.001"},
                                       {"RANDSEED", "0"},
                                       {"DEBUG_LEVEL", "0"},
                                       {"DEBUG_LOG", "''"},
                                       {"RANDOM_PARTICLE_DIR", "'NO'"},
                                       {"BUILD_SPATIAL_TREE", "'NO'"},
                                       {"CHECKSUM", "'0'"}}),
                        ""});
}

TemplateText& TemplateText::Behind(const std::string& text) {
  behind += text;
  return *this;
}

TemplateText& TemplateText::Before(const std::string& text) {
  before += text;
  return *this;
}

TemplateText& TemplateText::Head(const std::string& list) {
  return Add(heads[list], {kHead, ""});
}

TemplateText& TemplateText::Function(const std::string& publicName) {
  return Add(functions, {Joined(Base("User " + publicName), {{"PUBLICNAME", Quoted(publicName)},
                                                             {"PARAMETERS", "1"},
                                                             {"USED_AS", "'AS_MATH_FUNC'"},
                                                             {"DLL", "'plugin.dll'"},
                                                             {"ENTRYPOINT", "'entry'"}}),
                         ""});
}

TemplateText& TemplateText::Group(const std::string& name) {
  groups.push_back({name, {}});
  return *this;
}

TemplateText& TemplateText::Level(const std::string& name, const std::string& items) {
  groups.back().second.push_back({name, items});
  return *this;
}

std::string TemplateText::Members(const std::string& prefix, const Elements& elements) {
  std::string content;
  int number = 0;
  for (const Element& element : elements) {
    content += Section(prefix + std::to_string(++number), Lines(element.keywords));
  }
  return content;
}

std::string TemplateText::List(const std::string& name, const std::string& prefix,
                               const Elements& elements) const {
  const auto head = heads.find(name);
  return Section(
      name, Lines(head == heads.end() ? kHead : head->second.back().keywords) + Members(prefix, elements));
}

std::string TemplateText::ClassText(const ParticleClass& specie, const std::string& number) {
  const auto list = [](const std::string& name, const std::string& prefix, const Elements& members) {
    return members.empty() ? "" : Section(name, Lines(kHead) + Members(prefix, members));
  };
  std::string equations;
  for (const Element& state : specie.states) equations += state.equation;
  return Section("SPECIE_" + number,
                 Lines(specie.itself.back().keywords) + list("STATE_VARIABLES", "S", specie.states) +
                     list("CONSTANTS", "C", specie.constants) + list("FORCINGS", "F", specie.forcings) +
                     list("SPATIAL_FUNCTIONS", "SPATIAL_FUNCTION_", specie.searches) +
                     list("ARITHMETICAL_EXPRESSIONS", "A", specie.expressions) +
                     Section("LAGRANGE_STATE_VARIABLE_EQUATIONS", equations) +
                     Section("HORIZONTAL_VECTORS_SECTION", Members("H", specie.movements)) +
                     (specie.descent.empty()
                          ? ""
                          : Section("VERTICAL_SPEED_EQUATION", Lines(specie.descent.back().keywords))));
}

std::string TemplateText::SettingsText() const {
  if (!hasSettings) return "";
  std::string content = Lines(settings.back().keywords) + furtherSettings;
  if (!functions.empty()) content += List("EXTERNAL_FUNCTIONS", "EXTERNAL_FUNCTION_", functions);
  std::string groupsText;
  for (const auto& [name, levels] : groups) {
    std::string levelsText;
    for (const auto& [level, items] : levels) {
      levelsText +=
          Section("L", Lines({{"LEVEL", Quoted(level)}, {"DESCRIPTION", Quoted(level + " text")}}) +
                           (items.empty() ? "ITEMCOUNT = 0\n" : "ITEMCOUNT = 1\nITEMS = " + items + "\n"));
    }
    groupsText += Section("G", Lines({{"GROUP", Quoted(name)},
                                      {"DESCRIPTION", Quoted(name + " text")},
                                      {"LEVELS", std::to_string(levels.size())}}) +
                                   levelsText);
  }
  if (!groups.empty()) {
    content += Section("VISIBILITY_GROUPS",
                       Lines(Joined(kHead, {{"GROUPS", std::to_string(groups.size())}})) + groupsText);
  }
  return Section("MISC", content);
}

std::string TemplateText::Text() const {
  std::string equations;
  for (const Element& element : stateVariables) equations += element.equation;
  std::string species;
  for (std::size_t place = 0; place < classes.size(); ++place) {
    species += ClassText(classes[place], std::to_string(place + 1));
  }
  const auto head = heads.find("");
  const std::string content =
      Lines(head == heads.end() ? kHead : head->second.back().keywords) + SettingsText() +
      List("STATE_VARIABLES", "STATE_VARIABLE_", stateVariables) + List("CONSTANTS", "CONSTANT_", constants) +
      List("FORCINGS", "FORCING_", forcings) +
      List("AUXILIARY_VARIABLES", "AUXILIARY_VARIABLE_", auxiliaries) +
      List("PROCESSES", "PROCESS_", processes) + List("DERIVED_OUTPUTS", "DERIVED_OUTPUT_", derivedOutputs) +
      Section("STATE_VARIABLE_EQUATIONS", equations) +
      (species.empty() ? std::string() : Section("LAGRANGE", species));
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

/// A line's kind, and what builds it from the word after the kind and the rest.
using LineBuilder = std::function<void(TemplateText&, std::string rest)>;

template <class Build>
LineBuilder Named(Build build) {
  return [build](TemplateText& text, std::string rest) {
    const std::string name = TakeWord(rest);
    build(text, name, rest);
  };
}

const std::map<std::string, LineBuilder>& LineBuilders() {
  using Text = TemplateText;
  using Word = const std::string&;
  static const std::map<std::string, LineBuilder> kBuilders = {
      {"state", Named([](Text& text, Word name, Word rest) { text.StateVariable(name, rest); })},
      {"constant",
       Named([](Text& text, Word name, Word rest) { text.Constant(name, rest.empty() ? "1" : rest); })},
      {"forcing", Named([](Text& text, Word name, Word) { text.Forcing(name); })},
      {"auxiliary", Named([](Text& text, Word name, Word rest) { text.Auxiliary(name, rest); })},
      {"process", Named([](Text& text, Word name, Word rest) { text.Process(name, rest); })},
      {"output", [](Text& text, Word rest) { text.DerivedOutput(rest); }},
      {"class", [](Text& text, Word rest) { text.Class(rest); }},
      {"class.state", Named([](Text& text, Word name, Word rest) { text.ClassState(name, rest); })},
      {"class.constant",
       Named([](Text& text, Word name, Word rest) { text.ClassConstant(name, rest.empty() ? "1" : rest); })},
      {"class.forcing", Named([](Text& text, Word name, Word) { text.ClassForcing(name); })},
      {"class.search", Named([](Text& text, Word name, Word rest) { text.ClassSearch(name, rest); })},
      {"class.expression", Named([](Text& text, Word name, Word rest) { text.ClassExpression(name, rest); })},
      {"class.movement", Named([](Text& text, Word speed, Word rest) { text.ClassMovement(speed, rest); })},
      {"class.descent", [](Text& text, Word rest) { text.ClassDescent(rest); }},
      {"settings",
       [](Text& text, std::string rest) {
         std::string content;
         while (!rest.empty()) content += TakeWord(rest) + "\n";
         text.Misc(content);
       }},
      {"function", [](Text& text, Word rest) { text.Function(rest); }},
      {"group", [](Text& text, Word rest) { text.Group(rest); }},
      {"level", Named([](Text& text, Word name, Word rest) { text.Level(name, rest); })},
      {"head", [](Text& text, Word rest) { text.Head(rest); }},
      {"before", [](Text& text, Word rest) { text.Before(rest + "\n"); }},
      {"behind", [](Text& text, Word rest) { text.Behind(rest + "\n"); }},
  };
  return kBuilders;
}

}  // namespace

std::string TemplateFromNotation(const std::string& lines) {
  TemplateText text;
  std::istringstream stream(lines);
  for (std::string line; std::getline(stream, line);) {
    const std::size_t bar = line.find(" | ");
    std::string rest = line.substr(0, bar);
    const std::string kind = TakeWord(rest);
    const auto builder = LineBuilders().find(kind);
    if (builder == LineBuilders().end()) throw std::invalid_argument("no kind of line: " + line);
    builder->second(text, rest);
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
