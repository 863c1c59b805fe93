#include "expr/parser.h"

#include "expr/parse_state.h"

namespace tessal {

int ParseExpressionText(const std::string& text, ExpressionNode& node, std::int32_t& line,
                        std::int32_t& position, std::string& message) {
  line = -1;
  position = -1;
  message.clear();
  ParseState state(text);
  if (tessal_expression_grammar_parse(state) != 0 || !state.Root()) {
    line = state.Line();
    position = state.Position();
    message = state.Message();
    return 0;
  }
  node = std::move(*state.Root());
  message = "no error";
  return 1;
}

}  // namespace tessal
