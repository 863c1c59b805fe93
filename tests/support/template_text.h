// Template files as text, built up element by element, for tests.
#pragma once

#include <deque>
#include <map>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace tessal::test {

/// Keywords of a section: name and value, the value as it stands in the file.
using Keywords = std::vector<std::pair<std::string, std::string>>;

/// Builds a file whose elements have every keyword; `With` (which adds what is not there) and `Without` change
/// those of the last one.
class TemplateText final {
 public:
  TemplateText& StateVariable(const std::string& symbol, const std::string& equation);
  TemplateText& Constant(const std::string& symbol, const std::string& value = "1");
  TemplateText& Forcing(const std::string& symbol);
  TemplateText& Auxiliary(const std::string& symbol, const std::string& expression);
  TemplateText& Process(const std::string& symbol, const std::string& expression);
  TemplateText& DerivedOutput(const std::string& expression);
  /// A particle class with one state variable of that equation and arithmetic expressions of its own.
  TemplateText& Specie(const std::string& name, const std::string& equation, const Keywords& expressions);
  /// A particle class without members. The next calls give it some.
  TemplateText& Class(const std::string& name);
  TemplateText& ClassState(const std::string& symbol, const std::string& equation);
  TemplateText& ClassConstant(const std::string& symbol, const std::string& value);
  TemplateText& ClassForcing(const std::string& symbol);
  TemplateText& ClassSearch(const std::string& symbol, const std::string& variable);
  TemplateText& ClassExpression(const std::string& symbol, const std::string& expression);
  TemplateText& ClassMovement(const std::string& speed, const std::string& direction);
  TemplateText& ClassDescent(const std::string& speed);
  TemplateText& With(const std::string& keyword, const std::string& value);
  TemplateText& Without(const std::string& keyword);
  TemplateText& Misc(const std::string& content = "");
  TemplateText& Behind(const std::string& text);
  TemplateText& Before(const std::string& text);
  /// The descriptive texts of the template itself ("") or of one of its lists ("CONSTANTS").
  TemplateText& Head(const std::string& list);
  /// A function of a plug-in, a visibility group and a level of it, for settings that hold them.
  TemplateText& Function(const std::string& publicName);
  TemplateText& Group(const std::string& name);
  TemplateText& Level(const std::string& name, const std::string& items);

  std::string Text() const;

 private:
  struct Element {
    Keywords keywords;
    std::string equation;
  };
  using Elements = std::vector<Element>;
  struct ParticleClass {
    Elements itself;
    Elements states;
    Elements constants;
    Elements forcings;
    Elements searches;
    Elements expressions;
    Elements movements;
    Elements descent;
  };
  struct LevelText {
    std::string name;
    std::string items;
  };

  TemplateText& Add(Elements& elements, Element element);
  static std::string Members(const std::string& prefix, const Elements& elements);
  std::string List(const std::string& name, const std::string& prefix, const Elements& elements) const;
  static std::string ClassText(const ParticleClass& specie, const std::string& number);
  std::string SettingsText() const;

  Elements stateVariables;
  Elements constants;
  Elements forcings;
  Elements auxiliaries;
  Elements processes;
  Elements derivedOutputs;
  std::deque<ParticleClass> classes;
  std::map<std::string, Elements> heads;
  Elements functions;
  std::vector<std::pair<std::string, std::vector<LevelText>>> groups;
  Elements* last = nullptr;
  bool hasSettings = false;
  Elements settings;
  std::string furtherSettings;
  std::string before;
  std::string behind;
};

/// Builds a template from lines such as
///
///     constant k 0.3 | UNIT='kg'; -MIN_VALUE
///     auxiliary a k*2
///     class Fish
///     class.expression Fish_e a + 1
///
/// Each line is a kind, a symbol where the kind has one, and what it holds; behind the bar are keywords that
/// are set (`NAME=VALUE`) or left out (`-NAME`). A line that begins with `behind ` or `before ` is text
/// around the template's own section.
std::string TemplateFromNotation(const std::string& lines);

/// A random template of all kinds that is good to load: the same for the same seed.
std::string RandomTemplate(unsigned seed, int elements);

}  // namespace tessal::test
