#include "expr/scanner.h"

#include <gtest/gtest.h>

#include "expr/identifiers.h"

namespace tessal {
namespace {

class Scanner : public testing::Test {
 protected:
  void SetUp() override { ResetExpressionScanner(); }
  void TearDown() override { ResetExpressionScanner(); }
};

/// Codes and lexemes of a text, "!" behind an unclean scan.
std::string Scanned(const std::string& text) {
  std::vector<ExpressionToken> tokens;
  const bool clean = ScanExpressionTokens(text, tokens);
  std::string result;
  for (const ExpressionToken& listed : tokens) {
    if (!result.empty()) result += ' ';
    result += std::to_string(static_cast<int>(listed.code)) + ":" + listed.text;
  }
  return clean ? result : result + " !";
}

TEST_F(Scanner, FindsTheLongestTokenAndPrefersKeywords) {
  struct Row {
    const char* text;
    const char* tokens;
  };
  const Row rows[] = {
      {"", ""},
      {" \t\r\n ", ""},
      {"if tHeN eLsE", "279:if 280:tHeN 281:eLsE"},
      {"IF1 IFX if_1 and or not And", "258:IF1 258:IFX 258:if_1 258:and 258:or 258:not 258:And"},
      {"NOT AND OR ! && ||", "282:NOT 283:AND 284:OR 282:! 283:&& 284:||"},
      {"a;b,c", "258:a 266:; 258:b 266:, 258:c"},
      {"== != >= <= < >", "273:== 274:!= 277:>= 278:<= 276:< 275:>"},
      {"a <> b", "258:a 276:< 275:> 258:b"},
      {"a = b", "258:a 291:= 258:b !"},
      {"a => b", "258:a 291:= 275:> 258:b !"},
      {"x^2", "258:x 291:^ 259:2 !"},
      {"1e 1e+ 1.2.3 1. 1.e3 .5",
       "259:1 258:e 259:1 258:e 262:+ 260:1.2 291:. 259:3 260:1. 261:1.e3 291:. 259:5 !"},
      {"12 1.5 1E-3 2e+10", "259:12 260:1.5 261:1E-3 261:2e+10"},
      {"::= ::+ ::- ::* ::/", "285:::= 286:::+ 287:::- 288:::* 289:::/"},
      {"::", "291:: 291:: !"},
      {"$a $ a", "290:$ 258:a 290:$ 258:a"},
      {"EXCEEDANCE_FREQUENCY", "291:EXCEEDANCE_FREQUENCY !"},
      {"Exceedance_Frequency", "258:Exceedance_Frequency"},
      {"a // b", "258:a 265:/ 265:/ 258:b"},
      {"a /* x * y / \n */ b", "258:a 258:b"},
      {"a \xC3\xA9 b", "258:a 291:\xC3 291:\xA9 258:b !"},
      {"\v", "291:\v !"},
  };
  for (const Row& row : rows) EXPECT_EQ(Scanned(row.text), row.tokens) << row.text;
}

TEST_F(Scanner, TellsWhereTokensStand) {
  std::vector<ExpressionToken> tokens;
  ASSERT_TRUE(ScanExpressionTokens("/* a */ b", tokens));
  ASSERT_EQ(tokens.size(), 1U);
  EXPECT_EQ(tokens[0].firstOffset, 8);
  EXPECT_EQ(tokens[0].lastOffset, 8);

  ASSERT_TRUE(ScanExpressionTokens("ab +\n  cde", tokens));
  ASSERT_EQ(tokens.size(), 3U);
  EXPECT_EQ(tokens[2].line, 1);
  EXPECT_EQ(tokens[2].firstColumn, 2);
  EXPECT_EQ(tokens[2].lastColumn, 4);
  EXPECT_EQ(tokens[2].firstOffset, 7);

  // Line feeds inside comments count for nobody.
  ASSERT_TRUE(ScanExpressionTokens("/* 1\n2 */ b", tokens));
  EXPECT_EQ(tokens[0].line, 0);
  EXPECT_EQ(tokens[0].firstColumn, 10);
}

TEST_F(Scanner, AnOpenCommentReachesIntoTheNextText) {
  EXPECT_EQ(Scanned("a /* open"), "258:a");
  EXPECT_EQ(Scanned("still */ b"), "258:b");
  EXPECT_EQ(Scanned("c"), "258:c");
}

TEST_F(Scanner, AZeroByteEndsTheText) {
  EXPECT_EQ(Scanned(std::string("a\0b", 3)), "258:a");
}

TEST_F(Scanner, HugeTokensAndCommentsScanInOnePass) {
  const std::string name(10'000'000, 'n');
  std::vector<ExpressionToken> tokens;
  EXPECT_TRUE(ScanExpressionTokens(name + "/*" + name + "*/", tokens));
  ASSERT_EQ(tokens.size(), 1U);
  EXPECT_EQ(tokens[0].text.size(), name.size());
}

TEST_F(Scanner, IdentifiersComeInTextOrderFromACleanScanOnly) {
  const std::pair<const char*, std::vector<std::string>> rows[] = {
      {"\"a + b*a\"", {"a", "b", "a"}},
      {"IF x > 1 THEN y ELSE z", {"x", "y", "z"}},
      {"a + ", {"a"}},
      {"a ^ b", {}},
      {"EXCEEDANCE_FREQUENCY(a > 1)", {}},
  };
  for (const auto& [text, names] : rows) {
    std::vector<std::string> found;
    ExtractIdentifiers(text, found);
    EXPECT_EQ(found, names) << text;
  }
}

TEST_F(Scanner, StoredQuotesAreStripped) {
  const std::pair<const char*, const char*> rows[] = {
      {"\"a+b\"", "a+b"}, {"a+b", "a+b"}, {"x\"a", "a"}, {"\"\"", ""}, {"\"a\"b\"", "a\"b"}};
  for (const auto& [stored, text] : rows) EXPECT_EQ(StripExpressionQuotes(stored), text) << stored;
}

}  // namespace
}  // namespace tessal
