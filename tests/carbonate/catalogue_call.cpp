#include "carbonate/catalogue_call.h"

#include <algorithm>
#include <charconv>
#include <limits>
#include <vector>

#include <gtest/gtest.h>

#include "expr/carbonate/options.h"
#include "expr/carbonate/settings_log.h"
#include "expr/evaluators.h"

namespace tessal {

namespace {

std::string_view Trimmed(std::string_view text) {
  const std::size_t first = text.find_first_not_of(' ');
  if (first == std::string_view::npos) return {};
  return text.substr(first, text.find_last_not_of(' ') - first + 1);
}

/// Cuts the text up to the separator off its front.
std::string_view CutFront(std::string_view& text, char separator) {
  const std::size_t end = std::min(text.find(separator), text.size());
  const std::string_view front = Trimmed(text.substr(0, end));
  text.remove_prefix(std::min(end + 1, text.size()));
  return front;
}

double Number(std::string_view text) {
  double number = std::numeric_limits<double>::quiet_NaN();
  const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
  EXPECT_TRUE(error == std::errc{} && end == text.data() + text.size()) << "not a number: " << text;
  return number;
}

}  // namespace

double Call(std::string_view call) {
  std::string_view rest = call;
  const std::string_view name = CutFront(rest, '(');
  std::string_view list = CutFront(rest, ')');
  std::vector<double> values;
  while (!list.empty()) values.push_back(Number(CutFront(list, ',')));
  for (const EvaluatorRow& row : Evaluators()) {
    if (row.name == name) return row.evaluator(values);
  }
  ADD_FAILURE() << "no evaluator for " << call;
  return std::numeric_limits<double>::quiet_NaN();
}

void CallEach(std::string_view calls) {
  while (!calls.empty()) Call(CutFront(calls, ';'));
}

void ResetCarbonateForTest() {
  SetCarbonateDefaults();
  CarbonateLog().Close();
  ForgetCarbonateProblems();
}

}  // namespace tessal
