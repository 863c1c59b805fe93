#include "expr/carbonate/settings.h"

namespace tessal {

namespace {

struct SettingsOfTheProcess {
  CarbonateSettings settings;
  std::uint64_t revision = 1;
};

SettingsOfTheProcess& Current() {
  static SettingsOfTheProcess current;
  return current;
}

}  // namespace

const CarbonateSettings& Carbonate() {
  return Current().settings;
}

CarbonateSettings& ChangeCarbonate() {
  ++Current().revision;
  return Current().settings;
}

std::uint64_t CarbonateRevision() {
  return Current().revision;
}

}  // namespace tessal
