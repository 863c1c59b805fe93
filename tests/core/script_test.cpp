// The files of cases of the template core.
#include <gtest/gtest.h>

#include "core/template_script.h"
#include "support/case_file.h"

namespace tessal::test {
namespace {

class Scripts : public ::testing::TestWithParam<const char*> {};

TEST_P(Scripts, GiveWhatTheirFileSays) {
  RunCases("core/cases/" + std::string(GetParam()) + ".txt", [](const Case& script) -> Answer {
    const auto session = std::make_shared<TemplateScript>(script);
    return [session](const CaseCall& call) { return session->Answer(call); };
  });
}

INSTANTIATE_TEST_SUITE_P(Core, Scripts,
                         ::testing::Values("load", "save", "table", "rules", "validation", "editing",
                                           "classes", "rename", "creation", "visibility", "account",
                                           "comparison", "pools", "find", "completion", "examples"),
                         [](const auto& file) { return std::string(file.param); });

}  // namespace
}  // namespace tessal::test
