#include "docgen/latex.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <iterator>
#include <optional>
#include <vector>

#include "expr/expression_node.h"
#include "expr/expression_shape.h"
#include "expr/parser.h"
#include "platform/ascii.h"

namespace tessal {

namespace {

/// How a function is set: what comes before its arguments, between them and after them, and how tightly an
/// argument must hold together there.
struct FunctionStyle {
  std::string_view name;
  std::int32_t arguments;
  Bond bond;  ///< of the whole
  Bond inner;
  std::string_view before;
  std::string_view between;
  std::string_view after;
};

// MAX and MIN are missing on purpose: they compute the opposite of what \max and \min mean.
constexpr std::array<FunctionStyle, 19> kStyles = {{
    {"PI", 0, Bond::Atom, Bond::None, "\\pi", "", ""},
    {"SQRT", 1, Bond::Power, Bond::None, "\\sqrt{", "", "}"},
    {"SQR", 1, Bond::Power, Bond::Atom, "{", "", "}^{2}"},
    {"POW", 2, Bond::Power, Bond::Atom, "{", "}^{", "}"},
    {"EXP", 1, Bond::Power, Bond::None, "\\mathrm{e}^{", "", "}"},
    {"ABS", 1, Bond::Atom, Bond::None, "\\left|", "", "\\right|"},
    {"FLOOR", 1, Bond::Atom, Bond::None, "\\left\\lfloor ", "", "\\right\\rfloor"},
    {"CEIL", 1, Bond::Atom, Bond::None, "\\left\\lceil ", "", "\\right\\rceil"},
    {"LN", 1, Bond::Power, Bond::None, "\\ln\\left(", "", "\\right)"},
    {"LOG10", 1, Bond::Power, Bond::None, "\\log_{10}\\left(", "", "\\right)"},
    {"SIN", 1, Bond::Power, Bond::None, "\\sin\\left(", "", "\\right)"},
    {"COS", 1, Bond::Power, Bond::None, "\\cos\\left(", "", "\\right)"},
    {"TAN", 1, Bond::Power, Bond::None, "\\tan\\left(", "", "\\right)"},
    {"ARCSIN", 1, Bond::Power, Bond::None, "\\arcsin\\left(", "", "\\right)"},
    {"ARCCOS", 1, Bond::Power, Bond::None, "\\arccos\\left(", "", "\\right)"},
    {"ARCTAN", 1, Bond::Power, Bond::None, "\\arctan\\left(", "", "\\right)"},
    {"SINH", 1, Bond::Power, Bond::None, "\\sinh\\left(", "", "\\right)"},
    {"COSH", 1, Bond::Power, Bond::None, "\\cosh\\left(", "", "\\right)"},
    {"TANH", 1, Bond::Power, Bond::None, "\\tanh\\left(", "", "\\right)"},
}};

/// An infix operator: its sign, how tightly the whole holds together, and what its sides must.
struct Infix {
  std::string_view text;
  std::string_view sign;
  Bond bond;
  Bond left;
  Bond right;
};

// The right side of a sum or a product begins with no sign: two of them need brackets between them.
constexpr std::array<Infix, 9> kInfixes = {{
    {"+", " + ", Bond::Sum, Bond::Sum, Bond::Product},
    {"-", " - ", Bond::Sum, Bond::Sum, Bond::Product},
    {"*", " \\cdot ", Bond::Product, Bond::Negation, Bond::Power},
    {"==", " = ", Bond::Comparison, Bond::Sum, Bond::Sum},
    {"!=", " \\neq ", Bond::Comparison, Bond::Sum, Bond::Sum},
    {">", " > ", Bond::Comparison, Bond::Sum, Bond::Sum},
    {"<", " < ", Bond::Comparison, Bond::Sum, Bond::Sum},
    {">=", " \\geq ", Bond::Comparison, Bond::Sum, Bond::Sum},
    {"<=", " \\leq ", Bond::Comparison, Bond::Sum, Bond::Sum},
}};

template <std::size_t Count, class Row>
const Row* FindRow(const std::array<Row, Count>& rows, std::string_view Row::*key, std::string_view text) {
  const auto hit = std::find_if(rows.begin(), rows.end(),
                                [key, text](const Row& row) { return EqualIgnoringCase(row.*key, text); });
  return hit == rows.end() ? nullptr : &*hit;
}

const FunctionStyle* StyleOf(const ExpressionNode& call, std::size_t arguments) {
  const FunctionStyle* style = FindRow(kStyles, &FunctionStyle::name, call.Text());
  return style != nullptr && static_cast<std::size_t>(style->arguments) == arguments ? style : nullptr;
}

/// One run of the writer. Trees of long chains are as deep as they are long, so what is left to write lies on
/// a stack of its own.
class LatexWriter final {
 public:
  explicit LatexWriter(std::string& target) : output(target) {}

  void Write(const ExpressionNode& tree) {
    stack.push_back(Part(tree));
    while (!stack.empty()) {
      const Piece piece = stack.back();
      stack.pop_back();
      if (piece.node == nullptr) {
        output += piece.text;
        continue;
      }
      pieces.clear();
      Split(*piece.node, piece.bond);
      stack.insert(stack.end(), pieces.rbegin(), pieces.rend());
    }
  }

 private:
  /// A text to write, or a node with how tightly its place asks it to hold together.
  struct Piece {
    const ExpressionNode* node = nullptr;
    Bond bond = Bond::None;
    std::string text = {};
  };

  static Piece Part(const ExpressionNode& node, Bond bond = Bond::None) { return {&node, bond}; }

  void Add(std::string_view text) { pieces.push_back({.text = std::string(text)}); }
  void Add(const ExpressionNode& node, Bond bond = Bond::None) { pieces.push_back(Part(node, bond)); }
  void AddName(std::string_view name) { Add("\\mathrm{" + LatexText(name) + "}"); }

  /// Makes the pieces of a node.
  void Split(const ExpressionNode& node, Bond bond) {
    const Bond own = MakePieces(node);
    const bool hasSign = bond >= Bond::Product && IsProduct(node) && BeginsWithSign(node);
    if (own >= bond && !hasSign) return;
    pieces.insert(pieces.begin(), {.text = "\\left("});
    Add("\\right)");
  }

  /// Returns how tightly the pieces hold together.
  Bond MakePieces(const ExpressionNode& node) {
    switch (node.Kind()) {
      case NodeKind::Identifier:
        AddName(node.Text());
        return Bond::Atom;
      case NodeKind::Number:
        return MakeNumber(node.Text());
      case NodeKind::Property:
        Add("\\left[");
        AddName(node.Text());
        Add("\\right]");
        return Bond::Atom;
      case NodeKind::Call:
        return MakeCall(node);
      case NodeKind::Arithmetic:
        if (node.Text() == "/") return MakeFraction(node);
        return MakeInfix(node);
      case NodeKind::Comparison:
        return MakeCondition(node);
      case NodeKind::Conditional:
        return MakeConditional(node);
      case NodeKind::Negate:
        Add("-");
        Add(*node.Child(1), Bond::Product);
        return Bond::Negation;
      case NodeKind::DirectAssign:
      case NodeKind::DirectPlus:
      case NodeKind::DirectMinus:
      case NodeKind::DirectMultiply:
      case NodeKind::DirectDivide:
        return MakeDirect(node);
      case NodeKind::Interaction:
        return MakeInteraction(node);
      case NodeKind::Exceedance:
        AddCall(node.Text(), {node.Child(1)});
        return Bond::Power;
      case NodeKind::Target:
        AddList({node.Child(1), node.Child(2)});
        return Bond::Atom;
      case NodeKind::Modlist:
        return MakeModlist(node);
      default:
        // What has no form of its own shows what is in it.
        for (std::int32_t slot = 1; slot <= node.ChildCount(); ++slot) Add(*node.Child(slot));
        return Bond::Atom;
    }
  }

  /// Turns an exponent into a power of ten.
  Bond MakeNumber(std::string_view number) {
    const std::size_t mark = number.find_first_of("eE");
    if (mark == std::string_view::npos) {
      Add(number);
      return Bond::Atom;
    }
    std::string_view exponent = number.substr(mark + 1);
    const bool isNegative = exponent.starts_with('-');
    exponent.remove_prefix(std::min(exponent.find_first_of("123456789"), exponent.size()));
    Add(number.substr(0, mark));
    Add(" \\cdot 10^{");
    Add(exponent.empty() ? "0" : (isNegative ? "-" : "") + std::string(exponent));
    Add("}");
    return Bond::Product;
  }

  Bond MakeFraction(const ExpressionNode& node) {
    Add("\\frac{");
    Add(*node.Child(1));
    Add("}{");
    Add(*node.Child(2));
    Add("}");
    return Bond::Power;
  }

  Bond MakeInfix(const ExpressionNode& node) {
    const Infix* infix = FindRow(kInfixes, &Infix::text, node.Text());
    Add(*node.Child(1), infix->left);
    Add(infix->sign);
    Add(*node.Child(2), infix->right);
    return infix->bond;
  }

  Bond MakeCondition(const ExpressionNode& node) {
    const std::optional<Logic> logic = LogicOf(node);
    if (!logic) return MakeInfix(node);
    if (logic->which == Logic::Operator::Not) {
      Add("\\lnot ");
      Add(logic->left, Bond::Atom);
      return Bond::Comparison;
    }
    const bool isAnd = logic->which == Logic::Operator::And;
    const Bond bond = isAnd ? Bond::And : Bond::Or;
    // A chain is a chain to the left; on the right the same operator was in brackets.
    Add(logic->left, bond);
    Add(isAnd ? " \\land " : " \\lor ");
    Add(logic->right, isAnd ? Bond::Comparison : Bond::And);
    return bond;
  }

  Bond MakeConditional(const ExpressionNode& node) {
    Add("\\begin{cases} ");
    // What follows ELSE IF is another row.
    const ExpressionNode* rest = &node;
    for (; IsIf(*rest); rest = &BranchesOf(*rest).otherwise) {
      Add(BranchesOf(*rest).then);
      Add(" & \\text{if } ");
      Add(BranchesOf(*rest).condition);
      Add(" \\\\ ");
    }
    Add(*rest);
    Add(" & \\text{otherwise} \\end{cases}");
    return Bond::None;
  }

  Bond MakeCall(const ExpressionNode& node) {
    const std::vector<const ExpressionNode*> arguments = ArgumentsOf(node);
    const FunctionStyle* style = StyleOf(node, arguments.size());
    if (style == nullptr) {
      AddCall(node.Text(), arguments);
      return Bond::Power;
    }
    Add(style->before);
    for (std::size_t place = 0; place < arguments.size(); ++place) {
      if (place > 0) Add(style->between);
      // An exponent needs no brackets: it is small.
      Add(*arguments[place], place == 0 ? style->inner : Bond::None);
    }
    Add(style->after);
    return style->bond;
  }

  Bond MakeDirect(const ExpressionNode& node) {
    AddName(node.Text());
    Add(" \\mathrel{\\mathtt{" + std::string(DirectSign(node.Kind())) + "}} ");
    Add(*node.Child(1));
    return Bond::None;
  }

  Bond MakeInteraction(const ExpressionNode& node) {
    AddName(node.Text());
    Add("\\left\\{");
    Add(*node.Child(1));
    for (const ExpressionNode* list : ItemsOf(node.Child(2), NodeKind::Modlists)) {
      Add(", ");
      Add(*list);
    }
    Add("\\right\\}");
    return Bond::Atom;
  }

  Bond MakeModlist(const ExpressionNode& node) {
    AddList(FieldsOf(node));
    return Bond::Atom;
  }

  void AddCall(std::string_view name, const std::vector<const ExpressionNode*>& arguments) {
    Add("\\operatorname{" + LatexText(UpperCase(name)) + "}");
    AddList(arguments);
  }

  /// Values in brackets, separated by commas.
  void AddList(const std::vector<const ExpressionNode*>& values) {
    Add("\\left(");
    for (const ExpressionNode* value : values) {
      if (value != values.front()) Add(", ");
      Add(*value);
    }
    Add("\\right)");
  }

  std::string& output;
  std::vector<Piece> stack;   ///< the next to write on top
  std::vector<Piece> pieces;  ///< of the node at hand, in order
};

}  // namespace

std::string LatexText(std::string_view text) {
  struct Escape {
    char character;
    std::string_view text;
  };
  static constexpr Escape kEscapes[] = {
      {'\\', "\\textbackslash{}"},
      {'{', "\\{"},
      {'}', "\\}"},
      {'_', "\\_"},
      {'#', "\\#"},
      {'$', "\\$"},
      {'%', "\\%"},
      {'&', "\\&"},
      {'~', "\\textasciitilde{}"},
      {'^', "\\textasciicircum{}"},
  };
  std::string safe;
  for (const char character : text) {
    const auto* hit = std::find_if(std::begin(kEscapes), std::end(kEscapes),
                                   [character](const Escape& row) { return row.character == character; });
    if (hit == std::end(kEscapes)) {
      safe += character;
    } else {
      safe += hit->text;
    }
  }
  return safe;
}

std::string TreeToLatex(const ExpressionNode& tree, std::string_view symbol, bool isDerivative) {
  std::string latex;
  if (!symbol.empty()) {
    const std::string name = "\\mathrm{" + LatexText(symbol) + "}";
    latex = isDerivative ? "\\frac{\\mathrm{d}" + name + "}{\\mathrm{d}t} = " : name + " = ";
  }
  LatexWriter(latex).Write(tree);
  return latex;
}

std::string ExpressionToLatex(const std::string& expression, const std::string& symbol, bool isDerivative) {
  const auto parsed = ParseExpression(expression);
  const ExpressionNode* tree = parsed->Tree();
  return tree == nullptr ? std::string() : TreeToLatex(*tree, symbol, isDerivative);
}

}  // namespace tessal
