#include "platform/host_settings.h"

#include <cstdlib>

namespace tessal {

namespace {

constexpr std::size_t kLongestAddress = 1024;

std::string FromEnvironment(const char* name) {
  const char* value = std::getenv(name);
  return value == nullptr ? std::string() : std::string(value);
}

}  // namespace

std::string InstallRoot() {
  return FromEnvironment("TESSAL_INSTALL_ROOT");
}

std::string ManualsAddress() {
  return FromEnvironment("TESSAL_MANUALS_URI").substr(0, kLongestAddress);
}

}  // namespace tessal
