#include "cli/tree_json.h"

#include <nlohmann/json.hpp>
#include <vector>

#include "cli/template_messages.h"
#include "expr/expression_node.h"

namespace tessal::cli {

namespace {

/// A node whose children are being written.
struct OpenNode {
  const ExpressionNode* node;
  std::int32_t written;
};

void AppendHead(const ExpressionNode& node, std::string& json) {
  json += "{\"kind\":" + std::to_string(static_cast<std::int32_t>(node.Kind())) +
          ",\"text\":" + nlohmann::json(JsonText(std::string(node.Text()))).dump();
  if (node.ChildCount() > 0) json += ",\"children\":[";
}

}  // namespace

std::string TreeJson(const ExpressionNode& tree) {
  std::string json;
  std::vector<OpenNode> path{{&tree, 0}};
  AppendHead(tree, json);
  while (!path.empty()) {
    OpenNode& open = path.back();
    if (open.written < open.node->ChildCount()) {
      if (open.written > 0) json += ',';
      const ExpressionNode* child = open.node->Child(++open.written);
      AppendHead(*child, json);
      path.push_back({child, 0});
      continue;
    }
    json += open.node->ChildCount() > 0 ? "]}" : "}";
    path.pop_back();
  }
  return json;
}

}  // namespace tessal::cli
