// Scripts over one template: each call does one thing through the front of the template core, and answers in
// text. Elements are named by their symbols, never by their identities.
#pragma once

#include <functional>
#include <map>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "core/replace.h"
#include "core/template_core.h"
#include "support/case_file.h"
#include "support/temporary_folder.h"

namespace tessal::test {

class TemplateScript final {
 public:
  /// Writes the case's template beside the script: lines for TemplateFromNotation, `from examples/NAME`, or
  /// the text of a key file, which begins with an empty line. Without input the template is a new one.
  explicit TemplateScript(const Case& script);
  TemplateScript(const TemplateScript&) = delete;
  TemplateScript& operator=(const TemplateScript&) = delete;
  ~TemplateScript();

  std::string Answer(const CaseCall& call);

 private:
  using Words = std::vector<std::string>;
  using Operation = std::function<std::string(TemplateScript&, const Words&)>;
  static const std::map<std::string, Operation>& Questions();
  static const std::map<std::string, Operation>& Changes();

  /// The element of a name: a symbol, `setup`, `settings`, `list KIND`, `function N`, or `CLASS list KIND`.
  CEL_Element& Element(const std::string& name);
  CEL_Lagrange_Specie* ClassIn(const Words& words, std::size_t place);

  std::string Load(const std::string& path);
  std::string Account() const;
  std::string Save(const std::string& name);
  std::string File(const std::string& name) const;
  std::string EditFile(const std::string& part, const std::string& by);
  std::string State() const;
  std::string Table() const;
  std::string Order() const;
  std::string Undefined() const;
  /// What has changed from the file to the template.
  std::string Compare() const;
  std::string Fields(const std::string& name);
  std::string Set(const std::string& name, const std::string& field, const std::string& value);
  std::string MoveBeforeFirstUser(const std::string& name);
  std::string Create(const Words& words);
  std::string Lost(const std::string& oldSymbol, const std::string& newSymbol) const;
  std::string Offer(const Words& words);
  std::string Preview(const Words& words);
  /// Applies the preview without those of the named places, from 1.
  std::string Apply(const Words& unwanted);
  std::string Groups();
  std::string Items(const Words& words);
  std::string Locks(const std::string& name);
  std::string LevelItems(const Words& words);
  std::string Lookups(const std::string& name);
  std::string Shortened(std::string text) const;
  std::string SymbolOf(Uid uid) const;
  Uid UidOf(const std::string& name) { return Element(name).GetUid(); }
  std::uint32_t SequenceOf(const std::string& name) const;

  TemporaryFolder folder;
  TemplateCore core;
  std::vector<Replacement> preview;
};

}  // namespace tessal::test
