#include "support/template_text.h"

#include <algorithm>
#include <map>
#include <random>
#include <sstream>
#include <stdexcept>

#include "support/temporary_folder.h"

namespace tessal::test {

namespace {

/// A kind of line, a row of template_kinds.txt.
struct KindRow {
  std::string section;
  std::string prefix;
  std::string keywords;
};

std::string Replaced(std::string text, std::string_view part, const std::string& by) {
  for (std::size_t place = 0; (place = text.find(part, place)) != std::string::npos; place += by.size())
    text.replace(place, part.size(), by);
  return text;
}

std::map<std::string, KindRow> ReadKinds() {
  std::map<std::string, KindRow> kinds;
  std::istringstream rows(ReadFile(TESSAL_SOURCE_DIR "/tests/support/template_kinds.txt"));
  for (std::string word; std::getline(rows, word, '|');) {
    KindRow row;
    if (word.starts_with('#')) word.erase(0, word.rfind('\n') + 1);
    std::getline(std::getline(rows, row.section, '|'), row.prefix, '|');
    std::getline(rows, row.keywords);
    for (const auto& [set, its] : kinds) {
      if (set.starts_with('@')) row.keywords = Replaced(row.keywords, set, its.keywords);
    }
    kinds.emplace(word, row);
  }
  return kinds;
}

const KindRow& RowOf(const std::string& word) {
  static const std::map<std::string, KindRow> kKinds = ReadKinds();
  const auto row = kKinds.find(word);
  if (row == kKinds.end()) throw std::invalid_argument("no kind of line: " + word);
  return row->second;
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
  std::istringstream rows(RowOf(kind).keywords);
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
    content += Section(RowOf(std::string(kind)).prefix + std::to_string(place + 1),
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
  const std::string section(RowOf(std::string(kind)).section);
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
  return "\n" + before + Section("TESSAL_SETUP", content) + after;
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
  } else if (kind == "after") {
    text.After(rest + "\n");
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
  text.After("[EXTRA] // kept\n// remark\nA = 1, 0.1, 'x', |y|\nEndSect // EXTRA\n");
  return text.Text();
}

}  // namespace tessal::test
