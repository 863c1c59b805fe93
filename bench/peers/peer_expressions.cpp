// The expressions of a generated model to trees, beside what other libraries make of the same expressions in
// their languages: nanoseconds of the processor for an expression, with the release of what was made.
#include <muParser.h>
#include <sbml/math/L3Parser.h>

#include <fparser.hh>
#include <iostream>
#include <memory>
#include <stdexcept>
#include <string>
#include <vector>

#include "expr/parser.h"
#include "generated_model.h"
#include "process_cost.h"
#include "ratio_table.h"
#include "samples.h"

namespace {

using namespace tessal;
using namespace tessal::bench;

constexpr int kElements = 1'000;
constexpr int kRounds = 101;

constexpr Dialect kMuParserDialect = {
    .patterns = {"$1*exp(-$2/($3+1)) + $4", "$1 > 0.5 ? $2*$3 : $4", "$1 - $2"},
    .nameStart = {},
    .nameEnd = {},
    .numberStart = {},
    .numberEnd = {}};
constexpr Dialect kFparserDialect = {
    .patterns = {"$1*exp(-$2/($3+1)) + $4", "if($1 > 0.5, $2*$3, $4)", "$1 - $2"},
    .nameStart = {},
    .nameEnd = {},
    .numberStart = {},
    .numberEnd = {}};
constexpr Dialect kSbmlDialect = {
    .patterns = {"$1*exp(-$2/($3+1)) + $4", "piecewise($2*$3, $1 > 0.5, $4)", "$1 - $2"},
    .nameStart = {},
    .nameEnd = {},
    .numberStart = {},
    .numberEnd = {}};

using Texts = std::vector<std::string>;

Texts In(const Dialect& dialect, const GeneratedModel& model) {
  Texts texts;
  for (const GeneratedExpression& expression : model.Expressions()) {
    texts.push_back(Write(expression, dialect));
  }
  return texts;
}

/// The variables of each expression, as a list that fparser takes.
Texts VariableLists(const GeneratedModel& model) {
  Texts lists;
  for (const GeneratedExpression& expression : model.Expressions()) {
    std::string& list = lists.emplace_back();
    for (const std::string& name : NamesIn(expression)) list += (list.empty() ? "" : ",") + name;
  }
  return lists;
}

void Require(bool isParsed, const char* parser, const std::string& text) {
  if (!isParsed) throw std::runtime_error(std::string(parser) + " does not parse " + text);
}

double OurSeconds(const Texts& texts) {
  const ProcessorClock clock;
  for (const std::string& text : texts) {
    const auto parsed = ParseExpression(text);
    Require(parsed->Tree() != nullptr, "ParseExpression", text);
  }
  return clock.Seconds();
}

/// A parse is forced by the question which variables there are.
double MuParserSeconds(const Texts& texts) try {
  mu::Parser parser;
  const ProcessorClock clock;
  for (const std::string& text : texts) {
    parser.SetExpr(text);
    Require(!parser.GetUsedVar().empty() || text.empty(), "muParser", text);
  }
  return clock.Seconds();
} catch (const mu::Parser::exception_type& failure) {
  throw std::runtime_error("muParser: " + failure.GetMsg());
}

double FparserSeconds(const Texts& texts, const Texts& variables) {
  FunctionParser parser;
  const ProcessorClock clock;
  for (std::size_t place = 0; place < texts.size(); ++place) {
    Require(parser.Parse(texts[place], variables[place]) < 0, "fparser", texts[place]);
  }
  return clock.Seconds();
}

double SbmlSeconds(const Texts& texts) {
  const ProcessorClock clock;
  for (const std::string& text : texts) {
    const std::unique_ptr<ASTNode> tree(SBML_parseL3Formula(text.c_str()));
    Require(tree != nullptr, "libSBML", text);
  }
  return clock.Seconds();
}

void Compare() {
  const GeneratedModel model(kElements);
  const Texts ours = In(kTemplateDialect, model);
  const Texts muParsers = In(kMuParserDialect, model);
  const Texts fparsers = In(kFparserDialect, model);
  const Texts variables = VariableLists(model);
  const Texts sbmls = In(kSbmlDialect, model);
  std::cout << ours.size() << " expressions, each parsed once in a round\n";
  const auto costs =
      InTurns<double>({[&] { return OurSeconds(ours); }, [&] { return FparserSeconds(fparsers, variables); },
                       [&] { return SbmlSeconds(sbmls); }, [&] { return MuParserSeconds(muParsers); }},
                      kRounds);
  constexpr const char* kPeers[] = {"fparser's byte code", "libSBML's L3 formula", "muParser"};
  const double scale = 1e9 / static_cast<double>(ours.size());
  const RatioTable table;
  for (std::size_t peer = 1; peer < costs.size(); ++peer) {
    table.PrintRow("expression to a tree", kPeers[peer - 1], "ns/expression", scale * Median(costs[0]),
                   scale * Median(costs[peer]));
  }
}

}  // namespace

int main() {
  return RunMain("peer_expressions", Compare);
}
