#include "support/template_text.h"

#include <random>

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
  const std::string number = std::to_string(++specieCount);
  const std::string symbol = name + "_Mass";
  const Keywords values = {{"UNIT", "'kg'"}, {"DEFAULT_VALUE", "1"}, {"MIN_VALUE", "0"}, {"MAX_VALUE", "10"}};
  std::string members =
      Section("STATE_VARIABLES",
              Lines(kHead) + Section("S", Lines(Joined(Joined(Base(symbol), {{"SPECIE", number}}), values))));
  std::string list = Lines(kHead);
  for (const auto& [expressionSymbol, expression] : expressions) {
    list += Section("A", Lines(Joined(Base(expressionSymbol), {{"EXPRESSION_TYPE", "'AUXILIARY_VARIABLE'"},
                                                               {"SPECIE", number},
                                                               {"OUTPUT", "'YES'"},
                                                               {"SPATIAL_VARIATION", "'PER_INDIVIDUAL'"},
                                                               {"UNIT", "'-'"},
                                                               {"EXPRESSION", Expression(expression)}})));
  }
  members += Section("ARITHMETICAL_EXPRESSIONS", list);
  members += Section("LAGRANGE_STATE_VARIABLE_EQUATIONS",
                     Section("E", symbol + " = " + Expression(equation) + "\n"));
  members += Section("HORIZONTAL_VECTORS_SECTION",
                     Section("H", "EXPRESSION_HORIZONTAL_SPEED = " + Expression("0") +
                                      "\nEXPRESSION_HORIZONTAL_DIRECTION = " + Expression("0") + "\n"));
  species +=
      Section("SPECIE_" + number,
              Lines(Joined(Joined({{"NAME", Quoted(name)}}, kHead), {{"SCOPE", "'WC'"},
                                                                     {"PROJECTION_TIME", "0"},
                                                                     {"FIELD_OF_VIEW", "180"},
                                                                     {"TRANSPORT", "'USER_SPECIFIED'"}})) +
                  members);
  return *this;
}

TemplateText& TemplateText::With(const std::string& keyword, const std::string& value) {
  for (auto& [name, present] : last->back().keywords) {
    if (name == keyword) present = value;
  }
  return *this;
}

TemplateText& TemplateText::Without(const std::string& keyword) {
  std::erase_if(last->back().keywords, [&keyword](const auto& entry) { return entry.first == keyword; });
  return *this;
}

TemplateText& TemplateText::Misc(const std::string& content) {
  misc = Section(
      "MISC", Lines(kHead) +
                  "TESSAL_VERSION = 2017.0014\nPARSER_VERSION = 2017.001\nRANDSEED = 0\nDEBUG_LEVEL = 0\n"
                  "DEBUG_LOG = ''\nRANDOM_PARTICLE_DIR = 'NO'\nBUILD_SPATIAL_TREE = 'NO'\nCHECKSUM = '0'\n" +
                  content);
  return *this;
}

TemplateText& TemplateText::Behind(const std::string& text) {
  behind += text;
  return *this;
}

std::string TemplateText::List(const std::string& name, const std::string& prefix, const Elements& elements) {
  std::string content = Lines(kHead);
  int number = 0;
  for (const Element& element : elements) {
    content += Section(prefix + std::to_string(++number), Lines(element.keywords));
  }
  return Section(name, content);
}

std::string TemplateText::Text() const {
  std::string equations;
  for (const Element& element : stateVariables) equations += element.equation;
  const std::string content =
      Lines(kHead) + misc + List("STATE_VARIABLES", "STATE_VARIABLE_", stateVariables) +
      List("CONSTANTS", "CONSTANT_", constants) + List("FORCINGS", "FORCING_", forcings) +
      List("AUXILIARY_VARIABLES", "AUXILIARY_VARIABLE_", auxiliaries) +
      List("PROCESSES", "PROCESS_", processes) + List("DERIVED_OUTPUTS", "DERIVED_OUTPUT_", derivedOutputs) +
      Section("STATE_VARIABLE_EQUATIONS", equations) +
      (species.empty() ? std::string() : Section("LAGRANGE", species));
  return "\n" + Section("TESSAL_SETUP", content) + behind;
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
