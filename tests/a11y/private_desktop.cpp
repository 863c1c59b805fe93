#include "a11y/private_desktop.h"

#include <chrono>
#include <cstdlib>
#include <stdexcept>
#include <vector>

namespace tessal::test {

namespace {

constexpr std::chrono::seconds kStart(20);

std::string Report(const Program& program, const char* name) {
  std::string line = program.FirstReport(kStart);
  if (line.empty()) throw std::runtime_error(std::string(name) + " does not start");
  return line;
}

void Set(const char* variable, const std::string& value) {
  setenv(variable, value.c_str(), 1);
}

}  // namespace

std::string PrivateDesktop::Missing() {
  for (const char* program :
       {"Xvfb", "dbus-daemon", "/usr/libexec/at-spi-bus-launcher", "/usr/libexec/at-spi2-registryd"}) {
    if (!CanRun(program)) return program;
  }
  return {};
}

PrivateDesktop::PrivateDesktop() {
  // Nothing of the user's own is read or written.
  for (const char* folder :
       {"HOME", "XDG_CONFIG_HOME", "XDG_DATA_HOME", "XDG_STATE_HOME", "XDG_CACHE_HOME", "XDG_RUNTIME_DIR"})
    Set(folder, home.Path().string());
  Set("GSETTINGS_BACKEND", "memory");
  Set("LC_ALL", "C.UTF-8");
  for (const char* variable : {"AT_SPI_BUS_ADDRESS", "WAYLAND_DISPLAY", "XAUTHORITY"}) unsetenv(variable);
  display = std::make_unique<Program>(std::vector<std::string>{"Xvfb", "-displayfd", "{report}", "-screen",
                                                               "0", "1280x1024x24", "-nolisten", "tcp"});
  Set("DISPLAY", ":" + Report(*display, "Xvfb"));
  bus = std::make_unique<Program>(std::vector<std::string>{"dbus-daemon", "--session", "--nofork",
                                                           "--nopidfile", "--print-address={report}"});
  Set("DBUS_SESSION_BUS_ADDRESS", Report(*bus, "dbus-daemon"));
  if (atspi_init() != 0) throw std::runtime_error("the accessibility bus does not start");
  // What a program said once is asked for again each time.
  AtspiAccessible* programs = atspi_get_desktop(0);
  const Accessible held(programs);
  atspi_accessible_set_cache_mask(programs, ATSPI_CACHE_NONE);
}

PrivateDesktop::~PrivateDesktop() {
  atspi_exit();
}

Accessible PrivateDesktop::Find(const Program& program) const {
  Accessible found;
  WaitUntil(
      [&program, &found] {
        constexpr int kPrograms = 10;
        const Accessible desktop(atspi_get_desktop(0));
        for (const Accessible& each : desktop.Children(kPrograms)) {
          if (each.ProcessId() == program.Id()) found = each;
        }
        return found || !program.IsRunning();
      },
      static_cast<int>(std::chrono::milliseconds(kStart).count()));
  return found;
}

}  // namespace tessal::test
