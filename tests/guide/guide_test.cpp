// The pages of the guide and of the help, as they were built: nothing that they point to is missing.
#include <gtest/gtest.h>

#include <filesystem>
#include <map>
#include <regex>
#include <set>

#include "guide/chapter_page.h"
#include "support/temporary_folder.h"

namespace tessal::test {
namespace {

namespace fs = std::filesystem;

const fs::path kProject = TESSAL_SOURCE_DIR;
const fs::path kPages = TESSAL_PAGES;

std::vector<fs::path> FilesIn(const fs::path& folder, const std::string& ending) {
  std::vector<fs::path> files;
  for (const auto& entry : fs::directory_iterator(folder))
    if (entry.path().extension() == ending) files.push_back(entry.path());
  return files;
}

std::set<std::string> ValuesOf(const std::string& attribute, const std::string& html) {
  std::set<std::string> values;
  const std::regex pattern(" " + attribute + "=\"([^\"]*)\"");
  for (std::sregex_iterator hit(html.begin(), html.end(), pattern), end; hit != end; ++hit)
    values.insert((*hit)[1]);
  return values;
}

/// What a link of a page leads to: a help page lies beside the programs, the examples with the project.
fs::path Target(const fs::path& page, const std::string& path) {
  if (path.empty()) return page;
  const fs::path target = (page.parent_path() / path).lexically_normal();
  const fs::path below = target.lexically_relative(kPages);
  return *below.begin() == "examples" ? kProject / below : target;
}

TEST(Guide, PointsToNothingThatIsMissing) {
  std::vector<fs::path> pages = FilesIn(kPages / "guide", ".html");
  EXPECT_GT(pages.size(), 1U);
  for (const fs::path& page : FilesIn(kPages, ".html")) pages.push_back(page);
  std::map<fs::path, std::set<std::string>> anchors;
  for (const fs::path& page : pages) anchors[page] = ValuesOf("id", ReadFile(page.string()));
  for (const fs::path& page : pages) {
    const std::string html = ReadFile(page.string());
    for (const std::string& picture : ValuesOf("src", html))
      EXPECT_TRUE(fs::exists(Target(page, picture))) << page << " shows " << picture;
    for (const std::string& link : ValuesOf("href", html)) {
      if (link.find("://") != std::string::npos) continue;
      const std::size_t fragment = std::min(link.find('#'), link.size());
      const fs::path target = Target(page, link.substr(0, fragment));
      EXPECT_TRUE(fs::exists(target)) << page << " links to " << link;
      if (fragment == link.size()) continue;
      EXPECT_TRUE(anchors[target].contains(link.substr(fragment + 1))) << page << " links to " << link;
    }
  }
}

TEST(Guide, HasEachChapterInItsIndex) {
  const auto index =
      guide::PageFromMarkdown(ReadFile((kProject / "docs/guide/index.md").string()), "docs/guide/index.md");
  const std::vector<std::string> chapters = guide::ChaptersIn(index);
  std::set<std::string> listed(chapters.begin(), chapters.end());
  listed.insert("index");
  std::set<std::string> present;
  for (const fs::path& file : FilesIn(kProject / "docs/guide", ".md")) present.insert(file.stem().string());
  EXPECT_EQ(listed, present);
}

TEST(Guide, ShowsNoPictureThatTheScriptDoesNotMake) {
  const std::string script = ReadFile((kProject / "docs/pictures.txt").string());
  for (const std::string folder : {"docs/pictures", "docs/help/pictures", "docs/guide/pictures"}) {
    const std::vector<fs::path> pictures = FilesIn(kProject / folder, ".png");
    EXPECT_FALSE(pictures.empty()) << folder;
    for (const fs::path& picture : pictures) {
      const std::string name = folder + "/" + picture.filename().string();
      EXPECT_NE(script.find(" " + name), std::string::npos) << name;
    }
  }
}

TEST(Guide, MarksHeadingsAndFollowsDocumentsToTheirPages) {
  const auto page = guide::PageFromMarkdown(
      "# A `B`, and *C*_d\n[1](scopes.md#the-table) [2](../functions.md#abs) "
      "[3](../help/TessalOnline.html#131180) "
      "[4](#here) [5](https://example.org/x.md) [6](../../examples/asm1.tessal) [7](../analysis.md)\n\n<b>\n",
      "docs/guide/first.md");
  EXPECT_EQ(page.title, "A B, and C_d");
  EXPECT_EQ(ValuesOf("id", page.body), std::set<std::string>{"a-b-and-c_d"});
  const std::set<std::string> expected{"scopes.html#the-table",
                                       "../Functions.html#ABS",
                                       "../TessalOnline.html#131180",
                                       "#here",
                                       "https://example.org/x.md",
                                       "../examples/asm1.tessal",
                                       "../analysis.html"};
  EXPECT_EQ(ValuesOf("href", page.body), expected);
  EXPECT_NE(page.body.find("&lt;b&gt;"), std::string::npos) << "a chapter holds no HTML of its own";
}

}  // namespace
}  // namespace tessal::test
