// The expression language, from tokens to mark-up, by the files of cases beside this runner. In them `> each`
// asks the question that follows it about every line of the input; `> then` keeps the scanner as the question
// before left it.
#include <gtest/gtest.h>

#include <functional>
#include <map>
#include <memory>
#include <random>
#include <sstream>

#include "core/error_registry.h"
#include "docgen/latex.h"
#include "docgen/mathml.h"
#include "expr/identifiers.h"
#include "expr/interaction_rewriter.h"
#include "expr/parser.h"
#include "expr/semantic_checks.h"
#include "expr/user_function_names.h"
#include "platform/ascii.h"
#include "support/case_file.h"

namespace tessal {
namespace {

std::string Tokens(const std::string& text) {
  std::vector<ExpressionToken> tokens;
  const bool clean = ScanExpressionTokens(text, tokens);
  std::string rows;
  for (const ExpressionToken& each : tokens) {
    rows += std::to_string(static_cast<int>(each.code)) + " " + std::string(TokenName(each.code)) + " " +
            each.text + " " + std::to_string(each.line) + ":" + std::to_string(each.firstColumn) + "-" +
            std::to_string(each.lastColumn) + " " + std::to_string(each.firstOffset) + "-" +
            std::to_string(each.lastOffset) + "\n";
  }
  return clean ? rows : rows + "not clean\n";
}

/// A tree as nested lists: (kind text child child).
std::string TreeText(const ExpressionNode& node) {
  std::string text = "(" + std::to_string(static_cast<int>(node.Kind())) + " " + std::string(node.Text());
  for (std::int32_t slot = 1; slot <= node.ChildCount(); ++slot) {
    EXPECT_EQ(node.Child(slot)->Parent(), &node);
    text += " " + TreeText(*node.Child(slot));
  }
  return text + ")";
}

/// What is made of the tree of a text, or the parser's message.
std::string OfTree(const std::string& text, const std::function<std::string(const ExpressionNode&)>& make) {
  const auto parsed = ParseExpression(text);
  return parsed->Failure() != nullptr ? parsed->Failure()->finding.text : make(*parsed->Tree()) + "\n";
}

std::string Tree(const std::string& text) {
  return OfTree(text, TreeText);
}

/// The calls of both walks: < before, = visit, > after, each with text and depth.
std::string Walks(const std::string& text) {
  return OfTree(text, [](const ExpressionNode& tree) {
    std::string calls;
    const auto note = [&calls](char sign) {
      return [&calls, sign](NodeKind, std::string_view nodeText, std::int32_t depth) {
        calls += sign + std::string(nodeText) + std::to_string(depth) + ' ';
      };
    };
    tree.WalkInOrder(note('<'), note('='), note('>'));
    calls += "\n";
    tree.WalkPostOrder(note('<'), note('='), note('>'), 5);
    return calls;
  });
}

std::string Findings(const std::string& text) {
  Errors().Reset();
  std::string rows = CheckFunctionsSpecified("S", Uid{7}, text) == 1 ? "" : "no tree\n";
  for (const ErrorRecord& record : Errors().Records()) {
    rows += std::to_string(record.level) + " " + record.symbol + std::to_string(NumberOf(record.uid)) + " " +
            std::string(record.code) + ": " + record.text + "\n";
  }
  return rows;
}

/// The identifiers of a text. A parse that knows them has the same, and the same effect on the scanner.
std::string Identifiers(const std::string& text) {
  const std::string_view bare = StripExpressionQuotes(text);
  const ScannerStart start = ExpressionScannerStart();
  const auto parsed = ParseExpression(bare);
  SetExpressionScannerStart(start);
  std::vector<std::string> identifiers;
  ExtractIdentifiers(text, identifiers);
  if (parsed->KnowsIdentifiers()) {
    std::vector<std::string> known;
    for (const LexemeSpan& name : parsed->Identifiers())
      known.emplace_back(bare.substr(name.start, name.length));
    EXPECT_EQ(known, identifiers) << text;
    EXPECT_EQ(parsed->Left(), ExpressionScannerStart()) << text;
  }
  std::string rows;
  for (const std::string& each : identifiers) rows += each + "\n";
  return rows;
}

/// What is between the frame of a block and its symbol, which is s.
std::string RightSide(const std::string& text) {
  const std::string nothing = ExpressionToMathML("0", "s", false);
  const std::size_t start = nothing.find("<mn>0</mn>");
  const std::size_t end = nothing.size() - start - std::string_view("<mn>0</mn>").size();
  const std::string block = ExpressionToMathML(text, "s", false);
  return block.empty() ? "" : block.substr(start, block.size() - start - end) + "\n";
}

std::string Latex(const ExpressionNode& tree) {
  return TreeToLatex(tree, "", false);
}

std::string NameUses(const std::string& text) {
  std::string uses;
  if (IsValidSymbolSpelling(text)) uses += " spelt";
  if (IsValidSymbol(text)) uses += " symbol";
  if (IsReservedName(text)) uses += " reserved";
  if (IsPropertyName(text)) uses += " property";
  if (IsInteractionVerb(text)) uses += " verb";
  if (IsConditionalWord(text)) uses += " conditional";
  return uses.empty() ? "" : uses.substr(1) + "\n";
}

const std::map<std::string, std::string (*)(const std::string&)> kQuestions = {
    {"tokens", Tokens},
    {"tree", Tree},
    {"walks", Walks},
    {"findings", Findings},
    {"identifiers", Identifiers},
    {"right side", RightSide},
    {"name", NameUses},
    {"mathml", [](const std::string& text) { return ExpressionToMathML(text, "s", false); }},
    {"latex", [](const std::string& text) { return OfTree(text, Latex); }},
    {"latex equation", [](const std::string& text) { return ExpressionToLatex(text, "k_20", false) + "\n"; }},
    {"latex derivative", [](const std::string& text) { return ExpressionToLatex(text, "DO", true) + "\n"; }},
    {"derivative", [](const std::string& text) { return ExpressionToMathML(text, "s", true); }},
    {"rewrite", [](const std::string& text) { return OfTree(text, RewriteExpressionText); }},
    {"unquoted", [](const std::string& text) { return std::string(StripExpressionQuotes(text)) + "\n"; }},
};

std::string Ask(const std::string& question, const std::string& text) {
  const auto hit = kQuestions.find(question);
  EXPECT_NE(hit, kQuestions.end()) << question;
  return hit == kQuestions.end() ? "no such question\n" : hit->second(text);
}

/// The rest of a text after its first words; nothing when it begins otherwise.
std::optional<std::string> After(const std::string& words, std::string_view text) {
  return text.starts_with(words) ? std::optional<std::string>(text.substr(words.size())) : std::nullopt;
}

class Language : public testing::TestWithParam<const char*> {
 protected:
  void TearDown() override {
    ResetExpressionScanner();
    ResetUserFunctionNames();
    Errors().Reset();
  }
};

TEST_P(Language, IsAsTheCasesSay) {
  test::RunCases(std::string("expr/cases/") + GetParam(), [](const test::Case& each) -> test::Answer {
    ResetUserFunctionNames();
    ResetExpressionScanner();
    return [input = each.input](const test::CaseCall& call) {
      if (const auto question = After("each ", call.words)) {
        return test::AnswerEach(input, [&question](const std::string& line) {
          ResetExpressionScanner();
          return Ask(*question, line);
        });
      }
      if (const auto question = After("then ", call.words)) return Ask(*question, input);
      if (const auto name = After("register ", call.words)) {
        return std::string(RegisterUserFunctionName(*name) ? "new\n" : "known\n");
      }
      if (const auto name = After("unregister ", call.words)) {
        UnregisterUserFunctionName(*name);
        return std::string();
      }
      ResetExpressionScanner();
      return Ask(call.words, input);
    };
  });
}

INSTANTIATE_TEST_SUITE_P(Cases, Language,
                         testing::Values("scanning.txt", "trees.txt", "failures.txt", "checks.txt",
                                         "output.txt", "latex.txt"));

/// What the bars of a text separate.
std::vector<std::string> PartsOf(const std::string& text) {
  std::vector<std::string> parts;
  std::istringstream rest(text);
  for (std::string part; std::getline(rest, part, '|');) parts.push_back(part);
  return parts;
}

/// A random expression: a shape whose @ are expressions and whose # are leaves.
std::string RandomExpression(std::mt19937& random, int depth) {
  static const std::vector<std::string> leaves = PartsOf("a|Kd|x_1|2|0.5|1e-3|[XPOS]|$r|PI()");
  static const std::vector<std::string> shapes = PartsOf(
      "@ + @|@-@|(@)*#|(@)/(@)|-(@)|MAX(@, @)|(IF @ >= # THEN @ ELSE @)|IF(@ >= #;@;@)|"
      "(IF @ >= # AND # != # THEN @ ELSE @)|IF(NOT (@ >= # OR # < #);@;@)|#");
  std::string text;
  for (const char mark : depth == 0 ? "#" : shapes[random() % shapes.size()]) {
    text += mark == '@'   ? RandomExpression(random, depth - 1)
            : mark == '#' ? leaves[random() % leaves.size()]
                          : std::string(1, mark);
  }
  return text;
}

TEST_F(Language, RandomExpressionsParseTheSameWhateverTheirBlanks) {
  for (unsigned seed = 1; seed <= 500; ++seed) {
    std::mt19937 random(seed);
    const std::string text = RandomExpression(random, 6);
    const std::string tree = Tree(text);
    ASSERT_EQ(tree.front(), '(') << "seed " << seed << ": " << text << "\n" << tree;
    std::string spaced;
    for (const char character : text) spaced += character == ' ' ? " \n\t/* */ " : std::string(1, character);
    ASSERT_EQ(Tree("(" + spaced + ")"), tree) << "seed " << seed;
  }
}

/// What is open and not closed, or closed and not open, in a text of LaTeX; nothing where all is in order.
std::string Unbalanced(const std::string& latex) {
  static const std::map<std::string, std::string> ends = {
      {"{", "}"}, {"\\left", "\\right"}, {"\\begin", "\\end"}};
  std::vector<std::string> open;
  for (std::size_t place = 0; place < latex.size();) {
    std::size_t end = place + 1;
    if (latex[place] == '\\') {
      while (end < latex.size() && IsAsciiLetter(latex[end])) ++end;
      if (end == place + 1) ++end;
    }
    const std::string token = latex.substr(place, end - place);
    place = end;
    if (ends.contains(token)) open.push_back(ends.at(token));
    if (token != "}" && token != "\\right" && token != "\\end") continue;
    if (open.empty() || open.back() != token) return token + " before " + latex.substr(place, 20);
    open.pop_back();
  }
  return open.empty() ? "" : "no " + open.back();
}

TEST_F(Language, LatexOfRandomExpressionsClosesWhatItOpens) {
  EXPECT_EQ(Unbalanced("{\\{a\\right"), "\\right before ");
  EXPECT_EQ(Unbalanced("\\left({a}"), "no \\right");
  for (unsigned seed = 1; seed <= 500; ++seed) {
    std::mt19937 random(seed);
    const std::string text = RandomExpression(random, 6);
    const std::string latex = ExpressionToLatex(text, "s", seed % 2 == 0);
    ASSERT_EQ(Unbalanced(latex), "") << "seed " << seed << ": " << text << "\n" << latex;
    // Two signs side by side would be misread, and what is bracketed is never empty.
    for (const char* fault : {"+ -", "- -", "\\cdot -", "\\left(\\right)("}) {
      ASSERT_EQ(latex.find(fault), std::string::npos) << "seed " << seed << ": " << text << "\n" << latex;
    }
  }
}

TEST_F(Language, ATokenOfAThousandCharactersIsTooLong) {
  EXPECT_EQ(Tree(std::string(999, 'a')), "(2 " + std::string(999, 'a') + ")\n");
  EXPECT_EQ(Tree(std::string(1000, 'a')), "Line 1 position 1000 : token too long\n");
  // Before a syntax error at the same token.
  EXPECT_EQ(Tree("a " + std::string(1000, '7')), "Line 1 position 1002 : token too long\n");
  const std::string name(kLongestExpression / 2 - 2, 'n');
  std::vector<std::string_view> names;
  ScanIdentifiers(name + "/*" + name + "*/", names);
  ASSERT_EQ(names.size(), 1U);
  EXPECT_EQ(names[0].size(), name.size());
  ScanIdentifiers(name + "/*" + name + "*/ ", names);
  EXPECT_TRUE(names.empty()) << "one character more than is looked at";
}

std::string Repeated(const std::string& piece, int count) {
  std::string text;
  for (int repeat = 0; repeat < count; ++repeat) text += piece;
  return text;
}

TEST_F(Language, DeepNestingIsAMessage) {
  for (const char* opening : {"(", "-", "f(", "IF(a>1,", "a ::= "}) {
    EXPECT_NE(Tree(Repeated(opening, 50'000) + "a").find("memory exhausted\n"), std::string::npos) << opening;
  }
  // Deeper than the stack's first room, and still within its limit of 10,000 states.
  EXPECT_EQ(Tree(Repeated("(", 9'996) + "a" + Repeated(")", 9'996)), "(2 a)\n");
  EXPECT_EQ(Tree(Repeated("(", 9'997) + "a" + Repeated(")", 9'997)),
            "Line 1 position 9999 : memory exhausted\n");
}

TEST_F(Language, LongChainsNeedNoStack) {
  const std::string product = "a" + Repeated("*a", 300'000);
  const ExpressionTree copy(ParseExpression(product)->Tree());
  EXPECT_EQ(RewriteExpressionText(copy.Root()), product);
  std::int32_t deepest = 0;
  copy.Root().WalkPostOrder(
      nullptr,
      [&deepest](NodeKind, std::string_view, std::int32_t depth) { deepest = std::max(deepest, depth); },
      nullptr);
  EXPECT_EQ(deepest, 300'000);
  EXPECT_FALSE(TreeToMathML(copy.Root(), "s", false).empty());
  EXPECT_EQ(Latex(copy.Root()), "\\mathrm{a}" + Repeated(" \\cdot \\mathrm{a}", 300'000));
  EXPECT_EQ(Findings(product), "");
}

TEST_F(Language, AFailureLeavesTheTreeAlone) {
  ExpressionTree tree;
  std::int32_t line = 0;
  std::int32_t position = 0;
  std::string message;
  ASSERT_EQ(ParseExpressionText("a + 1", tree, line, position, message), 1);
  EXPECT_EQ(std::tie(line, position, message), std::make_tuple(-1, -1, "no error"));
  ASSERT_EQ(ParseExpressionText("\n a +", tree, line, position, message), 0);
  EXPECT_EQ(std::tie(line, position, message),
            std::make_tuple(1, 4, "Line 2 position 4 : syntax error, unexpected $end\n"));
  EXPECT_EQ(TreeText(tree.Root()), "(5 + (2 a) (3 1))");
}

TEST_F(Language, AHeldParseIsUsedAgainAsIfItWereParsedAgain) {
  std::unique_ptr<const ParsedExpression> held;
  EXPECT_NE(ParseOnce(held, "a */ b").Failure(), nullptr) << "in plain text a product without its right side";
  SetExpressionScannerStart(ScannerStart::Comment);
  EXPECT_EQ(TreeText(*ParseOnce(held, "a */ b").Tree()), "(2 b)") << "a scan that begins elsewhere is made";
  EXPECT_EQ(ExpressionScannerStart(), ScannerStart::Text);
  // When it would begin as it began the text is not looked at, and the comment is closed as the parse did.
  SetExpressionScannerStart(ScannerStart::Comment);
  EXPECT_EQ(TreeText(*ParseOnce(held, "other").Tree()), "(2 b)");
  EXPECT_EQ(ExpressionScannerStart(), ScannerStart::Text);

  held.reset();
  ParseOnce(held, "a /* open");
  EXPECT_EQ(ExpressionScannerStart(), ScannerStart::Comment);
  ResetExpressionScanner();
  ParseOnce(held, "other");
  EXPECT_EQ(ExpressionScannerStart(), ScannerStart::Comment);
}

TEST_F(Language, ATreeIsACopyOfItsOwn) {
  std::string text = "f(a, b - c)";
  const auto parsed = ParseExpression(text);
  const std::string nodes = TreeText(*parsed->Tree());
  ExpressionTree copy(parsed->Tree());
  text.assign(text.size(), '!');
  const ExpressionTree moved = std::move(copy);
  EXPECT_EQ(TreeText(moved.Root()), nodes);

  ExpressionTree tree(moved.Root().Child(1)->Child(2));
  EXPECT_EQ(TreeText(tree.Root()), "(5 - (2 b) (2 c))");
  EXPECT_EQ(tree.Root().Parent(), nullptr);
  tree.DeepCopy(tree.Root().Child(2));
  EXPECT_EQ(TreeText(tree.Root()), "(2 c)");
  tree.DeepCopy(nullptr);
  EXPECT_EQ(TreeText(tree.Root()), "(0 )");
  tree.Release();
  EXPECT_EQ(TreeText(tree.Root()), "(0 unknown)");
  EXPECT_EQ(RewriteExpressionText(tree.Root()), "");
  EXPECT_EQ(tree.Root().Child(1), nullptr);
}

}  // namespace
}  // namespace tessal
