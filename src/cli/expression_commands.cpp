// Commands on single expressions.
#include <algorithm>
#include <functional>
#include <optional>
#include <string_view>

#include "cli/commands.h"
#include "cli/tree_json.h"
#include "core/error_registry.h"
#include "docgen/latex.h"
#include "docgen/mathml.h"
#include "expr/expression_node.h"
#include "expr/identifiers.h"
#include "expr/interaction_rewriter.h"
#include "expr/parser.h"
#include "expr/scanner.h"
#include "expr/semantic_checks.h"

namespace tessal::cli {

namespace {

/// What one expression gives: the result's text, and how it ended.
struct Answer {
  std::string text;
  ExitCode exitCode = kFine;
};

using Question = std::function<Answer(const std::string& expression)>;

/// Several lines of one result are one line for batch use.
std::string OnOneLine(std::string_view text, char separator) {
  std::string line(WithoutLineFeed(text));
  std::replace(line.begin(), line.end(), '\n', separator);
  return line;
}

/// Asks about each line of standard input; lines end at line feeds alone. The answers to the lines that are
/// there are written before more is waited for.
ExitCode AskEachLine(const Question& question) {
  ExitCode worst = kFine;
  InputLines lines;
  while (const std::optional<std::string> line = lines.Next()) {
    const Answer answer = question(*line);
    PrintLine(OnOneLine(answer.text, '\t'));
    worst = Worse(worst, answer.exitCode);
    if (!lines.HasMore()) FlushOutput();
  }
  return worst;
}

ExitCode AskOnce(const ExpressionCall& call, const Question& question) {
  const Answer answer = question(call.text == "-" ? ReadStandardInput() : call.text);
  if (!answer.text.empty()) PrintLine(WithoutLineFeed(answer.text));
  return answer.exitCode;
}

ExitCode Ask(const ExpressionCall& call, const Question& question) {
  return call.eachLine ? AskEachLine(question) : AskOnce(call, question);
}

/// Parses, and lets the operation make the text of a tree. The failure is the parser's message, or nothing.
Answer WithTree(const std::string& expression, bool withMessage,
                const std::function<std::string(const ExpressionNode&)>& textOf) {
  const auto parsed = ParseExpression(expression);
  if (const ParseFailure* failure = parsed->Failure()) {
    return {withMessage ? failure->finding.text : std::string(), kContentFault};
  }
  return {textOf(*parsed->Tree()), kFine};
}

/// A token outside the table carries the code of the last one in it; its text shows which of the two it is.
std::string_view NameOf(const ExpressionToken& listed) {
  const bool isOther = listed.code == TokenCode::ExceedanceFrequency && listed.text != "EXCEEDANCE_FREQUENCY";
  return isOther ? "-" : TokenName(listed.code);
}

std::string CodeText(const ExpressionToken& listed) {
  return std::to_string(static_cast<std::int32_t>(listed.code));
}

std::string TokenRow(const ExpressionToken& listed) {
  std::string row = CodeText(listed) + '\t';
  row += NameOf(listed);
  for (const std::int32_t number :
       {listed.firstColumn, listed.lastColumn, listed.firstOffset, listed.lastOffset}) {
    row += '\t' + std::to_string(number);
  }
  return row + '\t' + listed.text;
}

Answer TokenTable(const std::string& expression) {
  std::vector<ExpressionToken> tokens;
  const bool clean = ScanExpressionTokens(expression, tokens);
  Answer answer;
  for (const ExpressionToken& listed : tokens) answer.text += TokenRow(listed) + '\n';
  answer.exitCode = clean ? kFine : kContentFault;
  return answer;
}

Answer TokenLine(const std::string& expression) {
  std::vector<ExpressionToken> tokens;
  const bool clean = ScanExpressionTokens(expression, tokens);
  Answer answer;
  for (const ExpressionToken& listed : tokens) {
    if (!answer.text.empty()) answer.text += ' ';
    answer.text += CodeText(listed) + ":" + listed.text;
  }
  if (!clean) answer.text += " !";
  answer.exitCode = clean ? kFine : kContentFault;
  return answer;
}

Answer Findings(const std::string& expression) {
  Errors().ClearErrors();
  CheckFunctionsSpecified("", Uid::None, expression);
  Answer answer;
  for (const ErrorRecord& record : Errors().Records()) {
    answer.text += std::string(WithoutLineFeed(record.text)) + '\n';
    answer.exitCode = kContentFault;
  }
  return answer;
}

/// The expression as an equation, by what makes one of an expression, a symbol and whether the left side is a
/// derivative. Nothing for an expression that does not parse.
ExitCode AskForEquation(const ExpressionCall& call,
                        std::string (*equationOf)(const std::string&, const std::string&, bool)) {
  return Ask(call, [&call, equationOf](const std::string& expression) {
    Answer answer{equationOf(expression, call.symbol, call.isDerivative), kFine};
    if (answer.text.empty()) answer.exitCode = kContentFault;
    return answer;
  });
}

}  // namespace

ExitCode RunTokens(const ExpressionCall& call) {
  return Ask(call, call.eachLine ? TokenLine : TokenTable);
}

ExitCode RunParse(const ExpressionCall& call) {
  return Ask(call, [](const std::string& expression) { return WithTree(expression, true, TreeJson); });
}

ExitCode RunMathml(const ExpressionCall& call) {
  return AskForEquation(call, ExpressionToMathML);
}

ExitCode RunLatex(const ExpressionCall& call) {
  return AskForEquation(call, ExpressionToLatex);
}

ExitCode RunRewrite(const ExpressionCall& call) {
  return Ask(
      call, [](const std::string& expression) { return WithTree(expression, false, RewriteExpressionText); });
}

ExitCode RunExpressionCheck(const ExpressionCall& call) {
  return Ask(call, Findings);
}

ExitCode RunIdentifiers(const ExpressionCall& call) {
  return Ask(call, [](const std::string& expression) {
    std::vector<std::string> identifiers;
    ExtractIdentifiers(expression, identifiers);
    Answer answer;
    for (const std::string& identifier : identifiers) answer.text += identifier + '\n';
    return answer;
  });
}

}  // namespace tessal::cli
