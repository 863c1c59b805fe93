// A template of an aquatic process model: load it, look at it, change it, check it and save it.
//
//     tessal::Template model;
//     if (const tessal::Outcome loaded = model.Load("river.tessal"); !loaded) return Complain(loaded.reason);
//     model.Rename("k1_20", "kd");
//     model.Save();
//
// One thread: the library keeps its catalogues, its scanner and its list of messages once in the process. Any
// number of templates may be open, but all calls of a process come from one thread at a time. It changes
// nothing else of the process: no locale, no signals, no output, no current folder.
//
// Texts are bytes. Those of a template come and go as the file has them, which is UTF-8 or Windows-1252. What
// fails for want of memory raises std::bad_alloc; no other exception leaves the library. A template that was
// moved from can only be destroyed or assigned to.
#pragma once

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "tessal/element.h"
#include "tessal/export.h"
#include "tessal/message.h"

namespace tessal {
inline namespace v1 {

class TemplateData;

/// What a rename does with the expressions that use the symbol.
enum class Uses { Rewritten, LeftAlone };

/// On which side of another element.
enum class Side { Before, After };

class TESSAL_API Template final {
 public:
  /// An empty template.
  Template();
  Template(Template&& other) noexcept;
  Template& operator=(Template&& other) noexcept;
  ~Template();

  // Files.

  /// Loads a file in the place of what the template holds. Refused when it can not be read as a template;
  /// this one is empty then. One with faults loads, and `LoadMessages` lists them.
  Outcome Load(const std::string& path);
  /// The same with the text of a file. It has no name: `Save` is refused until `SaveAs` gives it one.
  Outcome LoadText(std::string text);
  /// Saves in place, in one step: the file is replaced when every byte of the new one is on disk, or stays as
  /// it was. Refused while `Losses` is not empty.
  Outcome Save();
  /// The same although something of the file is lost.
  Outcome SaveInSpiteOfLosses();
  /// Saves under another name, which the template has from then on, with fresh version stamps. The file does
  /// not hold what is in `Losses`.
  Outcome SaveAs(const std::string& path);
  /// The text that `Save` would write, but for the revision. Nothing when the format can not hold the
  /// template.
  std::optional<std::string> Text();
  /// Whether something has changed since the load or the last save.
  bool IsModified() const;

  // What is in it.

  /// All elements, in the order of the symbol table: a particle class, with its movements, after its other
  /// members.
  std::vector<Element> Elements() const;
  /// The first element with a symbol.
  std::optional<Element> Find(std::string_view symbol) const;

  // What is wrong with it. `tessal check` lists the same.

  /// What the load found, with the checks of the template as it was then.
  const std::vector<TemplateMessage>& LoadMessages() const;
  /// What of the file a save would lose: parts that the load did not read, or read as something else.
  std::vector<TemplateMessage> Losses() const;
  /// Checks the template as it is now.
  std::vector<TemplateMessage> Check();
  std::vector<UndefinedName> UndefinedNames() const;

  // Changing it. Each call that does something is one step.

  /// Makes an element, at the place that the order of declaration needs. A member of a particle class is made
  /// with the symbol of the class. Nothing when the symbol is taken or is none, or there is no such class.
  std::optional<Element> Create(Kind kind, std::string_view symbol, std::string_view classSymbol = {});
  /// Refused while somebody uses the element.
  Outcome Remove(const Element& element);
  /// Moves an element beside a sibling. Refused when a use would come before its definition.
  Outcome Move(const Element& element, Side side, const Element& sibling);
  /// Gives a symbol another name. Uses are rewritten where the whole of an identifier is the symbol. Refused
  /// for a name that is taken or is none, and for what has no name in the file (derived outputs, movements).
  Outcome Rename(std::string_view oldSymbol, std::string_view newSymbol, Uses uses = Uses::Rewritten);
  /// Takes the last step back, or does it again. False when there is none.
  bool Undo();
  bool Redo();

 private:
  friend TemplateData& DataOf(const Template& model);
  std::unique_ptr<TemplateData> data;
};

}  // namespace v1
}  // namespace tessal
