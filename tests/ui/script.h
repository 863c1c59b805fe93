// An editor driven by the lines of a file of cases. A case's input is a model in short lines; each call is
// something that a user does or looks at. The answer to an action is all that it changed: what the user was
// asked and shown, then the lines of the editor's state that went (-) and came (+).
#pragma once

#include <map>
#include <memory>
#include <string>
#include <vector>

#include "support/case_file.h"
#include "ui/editor.h"

namespace tessal::test {

class Script final {
 public:
  explicit Script(const std::string& model);

  /// Does what a call says, or shows what it asks for.
  std::string Answer(const CaseCall& call);

 private:
  /// All that the window shows and the template holds, line by line.
  struct State {
    Uid node = Uid::None;
    std::vector<std::string> lines;
    std::vector<std::string> form;
  };

  State Look();
  void AppendTemplate(std::vector<std::string>& lines);

  std::unique_ptr<Editor> editor;
  std::map<Uid, std::string> names;  ///< the first symbol that each element was seen under
  State former;
};

}  // namespace tessal::test
