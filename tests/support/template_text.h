// Template files as text, built up element by element, for tests.
#pragma once

#include <deque>
#include <map>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace tessal::test {

/// Keywords of a section: name and value, the value as it is in the file.
using Keywords = std::vector<std::pair<std::string, std::string>>;

/// Builds a file whose elements have every keyword; `With` (which adds what is not there) and `Without`
/// change those of the last one.
class TemplateText final {
 public:
  TemplateText& StateVariable(const std::string& symbol, const std::string& equation) {
    return Add("state", symbol, equation);
  }
  TemplateText& Constant(const std::string& symbol, const std::string& value = "1") {
    return Add("constant", symbol, value);
  }
  TemplateText& Forcing(const std::string& symbol) { return Add("forcing", symbol); }
  TemplateText& Auxiliary(const std::string& symbol, const std::string& expression) {
    return Add("auxiliary", symbol, expression);
  }
  TemplateText& Process(const std::string& symbol, const std::string& expression) {
    return Add("process", symbol, expression);
  }
  TemplateText& DerivedOutput(const std::string& expression) { return Add("output", "", expression); }
  /// A particle class with one state variable of that equation and arithmetic expressions of its own.
  TemplateText& Specie(const std::string& name, const std::string& equation, const Keywords& expressions);
  TemplateText& With(const std::string& keyword, const std::string& value);
  TemplateText& Without(const std::string& keyword);
  TemplateText& Misc(const std::string& content = "") {
    furtherSettings = content;
    return Add("settings", "");
  }
  TemplateText& After(const std::string& text) { return after += text, *this; }
  TemplateText& Before(const std::string& text) { return before += text, *this; }
  /// A visibility group and a level of it, for settings that hold them.
  TemplateText& Group(const std::string& name);
  TemplateText& Level(const std::string& name, const std::string& items);

  /// An element of any kind, by the words of the notation below. Members go to the last class.
  TemplateText& Add(const std::string& kind, const std::string& symbol, const std::string& value = "");

  std::string Text() const;

 private:
  struct Element {
    Keywords keywords;
    std::string equation;
  };
  using Elements = std::deque<Element>;
  using Lists = std::map<std::string, Elements, std::less<>>;

  static std::string Members(const Lists& from, std::string_view kind);
  static std::string Equations(const Lists& from, std::string_view kind);
  std::string HeadOf(std::string_view list) const;
  std::string ListOf(const Lists& from, std::string_view kind) const;
  std::string ClassText(const Lists& specie, const std::string& number) const;
  std::string SettingsText() const;

  Lists lists;  ///< by kind; texts of heads by section
  std::deque<Lists> classes;
  std::vector<std::pair<std::string, std::string>> groups;
  Element* last = nullptr;
  std::string furtherSettings;
  std::string before;
  std::string after;
};

/// Builds a template from lines such as
///
///     constant k 0.3 | UNIT='kg'; -MIN_VALUE
///     auxiliary a k*2
///     class Fish
///     class.expression Fish_e a + 1
///
/// Each line is a kind, a symbol where the kind has one, and what it holds; after the bar are keywords that
/// are set (`NAME=VALUE`) or left out (`-NAME`). A line that begins with `after ` or `before ` is text
/// around the template's own section.
std::string TemplateFromNotation(const std::string& lines);

/// A random template of all kinds that is good to load: the same for the same seed.
std::string RandomTemplate(unsigned seed, int elements);

}  // namespace tessal::test
