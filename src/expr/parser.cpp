#include "expr/parser.h"

#include <utility>

#include "expr/parse_state.h"

namespace tessal {

ParsedExpression ParseExpression(std::string_view text) {
  ParsedExpression parsed;
  parsed.began = ExpressionScannerStart();
  if (text.size() > kLongestExpression) {
    parsed.result = ParseFailure{{"expression-too-long", {std::to_string(kLongestExpression)}}, 0, 1};
    parsed.left = parsed.began;
    return parsed;
  }
  ParseState state(text);
  if (tessal_expression_grammar_parse(state) == 0 && state.Root()) {
    parsed.result = std::move(*state.Root());
  } else {
    parsed.result = ParseFailure{state.Failure(), state.Line(), state.Position()};
  }
  parsed.left = ExpressionScannerStart();
  return parsed;
}

const ParsedExpression& ParseOnce(std::unique_ptr<const ParsedExpression>& held, std::string_view text) {
  if (held && held->began == ExpressionScannerStart()) {
    SetExpressionScannerStart(held->left);
    return *held;
  }
  held = std::make_unique<const ParsedExpression>(ParseExpression(text));
  return *held;
}

int ParseExpressionText(const std::string& text, ExpressionNode& node, std::int32_t& line,
                        std::int32_t& position, std::string& message) {
  ParsedExpression parsed = ParseExpression(text);
  if (const ParseFailure* failure = parsed.Failure()) {
    line = failure->line;
    position = failure->position;
    message = failure->finding.text;
    return 0;
  }
  node = std::move(std::get<ExpressionNode>(parsed.result));
  line = -1;
  position = -1;
  message = "no error";
  return 1;
}

}  // namespace tessal
