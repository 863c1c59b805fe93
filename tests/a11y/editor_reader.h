// The editor on a private desktop, found its way through with keys, and read as a screen reader reads it.
#pragma once

#include <string>
#include <vector>

#include "a11y/accessible.h"
#include "a11y/keyboard.h"
#include "a11y/private_desktop.h"
#include "a11y/program.h"

namespace tessal::test {

class EditorReader final {
 public:
  /// Opens copies of the examples of these names. Throws where the editor does not come up.
  explicit EditorReader(const std::vector<std::string>& examples);

  /// The window that lies on top: the frame, or a dialog over it.
  Accessible TopWindow() const;
  /// All that it shows.
  std::vector<Control> Read() const { return ReadControls(TopWindow()); }
  /// The first control with the role and the name; empty where there is none in time.
  Accessible Wait(AtspiRole role, const std::string& name) const;

  /// The keyboard goes to the window on top when its title begins like this.
  bool WaitForTitle(const std::string& title) const;

  // What a user does. Each is over when it shows, and false when it never does.
  bool ShowDocument(const std::string& example) const;
  bool ShowTab(const std::string& name) const;
  bool GoToSymbol(const std::string& symbol) const;
  /// Selects a node of the tree by the names from below the root; the branches on the way are opened.
  bool GoToNode(const std::vector<std::string>& path) const;
  /// Presses keys that open or close something, until the window on top has this title.
  bool OpenWindow(const std::string& title, unsigned long key,
                  std::initializer_list<unsigned long> held = {}) const;
  bool CloseWindow() const;
  bool Press(AtspiRole role, const std::string& name) const;

  const Keyboard& Keys() const { return keyboard; }

 private:
  Accessible Tree() const;

  PrivateDesktop desktop;
  Keyboard keyboard;
  Program editor;
  Accessible application;
};

/// Whether Tab is to lead to a control: neither one of the rows, cells and tabs among which arrow keys lead,
/// nor what only passes the keyboard on to a part of it.
bool IsTabStop(const Control& control);

}  // namespace tessal::test
