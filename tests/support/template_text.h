// Template files as text, built up element by element, for tests.
#pragma once

#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace tessal::test {

/// Keywords of a section: name and value, the value as it stands in the file.
using Keywords = std::vector<std::pair<std::string, std::string>>;

/// Builds a file whose elements have every keyword; `With` and `Without` change those of the last one.
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
  TemplateText& With(const std::string& keyword, const std::string& value);
  TemplateText& Without(const std::string& keyword);
  TemplateText& Misc(const std::string& content = "");
  TemplateText& Behind(const std::string& text);

  std::string Text() const;

 private:
  struct Element {
    Keywords keywords;
    std::string equation;
  };
  using Elements = std::vector<Element>;

  TemplateText& Add(Elements& elements, Element element);
  static std::string List(const std::string& name, const std::string& prefix, const Elements& elements);

  Elements stateVariables;
  Elements constants;
  Elements forcings;
  Elements auxiliaries;
  Elements processes;
  Elements derivedOutputs;
  Elements* last = nullptr;
  std::string misc;
  std::string species;
  int specieCount = 0;
  std::string behind;
};

/// A random template of all kinds that is good to load: the same for the same seed.
std::string RandomTemplate(unsigned seed, int elements);

}  // namespace tessal::test
