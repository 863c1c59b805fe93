#include "docgen/mathml.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <string_view>
#include <vector>

#include "expr/expression_node.h"
#include "expr/expression_shape.h"
#include "expr/parser.h"
#include "platform/ascii.h"

namespace tessal {

namespace {

constexpr std::string_view kStart =
    "<?xml version=\"1.0\" encoding=\"ISO-8859-1\"?>"
    "<math display=\"block\" align=\"left\" xmlns=\"http://www.w3.org/1998/Math/MathML\"><mrow>";
constexpr std::string_view kEnd = "</mrow></math>\n";

/// What encloses the symbol on the left side of the equation.
struct LeftSide {
  std::string_view before;
  std::string_view after;
};

constexpr LeftSide kValue{"<mi>", "</mi><mo>=</mo>"};
constexpr LeftSide kDerivative{"<mfrac><mrow><mi>d</mi><mi>",
                               "</mi></mrow><mrow><mi>dt</mi></mrow></mfrac><mo>=</mo>"};

constexpr std::string_view kFence = "<mfenced separators=\"\">";
constexpr std::string_view kFenceEnd = "</mfenced>";

struct Relation {
  std::string_view text;
  std::string_view markUp;
};

// The greater sign is not escaped, unlike the smaller one.
constexpr std::array<Relation, 6> kRelations = {{
    {"==", "<mo>=</mo>"},
    {"!=", "<mo>&#x2260;</mo>"},
    {"<", "<mo>&lt;</mo>"},
    {">", "<mo>></mo>"},
    {">=", "<mo>&#x2265;</mo>"},
    {"<=", "<mo>&#x2264;</mo>"},
}};

struct FunctionMarkUp {
  std::string_view name;
  std::string_view enter;
  std::string_view leave;
};

constexpr std::array<FunctionMarkUp, 5> kFunctions = {{
    {"PI", "<mi mathvariant=\"bold-italic\">&#x3C0;</mi>", ""},
    {"SQRT", "<mrow><msqrt>", "</msqrt></mrow>"},
    {"SQR", "<mrow><msup>", "<mn>2</mn></msup></mrow>"},
    {"POW", "<mrow><msup>", "</msup></mrow>"},
    {"EXP", "<mrow><msup><mi>e</mi>", "</msup></mrow>"},
}};

constexpr std::string_view kRow = "<mtr><mtd columnalign=\"left\"><mtext mathcolor=\"blue\">";
constexpr std::string_view kRowValue = "</mtext></mtd><mtd columnalign=\"left\">";

const FunctionMarkUp* FindMarkUp(std::string_view name) {
  const auto hit = std::find_if(kFunctions.begin(), kFunctions.end(), [name](const FunctionMarkUp& row) {
    return EqualIgnoringCase(row.name, name);
  });
  return hit == kFunctions.end() ? nullptr : &*hit;
}

bool IsSum(std::string_view text) {
  return text == "+" || text == "-";
}

/// One run of the writer. A sum is fenced once; products, quotients and calls start afresh.
class MathMLWriter final {
 public:
  explicit MathMLWriter(std::string& output) : buffer(output) {}

  void OnEnter(NodeKind kind, std::string_view text) {
    switch (kind) {
      case NodeKind::Call:
        EnterCall(text);
        break;
      case NodeKind::Arithmetic:
        EnterArithmetic(text);
        break;
      case NodeKind::Comparison:
        buffer += kFence;
        break;
      case NodeKind::Conditional:
        EnterConditional(text);
        break;
      case NodeKind::DirectAssign:
      case NodeKind::DirectPlus:
      case NodeKind::DirectMinus:
      case NodeKind::DirectMultiply:
      case NodeKind::DirectDivide:
        Element("mi", text);
        buffer += "<mtext mathvariant=\"bold-italic\" mathcolor=\"green\">";
        buffer += DirectSign(kind);
        buffer += "</mtext>";
        break;
      case NodeKind::Argument:
        if (listDepth++ == 0) buffer += "<mrow>";
        break;
      case NodeKind::Negate:
        buffer += "<mo>-</mo>";
        break;
      default:
        break;
    }
  }

  void OnBetween(NodeKind kind, std::string_view text) {
    switch (kind) {
      case NodeKind::Identifier:
        Element("mi", text);
        break;
      case NodeKind::Number:
        Element("mn", text);
        break;
      case NodeKind::Arithmetic:
        if (text == "/") {
          buffer += "</mrow><mrow>";
        } else {
          Element("mo", text);
        }
        break;
      case NodeKind::Comparison:
        WriteRelation(text);
        break;
      case NodeKind::Property:
        buffer += "<mtext>[";
        buffer += text;
        buffer += "]</mtext>";
        break;
      default:
        break;
    }
  }

  void OnLeave(NodeKind kind, std::string_view text) {
    switch (kind) {
      case NodeKind::Call:
        LeaveCall(text);
        break;
      case NodeKind::Arithmetic:
        LeaveArithmetic(text);
        break;
      case NodeKind::Comparison:
        buffer += kFenceEnd;
        break;
      case NodeKind::Conditional:
        if (text == "IF") buffer += "</mtd></mtr></mtable> </mfenced> ";
        break;
      case NodeKind::Argument:
        // The end of one argument is the beginning of the next.
        buffer += "</mrow>";
        if (--listDepth >= 1) buffer += "<mrow>";
        break;
      default:
        break;
    }
  }

 private:
  void Element(std::string_view tag, std::string_view content) {
    buffer += '<';
    buffer += tag;
    buffer += '>';
    buffer += content;
    buffer += "</";
    buffer += tag;
    buffer += '>';
  }

  void EnterCall(std::string_view name) {
    if (const FunctionMarkUp* markUp = FindMarkUp(name)) {
      buffer += markUp->enter;
    } else {
      buffer += "<mrow><mtext mathvariant=\"bold-italic\" mathcolor=\"green\">";
      for (const char character : name) buffer += UpperCase(character);
      buffer += "</mtext><mfenced>";
    }
    listStack.push_back(listDepth);
    fenceStack.push_back(fenceDepth);
    listDepth = fenceDepth = 0;
  }

  void LeaveCall(std::string_view name) {
    const FunctionMarkUp* markUp = FindMarkUp(name);
    buffer += markUp != nullptr ? markUp->leave : "</mfenced></mrow>";
    listDepth = Take(listStack);
    fenceDepth = Take(fenceStack);
  }

  void EnterArithmetic(std::string_view text) {
    if (IsSum(text)) {
      if (++fenceDepth == 1) buffer += kFence;
      return;
    }
    if (text == "/") buffer += "<mfrac><mrow>";
    fenceStack.push_back(fenceDepth);
    fenceDepth = 0;
  }

  void LeaveArithmetic(std::string_view text) {
    if (IsSum(text)) {
      if (fenceDepth-- == 1) buffer += kFenceEnd;
      return;
    }
    if (text == "/") buffer += "</mrow></mfrac>";
    fenceDepth = Take(fenceStack);
  }

  void EnterConditional(std::string_view text) {
    if (text == "IF") {
      buffer += "<mtext mathcolor=\"blue\">IF</mtext>";
      return;
    }
    buffer += text == "THEN" ? "<mfenced open=\"{\" close=\"\"><mtable>" : "</mtd></mtr>";
    buffer += kRow;
    buffer += text;
    buffer += kRowValue;
  }

  void WriteRelation(std::string_view text) {
    const auto hit = std::find_if(kRelations.begin(), kRelations.end(),
                                  [text](const Relation& relation) { return relation.text == text; });
    if (hit != kRelations.end()) {
      buffer += hit->markUp;
    } else {
      Element("mo", text);
    }
  }

  static std::int32_t Take(std::vector<std::int32_t>& stack) {
    const std::int32_t value = stack.back();
    stack.pop_back();
    return value;
  }

  std::string& buffer;
  std::int32_t fenceDepth = 0;
  std::int32_t listDepth = 0;
  std::vector<std::int32_t> fenceStack;
  std::vector<std::int32_t> listStack;
};

}  // namespace

std::string TreeToMathML(const ExpressionNode& tree, std::string_view symbol, bool isDerivative) {
  std::string buffer(kStart);
  const LeftSide& side = isDerivative ? kDerivative : kValue;
  buffer += side.before;
  buffer += symbol;
  buffer += side.after;
  MathMLWriter writer(buffer);
  tree.WalkInOrder(
      [&writer](NodeKind kind, std::string_view text, std::int32_t) { writer.OnEnter(kind, text); },
      [&writer](NodeKind kind, std::string_view text, std::int32_t) { writer.OnBetween(kind, text); },
      [&writer](NodeKind kind, std::string_view text, std::int32_t) { writer.OnLeave(kind, text); });
  buffer += kEnd;
  return buffer;
}

std::string ExpressionToMathML(const std::string& expression, const std::string& symbol, bool isDerivative) {
  const auto parsed = ParseExpression(expression);
  const ExpressionNode* tree = parsed->Tree();
  return tree == nullptr ? std::string() : TreeToMathML(*tree, symbol, isDerivative);
}

}  // namespace tessal
