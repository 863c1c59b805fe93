#include "support/catalogue_call.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cstdio>
#include <sstream>
#include <vector>

#include "expr/carbonate/options.h"
#include "expr/carbonate/settings_log.h"
#include "expr/function_catalogue.h"
#include "expr/numeric/data_slots.h"
#include "expr/numeric/random.h"

namespace tessal::test {

double Call(const std::string& calls) {
  double value = std::nan("");
  std::istringstream pieces(calls);
  for (std::string call; std::getline(pieces >> std::ws, call, ';');) {
    const std::size_t open = call.find('(');
    const CatalogueFunction* function = FindFunction(call.substr(0, open));
    if (open == std::string::npos || function == nullptr || function->evaluator == nullptr) {
      ADD_FAILURE() << "no call of a function with an evaluator: " << call;
      return std::nan("");
    }
    std::vector<double> values;
    std::istringstream list(call.substr(open + 1, call.find(')') - open - 1));
    for (std::string word; std::getline(list, word, ',');)
      values.push_back(std::strtod(word.c_str(), nullptr));
    value = function->evaluator(values);
  }
  return value;
}

std::string FreshCall(const std::string& calls) {
  ResetNumbers();
  const double value = Call(calls);
  if (std::isnan(value)) return "nan\n";
  char text[32];
  std::snprintf(text, sizeof text, "%.12g\n", value);
  return text;
}

void ResetNumbers() {
  ClearDataSlots();
  ResetRandomNumbers();
  SetCarbonateDefaults();
  CarbonateLog().Close();
  ForgetCarbonateProblems();
}

}  // namespace tessal::test
