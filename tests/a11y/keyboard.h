// The keyboard of a display that nobody sits at. What a window manager does, the test does: it says which
// window has the keyboard.
#pragma once

#include <X11/keysym.h>

#include <initializer_list>
#include <memory>

struct _XDisplay;

namespace tessal::test {

class Keyboard final {
 public:
  /// Of the display that the environment names. Throws where it cannot be opened.
  Keyboard();

  /// Gives the keyboard to the window that lies on top of all others. False when there is none.
  bool FocusTopWindow() const;

  /// Presses and releases a key, with others held down.
  void Type(unsigned long key, std::initializer_list<unsigned long> held = {}) const;

 private:
  struct Close {
    void operator()(_XDisplay* display) const;
  };
  std::unique_ptr<_XDisplay, Close> display;
};

}  // namespace tessal::test
