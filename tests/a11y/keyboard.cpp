#include "a11y/keyboard.h"

#include <X11/Xlib.h>
#include <X11/extensions/XTest.h>

#include <stdexcept>

namespace tessal::test {

Keyboard::Keyboard() : display(XOpenDisplay(nullptr)) {
  if (display == nullptr) throw std::runtime_error("the display cannot be opened");
}

void Keyboard::Close::operator()(_XDisplay* display) const {
  XCloseDisplay(display);
}

bool Keyboard::FocusTopWindow() const {
  Window root = 0;
  Window parent = 0;
  Window* windows = nullptr;
  unsigned count = 0;
  if (XQueryTree(display.get(), DefaultRootWindow(display.get()), &root, &parent, &windows, &count) == 0)
    return false;
  Window top = 0;
  for (unsigned place = 0; place < count; ++place) {
    XWindowAttributes state{};
    if (XGetWindowAttributes(display.get(), windows[place], &state) == 0) continue;
    // Menus and tips take no keyboard.
    if (state.map_state == IsViewable && state.override_redirect == 0) top = windows[place];
  }
  if (windows != nullptr) XFree(windows);
  if (top != 0) XSetInputFocus(display.get(), top, RevertToPointerRoot, CurrentTime);
  XSync(display.get(), False);
  return top != 0;
}

void Keyboard::Type(unsigned long key, std::initializer_list<unsigned long> held) const {
  const auto send = [this](unsigned long symbol, bool down) {
    XTestFakeKeyEvent(display.get(), XKeysymToKeycode(display.get(), symbol), down ? True : False,
                      CurrentTime);
  };
  for (const unsigned long each : held) send(each, true);
  send(key, true);
  send(key, false);
  for (const unsigned long each : held) send(each, false);
  XSync(display.get(), False);
}

}  // namespace tessal::test
