// The laws of a merge, over random edits of random templates.
#include "core/merge.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <iterator>
#include <random>
#include <set>
#include <sstream>

#include "core/comparison.h"
#include "core/loaded_template.h"
#include "core/pools.h"
#include "expr/scanner.h"
#include "support/random_edits.h"
#include "support/template_content.h"
#include "support/template_text.h"

namespace tessal {
namespace {

using test::LoadedTemplate;

std::string TextOf(TemplateCore& core) {
  std::string reason;
  return core.CopyText(reason).value_or("");
}

/// The text of a template after some random edits; that of the same one when a file cannot hold the result.
std::string Edited(const std::string& text, unsigned seed, int edits) {
  LoadedTemplate loaded(text);
  std::mt19937 generator(seed);
  std::vector<std::uint8_t> bytes(static_cast<std::size_t>(edits) * 8);
  std::generate(bytes.begin(), bytes.end(), [&generator] { return static_cast<std::uint8_t>(generator()); });
  fuzz::Choices choices(bytes.data(), bytes.size());
  for (int edit = 0; edit < edits; ++edit) test::EditAtRandom(*loaded, choices);
  (*loaded).RebuildSymbolTable();
  const std::string result = TextOf(*loaded);
  LoadedTemplate again(result.empty() ? text : result);
  return TextOf(*again);
}

struct Merged {
  std::string text;
  std::vector<MergeConflict> conflicts;
};

Merged Merge(const std::string& base, const std::string& ours, const std::string& theirs) {
  LoadedTemplate baseCore(base);
  LoadedTemplate theirsCore(theirs);
  LoadedTemplate oursCore(ours);
  ResetExpressionScanner();
  Merged merged;
  merged.conflicts = (*oursCore).Merge(*baseCore, *theirsCore);
  merged.text = TextOf(*oursCore);
  return merged;
}

std::string Listed(const std::vector<MergeConflict>& conflicts) {
  std::string text;
  for (const MergeConflict& each : conflicts)
    text += each.kind + " " + each.symbol + " " + each.field + ": " + each.ours + " | " + each.theirs + "\n";
  return text;
}

/// The text without the count of saves, which becomes the higher one.
std::string WithoutRevision(std::string text) {
  const std::size_t start = text.find("DOCUMENT_REVISION");
  return start == std::string::npos ? text : text.erase(start, text.find('\r', start) - start);
}

/// What differs, a line each. Where additions of both sides meet, either may come first, and so with pools,
/// which are listed one by one.
std::set<std::string> Differences(const std::string& former, const std::string& later, bool withPlaces) {
  LoadedTemplate formerCore(former);
  LoadedTemplate laterCore(later);
  std::set<std::string> lines;
  for (const SymbolChange& change : CompareBySymbol(*formerCore, *laterCore)) {
    if (!withPlaces && change.symbol == "TESSAL_POOLS") continue;
    const std::string item =
        std::to_string(static_cast<int>(change.change)) + " " + change.kind + " " + change.symbol;
    if (change.fields.empty()) lines.insert(item);
    for (const FieldChange& field : change.fields) {
      if (withPlaces || field.field != "Comes after")
        lines.insert(item + " " + field.field + ": " + field.after);
    }
  }
  const std::vector<Pool> known = PoolsOf(*formerCore).pools;
  for (const Pool& pool : PoolsOf(*laterCore).pools) {
    if (std::find(known.begin(), known.end(), pool) == known.end())
      lines.insert("pool " + pool.name + ": " + pool.expression);
  }
  return lines;
}

std::string Joined(const std::set<std::string>& lines) {
  std::string text;
  for (const std::string& line : lines) text += line + "\n";
  return text;
}

/// All that the file holds but the numbers of classes, which follow from places.
std::string Content(const std::string& text) {
  LoadedTemplate loaded(text);
  std::istringstream lines(test::TemplateContent(*loaded));
  std::string content;
  for (std::string line; std::getline(lines, line);) {
    if (!line.starts_with("Specie ID=")) content += line + "\n";
  }
  return content;
}

constexpr unsigned kSeeds = 60;

TEST(Merge, TakesWhatOneSideAloneChanged) {
  for (unsigned seed = 1; seed <= kSeeds; ++seed) {
    const std::string base = Edited(test::RandomTemplate(seed, 15), seed + 5000, 6);
    const std::string edited = Edited(base, seed, 1 + static_cast<int>(seed % 12));
    const Merged theirs = Merge(base, base, edited);
    EXPECT_EQ(Listed(theirs.conflicts), "") << "seed " << seed;
    EXPECT_EQ(Joined(Differences(edited, theirs.text, true)), "") << "seed " << seed;
    EXPECT_TRUE(Content(theirs.text) == Content(edited)) << "seed " << seed;
    for (const std::string& other : {base, edited}) {
      const Merged ours = Merge(base, edited, other);
      EXPECT_EQ(Listed(ours.conflicts), "") << "seed " << seed;
      EXPECT_EQ(WithoutRevision(ours.text), WithoutRevision(edited)) << "seed " << seed;
    }
    if (HasFailure()) break;
  }
}

bool Includes(const std::set<std::string>& all, const std::set<std::string>& part) {
  return std::includes(all.begin(), all.end(), part.begin(), part.end());
}

TEST(Merge, OfEditsThatDoNotMeetHasBothWhicheverSideIsOurs) {
  unsigned merged = 0;
  for (unsigned seed = 1; seed <= kSeeds; ++seed) {
    const std::string base = test::RandomTemplate(seed, 40);
    const std::string ours = Edited(base, seed, 3);
    const std::string theirs = Edited(base, seed + 1000, 3);
    const Merged one = Merge(base, ours, theirs);
    const Merged other = Merge(base, theirs, ours);
    EXPECT_EQ(one.conflicts.empty(), other.conflicts.empty()) << "seed " << seed << "\n"
                                                              << Listed(one.conflicts) << "--\n"
                                                              << Listed(other.conflicts);
    if (!one.conflicts.empty()) continue;
    ++merged;
    EXPECT_EQ(Joined(Differences(one.text, other.text, false)), "") << "seed " << seed;
    const auto ourChanges = Differences(base, ours, false);
    const auto theirChanges = Differences(base, theirs, false);
    const auto inMerged = Differences(base, one.text, false);
    // A new name shows in the fields of its users.
    const auto isRename = [](const std::string& line) { return line.starts_with("3"); };
    if (std::any_of(inMerged.begin(), inMerged.end(), isRename)) continue;
    EXPECT_TRUE(Includes(inMerged, ourChanges)) << "seed " << seed << "\n"
                                                << Joined(ourChanges) << "--\n"
                                                << Joined(inMerged);
    EXPECT_TRUE(Includes(inMerged, theirChanges)) << "seed " << seed << "\n"
                                                  << Joined(theirChanges) << "--\n"
                                                  << Joined(inMerged);
    if (HasFailure()) break;
  }
  EXPECT_GT(merged, kSeeds / 3);
}

}  // namespace
}  // namespace tessal
