// Files made from the examples with one thing missing, doubled, mistyped or foreign. Each loads, the account
// names what was wrong, and a save loses nothing of the file that neither the account nor a message names.
#include <gtest/gtest.h>

#include <algorithm>
#include <map>
#include <set>
#include <sstream>

#include "core/error_registry.h"
#include "core/template_core.h"
#include "expr/scanner.h"
#include "support/case_file.h"
#include "support/template_text.h"
#include "support/temporary_folder.h"

namespace tessal {
namespace {

using Lines = std::vector<std::string>;

Lines LinesOf(const std::string& text) {
  Lines lines;
  std::istringstream stream(text);
  for (std::string line; std::getline(stream, line);) {
    if (line.ends_with('\r')) line.pop_back();
    lines.push_back(line);
  }
  return lines;
}

std::string Joined(const Lines& lines) {
  std::string text;
  for (const std::string& line : lines) text += line + "\r\n";
  return text;
}

std::string Trimmed(const std::string& line) {
  const std::size_t start = line.find_first_not_of(' ');
  return start == std::string::npos ? "" : line.substr(start);
}

/// The keyword of a line that holds a whole value; empty for any other line.
std::string KeyOf(const std::string& line) {
  const std::string text = Trimmed(line);
  const std::size_t end = text.find(" = ");
  const bool isWhole = end != std::string::npos && std::count(text.begin(), text.end(), '\'') != 1;
  return isWhole && text.find_first_of("'|[/") >= end ? text.substr(0, end) : "";
}

/// One broken file: what was done to which line, and the lines.
struct Broken {
  std::string what;
  Lines lines;
};

/// The index of the line that closes the section of a head, by their indentation.
std::size_t EndOfSection(const Lines& lines, std::size_t head) {
  const std::size_t indent = lines[head].find('[');
  std::size_t end = head + 1;
  while (!(lines[end].find("EndSect") == indent)) ++end;
  return end;
}

/// Leaves each keyword of each kind of section out, breaks it in one of four ways by turns, and leaves each
/// kind of section out; what was done before is not done again.
std::vector<Broken> BreakEach(const Lines& lines, std::set<std::string>& done) {
  std::vector<Broken> files;
  Lines path;
  for (std::size_t at = 0; at < lines.size(); ++at) {
    const std::string text = Trimmed(lines[at]);
    if (text.starts_with("[")) {
      std::string section = text.substr(1, text.find(']') - 1);
      while (!section.empty() && (std::isdigit(section.back()) != 0 || section.back() == '_'))
        section.pop_back();
      path.push_back(section);
      if (path.size() > 1 && done.insert("[" + path[path.size() - 2] + "/" + section).second) {
        Broken out{"without [" + section + "]", lines};
        out.lines.erase(out.lines.begin() + static_cast<std::ptrdiff_t>(at),
                        out.lines.begin() + static_cast<std::ptrdiff_t>(EndOfSection(lines, at) + 1));
        files.push_back(out);
      }
    } else if (text.starts_with("EndSect")) {
      path.pop_back();
    }
    const std::string key = KeyOf(lines[at]);
    if (key.empty() || path.empty() || !done.insert(path.back() + "/" + key).second) continue;
    const std::string place = path.back() + "/" + key;
    const auto broken = [&](const std::string& what, const Lines& instead) {
      Broken file{what + " " + place, lines};
      const auto hit = file.lines.erase(file.lines.begin() + static_cast<std::ptrdiff_t>(at));
      file.lines.insert(hit, instead.begin(), instead.end());
      files.push_back(file);
    };
    const std::string& line = lines[at];
    broken("without", {});
    switch (done.size() % 4) {
      case 0:
        broken("doubled", {line, line.substr(0, line.find('=')) + "= 'again'"});
        break;
      case 1:
        broken("mistyped", {line.substr(0, line.find('=')) + "= |mistyped|"});
        break;
      case 2:
        broken("with a foreign key in", {line, "FOREIGN = 'kept?' // remark"});
        break;
      default:
        broken("renamed", {"X" + Trimmed(line)});
        break;
    }
  }
  return files;
}

/// Lines whose values follow from the rest of a template.
bool IsDerived(const std::string& key) {
  static const std::set<std::string> kDerived = {
      "ID",        "ITEMS",  "ITEMCOUNT",         "GROUPS",         "LEVELS", "LOOKFOR", "VARIABLE_ID",
      "SPECIE_ID", "SPECIE", "DOCUMENT_REVISION", "EXPRESSION_TYPE"};
  return key.empty() || kDerived.contains(key);
}

/// A line without quotes: a text keeps its value in either kind.
std::string Bare(const std::string& line) {
  std::string bare = Trimmed(line);
  std::erase_if(bare, [](char each) { return each == '\'' || each == '|' || each == '"'; });
  return bare;
}

/// The keywords of the lines that a save has lost or changed.
std::set<std::string> LostKeys(const Lines& before, const Lines& after) {
  std::map<std::string, int> counts;
  for (const std::string& line : after) ++counts[Bare(line)];
  std::set<std::string> lost;
  for (const std::string& line : before) {
    const std::string key = KeyOf(line);
    if (!IsDerived(key) && --counts[Bare(line)] < 0) lost.insert(key);
  }
  return lost;
}

TEST(BrokenFiles, AreAccountedForAndLoseNothingUnnamed) {
  constexpr std::size_t kFewest = 200;
  const test::TemporaryFolder folder;
  std::string listing;
  std::set<std::string> done;
  std::size_t tried = 0;
  for (const char* example : {"streeter_phelps", "fish_larvae", "lake_management"}) {
    const std::string path = folder.Write(
        "m.tessal", test::ReadFile(std::string(TESSAL_SOURCE_DIR "/examples/") + example + ".tessal"));
    TemplateCore core;
    ASSERT_TRUE(core.LoadWrapper(path) && core.SaveWrapper(path));
    for (const Broken& file : BreakEach(LinesOf(test::ReadFile(path)), done)) {
      ++tried;
      ResetExpressionScanner();
      const std::string name = std::string(example) + " " + file.what;
      listing += name + "\n";
      const std::string broken = folder.Write("broken.tessal", Joined(file.lines));
      if (!core.LoadWrapper(broken)) {
        listing += "  not loaded\n";
        continue;
      }
      std::string named;
      for (const AccountEntry& entry : core.Account().Entries()) named += "  " + entry.text + "\n";
      listing += named;
      const bool saved = core.SaveWrapper(broken);
      if (!saved) {
        listing += "  not saved\n";
        EXPECT_EQ(test::ReadFile(broken), Joined(file.lines)) << name;
        continue;
      }
      // Groups are named as a whole.
      if (named.find("visibility groups were not read") != std::string::npos) continue;
      for (const std::string& key : LostKeys(file.lines, LinesOf(test::ReadFile(broken)))) {
        EXPECT_NE(named.find(key), std::string::npos) << name << ": " << key << " is lost\n" << named;
      }
    }
  }
  EXPECT_GE(tried, kFewest);
  test::ExpectListing("core/broken_files.txt", listing);
}

}  // namespace
}  // namespace tessal
