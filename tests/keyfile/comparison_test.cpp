#include <gtest/gtest.h>

#include <regex>
#include <sstream>

#include "keyfile/item_tree.h"
#include "keyfile/reader.h"

namespace tessal {
namespace {

std::string Compared(const std::string& left, const std::string& right, const IgnoredNames* ignored = nullptr,
                     bool onlyKeywords = false) {
  CKvfSectionItem first;
  CKvfSectionItem second;
  EXPECT_EQ(ParseKeyFileTree("\n[T]\n" + left + "EndSect\n", first), 1) << KeyFileFailureText();
  EXPECT_EQ(ParseKeyFileTree("\n[T]\n" + right + "EndSect\n", second), 1) << KeyFileFailureText();
  std::ostringstream report;
  const bool same = first.Compare(second, &report, ignored, onlyKeywords);
  return (same ? "same: " : "different: ") + report.str();
}

constexpr const char* kNone = "No differences detected!\n";

TEST(Comparison, TellsRealDifferencesAndWhatLacksAPartnerBesideThem) {
  EXPECT_EQ(Compared("A = 1\n", "A = 1 // remark\n// more\n"), std::string("same: ") + kNone);
  // What only one side has makes no difference by itself.
  EXPECT_EQ(Compared("A = 1\n", "A = 1\nB = 2\n[S]\nEndSect\n"), std::string("same: ") + kNone);
  EXPECT_EQ(Compared("A = 1\nC = 1\n", "A = 2\nB = 2\n"),
            "different: Section .T is different (line 1)\nKeyword .T.A is different (line 3)\n"
            "Keyword .T.C is missing\nKeyword .T.B is extra\n");
  EXPECT_EQ(Compared("A = 1\n", "A = 1.0\n").substr(0, 10), "different:");
  EXPECT_EQ(Compared("A = 1\n[S]\nB = 1\nEndSect\n", "A = 1\n[S]\nB = 2\nEndSect\n", nullptr, true),
            "different: List ony keyword differences\nKeyword .T.S.B is different (line 5)\n");
}

TEST(Comparison, IgnoresNamesByExpression) {
  const IgnoredNames ignored = {"^A", "DATE$"};
  EXPECT_EQ(Compared("ABC = 1\nX_DATE = 1\n", "ABC = 2\nX_DATE = 2\n", &ignored),
            std::string("same: Ignored names : DATE$, ^A\n") + kNone);
  const IgnoredNames section = {"S"};
  EXPECT_EQ(Compared("[S]\nB = 1\nEndSect\n", "[S]\nB = 2\nEndSect\n", &section),
            std::string("same: Ignored names : S\n") + kNone);
  const IgnoredNames faulty = {"["};
  EXPECT_THROW(Compared("A = 1\n", "A = 1\n", &faulty), std::regex_error);
}

TEST(Comparison, DoesNotStopAtTheFirstPartner) {
  EXPECT_EQ(Compared("A = 1\n", "A = 1\nA = 2\n"),
            "different: Section .T is different (line 1)\nKeyword .T.A is different (line 3)\n");
  // The first of a name takes all partners; the next one finds none left.
  EXPECT_EQ(Compared("A = 1\nA = 2\n", "A = 1\nA = 2\n"),
            "different: Section .T is different (line 1)\nKeyword .T.A is different (line 3)\n"
            "Keyword .T.A is missing\n");
  EXPECT_EQ(Compared("A = 1\nA = 2\n", "A = 1\n"), std::string("same: ") + kNone);
}

TEST(Comparison, EndsForExpressionsThatHaveTooManyWays) {
  const std::string longest = std::string(1000, 'a') + " = 1\n";
  const IgnoredNames backtracking = {"(a+)+b"};
  EXPECT_EQ(Compared(longest, longest, &backtracking), std::string("same: Ignored names : (a+)+b\n") + kNone);
  const IgnoredNames repeated = {"^(.)\\1$"};
  EXPECT_EQ(Compared("AA = 1\n", "AA = 2\n", &repeated).substr(0, 5), "same:");
  const IgnoredNames longer = {std::string(kLongestIgnoredName + 1, 'a')};
  EXPECT_THROW(Compared("A = 1\n", "A = 1\n", &longer), std::regex_error);
}

TEST(Comparison, KeywordsTellTheirOwnDifference) {
  const auto key = [](std::vector<KvfValue> values, const char* name = "K") {
    CKvfKeyItem item;
    item.name = name;
    item.values = std::move(values);
    return item;
  };
  const auto compare = [](CKvfKeyItem left, CKvfKeyItem right) {
    std::ostringstream report;
    left.Compare(right, &report, nullptr, false);
    return report.str();
  };
  EXPECT_EQ(compare(key({KvfValue::Integer(1)}), key({KvfValue::Integer(1)})), "K matches\n");
  EXPECT_EQ(compare(key({KvfValue::Integer(1)}), key({KvfValue::Integer(2)})), "K Value #1 is different\n");
  EXPECT_EQ(compare(key({KvfValue::Integer(1)}), key({})), "K different value count\n");
  EXPECT_EQ(compare(key({}), key({})), "");
  EXPECT_EQ(compare(key({}), key({}, "L")), "Different key names K<>L\n");
}

}  // namespace
}  // namespace tessal
