// The controls of a running program as a screen reader meets them: over the bus, by role, name, state and
// relation, and never by what the program is made of.
#pragma once

#include <atspi/atspi.h>

#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace tessal::test {

/// A remote object. Every question goes to the program again; where it gives no answer, because the object is
/// gone, the answer is empty.
class Accessible final {
 public:
  Accessible() = default;
  /// Takes the reference over.
  explicit Accessible(AtspiAccessible* taken) {
    if (taken != nullptr) object.reset(taken, &g_object_unref);
  }

  explicit operator bool() const { return object != nullptr; }
  bool operator==(const Accessible& other) const { return object == other.object; }

  std::string Name() const;
  std::string Description() const;  ///< the tool tip, or what explains the control
  AtspiRole Role() const;
  bool Is(AtspiStateType state) const;
  std::uint64_t States() const;  ///< a bit for each state, the number of the state being its place
  int ProcessId() const;
  std::vector<std::string> Labels() const;  ///< the names of what labels it

  /// At most so many of its children.
  std::vector<Accessible> Children(int most) const;

  /// What it shows, where it is a field of text.
  std::string Text() const;
  bool SetText(const std::string& text) const;

  /// Runs the first of its actions.
  bool Press() const;
  int ColumnCount() const;  ///< -1 where it is no table

 private:
  std::shared_ptr<AtspiAccessible> object;
};

/// A control with what a reader says about it, read in one go.
struct Control {
  Accessible handle;
  AtspiRole role = ATSPI_ROLE_INVALID;
  std::string roleName;
  std::string name;
  std::size_t parent = 0;  ///< its place in the list; its own place at the top
  bool isShowing = false;
  bool isFocusable = false;
  bool isSensitive = false;
  bool passesFocusOn = false;  ///< to a part of it, as a box around tabs does

  /// "push button 'New'".
  std::string Words() const { return roleName + " '" + name + "'"; }
};

/// What a label says of its field.
std::string WithoutColon(std::string label);

/// An object and all below it that is seen, but for the menu bar of a window. From a menu bar, all of its
/// menus.
std::vector<Control> ReadControls(const Accessible& top);

/// The first that shows with that role and name, at the object or below it; rows of lists are left out.
Accessible FindControl(const Accessible& top, AtspiRole role, const std::string& name);

/// Asks until it is so, and lets the news of the bus in meanwhile. False when the time is over.
bool WaitUntil(const std::function<bool()>& isSo, int milliseconds = 5000);

}  // namespace tessal::test
