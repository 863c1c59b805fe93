// A desktop of its own for one program under test: a display, a session bus with the accessibility services,
// and a home that goes with it.
#pragma once

#include <memory>
#include <string>

#include "a11y/accessible.h"
#include "a11y/program.h"
#include "support/temporary_folder.h"

namespace tessal::test {

class PrivateDesktop final {
 public:
  /// What is not installed of all that a desktop needs; empty when nothing is missing.
  static std::string Missing();

  /// Starts display and bus, and points the environment of the test at them. Throws where they do not start.
  PrivateDesktop();
  PrivateDesktop(const PrivateDesktop&) = delete;
  PrivateDesktop& operator=(const PrivateDesktop&) = delete;
  ~PrivateDesktop();

  /// The program as the registry of accessible programs lists it; empty where it does not come up.
  Accessible Find(const Program& program) const;

  const TemporaryFolder& Home() const { return home; }

 private:
  TemporaryFolder home;
  std::unique_ptr<Program> display;
  std::unique_ptr<Program> bus;
};

}  // namespace tessal::test
