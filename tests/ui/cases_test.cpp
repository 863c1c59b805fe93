// What a user does with the editor, and what follows from it: files of cases.
#include <gtest/gtest.h>

#include "ui/script.h"

namespace tessal {
namespace {

class Cases : public testing::TestWithParam<const char*> {};

TEST_P(Cases, GiveWhatTheFileSays) {
  test::RunCases(std::string("ui/cases/") + GetParam() + ".txt", [](const test::Case& each) {
    const auto script = std::make_shared<test::Script>(each.input);
    return [script](const test::CaseCall& call) { return script->Answer(call); };
  });
}

INSTANTIATE_TEST_SUITE_P(Editor, Cases,
                         testing::Values("commits", "names", "choices", "expressions", "completion",
                                         "expression_help", "messages", "finding", "nodes", "undo", "visits",
                                         "groups", "lists", "root", "visibility", "particles", "exports",
                                         "analysis"),
                         [](const auto& file) { return file.param; });

}  // namespace
}  // namespace tessal
