// The process matrix, the mass balance, and the algebra under both.
#include <gtest/gtest.h>

#include <sstream>

#include "analysis/mass_balance.h"
#include "analysis/process_matrix.h"
#include "core/template_core.h"
#include "docgen/matrix_text.h"
#include "support/case_file.h"
#include "support/template_text.h"

namespace tessal::test {
namespace {

std::string TextOf(const ProcessMatrix& matrix) {
  std::string text = MatrixAsText(matrix);
  for (const MatrixFault& fault : matrix.faults) {
    text += matrix.states[fault.column].symbol + ": " + fault.reason + '\n';
  }
  return text;
}

/// "EXPRESSION; BOUNDARY BOUNDARY" as a pool, and what is found about it.
std::string BalanceOf(const TemplateCore& core, const std::string& words) {
  Pool pool{
      .name = "pool", .expression = words.substr(0, words.find(';')), .boundary = {}, .description = {}};
  if (words.find(';') != std::string::npos) {
    std::istringstream names(words.substr(words.find(';') + 1));
    for (std::string name; names >> name;) pool.boundary.push_back(name);
  }
  const PoolBalance balance = CheckMassBalance(core, {&pool, 1}).front();
  if (balance.verdict == PoolVerdict::Closed) return "closed";
  if (balance.verdict == PoolVerdict::Unknown) return "could not judge: " + balance.reason;
  std::string text = "open";
  for (const PoolLeak& leak : balance.leaks) text += "\n  " + leak.process + ": " + leak.net;
  return text;
}

std::string AnswerOf(const TemplateCore& core, const std::string& words) {
  const std::string verb = words.substr(0, words.find(' '));
  const std::string rest = verb.size() < words.size() ? words.substr(verb.size() + 1) : "";
  if (verb == "matrix") return TextOf(BuildProcessMatrix(core, MatrixProcesses::AsWritten));
  if (verb == "elementary") return TextOf(BuildProcessMatrix(core, MatrixProcesses::Elementary));
  if (verb == "class") {
    return TextOf(BuildProcessMatrix(core, core.GetSpecie(0), MatrixProcesses::AsWritten));
  }
  return verb == "balance" ? BalanceOf(core, rest) : "no such verb";
}

TEST(Balance, IsWhatItsCasesSay) {
  RunCases("analysis/cases/balance.txt", [](const Case& script) -> Answer {
    const auto core = std::make_shared<TemplateCore>();
    EXPECT_TRUE(core->LoadText(TemplateFromNotation(script.input))) << script.title;
    return [core](const CaseCall& call) { return AnswerOf(*core, call.words); };
  });
}

/// Long chains and deep nests are refused or judged, in any case at once.
TEST(Balance, HoldsOutAgainstLargeExpressions) {
  std::string chain = "p";
  for (int link = 0; link < 20000; ++link) chain += link % 2 == 0 ? "+p" : "-p";
  std::string product = "k";
  for (int link = 0; link < 20000; ++link) product += "*k/k";
  std::string nest = "p";
  for (int level = 0; level < 1500; ++level) nest = "k*(1+" + nest + ")";
  std::string brackets = "(k+m)";
  for (int factor = 0; factor < 40; ++factor) brackets += "*(k+m+" + std::to_string(factor) + "*p)";
  TemplateCore core;
  ASSERT_TRUE(core.LoadText(TemplateFromNotation("constant k 2\nconstant m 3\nprocess p k\nstate A " + chain +
                                                 "\nstate B p*" + product + "\nstate C " + nest +
                                                 "\nstate D " + brackets)));
  const ProcessMatrix matrix = BuildProcessMatrix(core, MatrixProcesses::AsWritten);
  ASSERT_EQ(matrix.rows.size(), 1U) << TextOf(matrix);
  ASSERT_EQ(matrix.rows.front().cells.size(), 2U) << TextOf(matrix).substr(0, 500);
  EXPECT_EQ(matrix.rows.front().cells[0].factor, "1");
  EXPECT_EQ(matrix.rows.front().cells[1].factor, "k");
  ASSERT_EQ(matrix.faults.size(), 2U);
  EXPECT_EQ(matrix.faults[0].reason, "an expression nests too deeply");
  EXPECT_EQ(BalanceOf(core, "A - B/k"), "closed");
}

}  // namespace
}  // namespace tessal::test
