#include "platform/build_info.h"

#include "git_revision.h"

namespace tessal {

std::string_view ProgramVersion() {
  return TESSAL_VERSION;
}

std::string BuildText(std::string_view program) {
  constexpr std::string_view kGitRevision = TESSAL_GIT_REVISION;
  constexpr std::string_view kBuildType = TESSAL_BUILD_TYPE;
  std::string text = std::string(program) + " " TESSAL_VERSION "\n";
  if (!kGitRevision.empty()) text += "built from: " + std::string(kGitRevision) + "\n";
  text += "built with: " TESSAL_COMPILER;
  if (!kBuildType.empty()) text += ", " + std::string(kBuildType);
  return text + "\ntemplate format: release " TESSAL_RELEASE_NUMBER ", revision " TESSAL_REVISION_NUMBER;
}

}  // namespace tessal
