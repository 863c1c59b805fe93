// The manual pages, the completions and the syntax definitions, as the programs that read them take them.
// What is not installed is passed over, and says so.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <array>
#include <cstdio>
#include <filesystem>
#include <nlohmann/json.hpp>
#include <regex>
#include <set>
#include <sstream>

#include "elements/format_words.h"
#include "expr/builtin_catalogue.h"
#include "expr/expression_tree.h"
#include "expr/function_catalogue.h"
#include "expr/parser.h"
#include "expr/scanner.h"
#include "expr/sign_reference.h"
#include "manual/option_tree.h"
#include "manual/roff.h"
#include "support/case_file.h"
#include "support/temporary_folder.h"

namespace tessal::manual {
namespace {

using test::ReadFile;
using test::TemporaryFolder;

const std::string kManual = TESSAL_MANUAL_FOLDER;
const std::string kCases = TESSAL_SOURCE_DIR "/tests/manual/";
constexpr const char* kPages[] = {"tessal.1", "tessal-editor.1", "tessal-template.5", "tessal-expressions.7"};

/// What a command prints, both streams together.
std::string OutputOf(const std::string& command) {
  std::string output;
  std::FILE* pipe = popen((command + " 2>&1 </dev/null").c_str(), "r");
  std::array<char, 4096> buffer;
  while (const std::size_t size = std::fread(buffer.data(), 1, buffer.size(), pipe)) {
    output.append(buffer.data(), size);
  }
  pclose(pipe);
  return output;
}

bool IsInstalled(const std::string& program) {
  return !OutputOf("command -v " + program).empty();
}

#define SKIP_WITHOUT(program) \
  if (!IsInstalled(program)) GTEST_SKIP() << (program) << " is not installed"

TEST(Signs, OfEveryTokenAreExplainedByExpressionsThatParse) {
  std::set<TokenCode> explained;
  for (const SignGroup& group : SignGroups()) {
    for (const SignReference& row : group.signs) {
      std::vector<ExpressionToken> signs;
      std::vector<ExpressionToken> example;
      ScanExpressionTokens(row.sign, signs);
      ScanExpressionTokens(row.example, example);
      ASSERT_EQ(signs.size(), 1U) << row.sign;
      explained.insert(signs[0].code);
      EXPECT_NE(ParseExpression(row.example)->Tree(), nullptr) << row.example;
      EXPECT_TRUE(std::any_of(example.begin(), example.end(), [&](const ExpressionToken& token) {
        return token.text == row.sign;
      })) << row.example;
    }
  }
  for (auto code = TokenCode::AddOpPlus; code <= TokenCode::ExceedanceFrequency;
       code = TokenCode{static_cast<std::int32_t>(code) + 1}) {
    EXPECT_TRUE(explained.contains(code)) << TokenName(code);
  }
}

/// A page as people read it, without line breaks.
std::string Rendered(const std::string& page) {
  std::string text = OutputOf("groff -man -Tascii -P-cbou -rLL=500n '" + kManual + "/" + page + "'");
  return std::regex_replace(text, std::regex(R"(\s+)"), " ");
}

TEST(Pages, AreReadWithoutAWarning) {
  SKIP_WITHOUT("groff");
  for (const std::string page : kPages) {
    EXPECT_EQ(OutputOf("groff -man -ww -z -Tutf8 '" + kManual + "/" + page + "'"), "") << page;
    if (IsInstalled("mandoc")) {
      EXPECT_EQ(OutputOf("mandoc -Tlint '" + kManual + "/" + page + "'"), "") << page;
    }
  }
}

TEST(Pages, ShowSignsOfRoffAsTheyAre) {
  SKIP_WITHOUT("groff");
  const TemporaryFolder folder;
  const std::string text = R"(.TH 'a' \fB \n ^~`"-x" -- a-b 2-1 µ °)";
  ManualPage page({"x", 1, "y", "z"}, "1", "2");
  page.Section("s");
  page.Paragraph(Prose(text));
  page.Item(Typed(text), Prose(text));
  page.Lines(text);
  const std::string shown =
      OutputOf("groff -man -ww -Tutf8 -P-cbou -rLL=200n '" + folder.Write("x.1", page.Text()) + "'");
  // Where a system shows hyphens as they are in print, they are not the sign that was typed.
  const std::string plain = std::regex_replace(shown, std::regex("\u2010"), "-");
  std::size_t count = 0;
  for (std::size_t place = plain.find(text); place != std::string::npos; place = plain.find(text, place + 1))
    ++count;
  EXPECT_EQ(count, 4U) << shown;
}

TEST(Pages, NameAllThatThereIs) {
  SKIP_WITHOUT("groff");
  const std::string tool = Rendered("tessal.1");
  ForEachCommand(ToolTree(), [&tool](const Command& command) {
    if (!command.commands.empty()) return;
    const std::size_t start = tool.find(" " + command.path + " ");
    ASSERT_NE(start, std::string::npos) << command.path;
    for (const CallPart& option : command.options) {
      if (option.names.back() == "--help") continue;
      EXPECT_NE(tool.find(" " + option.names.back() + " ", start), std::string::npos)
          << command.path << option.names.back();
    }
  });
  const std::string format = Rendered("tessal-template.5");
  for (const SectionWord& section : SectionWords()) {
    const std::string name = "[" + std::string(section.name) + (section.IsNumbered() ? "N" : "") + "] ";
    EXPECT_NE(format.find(name + std::string(section.meaning)), std::string::npos) << name;
  }
  const std::string expressions = Rendered("tessal-expressions.7");
  InitCatalogues();
  for (const CatalogueFunction& function : Functions()) {
    EXPECT_NE(expressions.find(" " + function.name + "("), std::string::npos) << function.name;
  }
  ReleaseCatalogues();
  for (const CatalogueBuiltin& builtin : Builtins()) {
    EXPECT_NE(expressions.find(" " + std::string(builtin.name) + " "), std::string::npos) << builtin.name;
  }
}

struct Shell {
  const char* name;
  const char* call;
  const char* completion;
};

class Completions : public testing::TestWithParam<Shell> {};

TEST_P(Completions, OfferWhatTheCallHasAPlaceFor) {
  const Shell& shell = GetParam();
  SKIP_WITHOUT(shell.name);
  TemporaryFolder folder;
  for (const char* file : {"one.tessal", "two.tessal", "notes.txt"}) folder.Write(file, "");
  const std::string expected = ReadFile(kCases + "cases/offers.txt");
  std::string call = "cd '" + folder.Path().string() + "' && HOME='" + folder.Path().string() + "' " +
                     shell.call + " '" + kCases + "offers." + shell.name + "' '" + kManual + "/" +
                     shell.completion + "'";
  std::istringstream lines(expected);
  for (std::string line; std::getline(lines, line);) call += " '" + line.substr(0, line.find(':')) + "'";
  std::string offered = OutputOf(call);
  // Fish offers other files too, after the templates.
  if (std::string(shell.name) == "fish")
    offered = std::regex_replace(offered, std::regex("(check|find) : notes.txt one"), "$1 : one");
  EXPECT_EQ(std::regex_replace(offered, std::regex(": *\n"), ":\n"), expected);
}

INSTANTIATE_TEST_SUITE_P(Shells, Completions,
                         testing::Values(Shell{"bash", "bash --norc", "bash/tessal"},
                                         Shell{"zsh", "zsh -f", "zsh"},
                                         Shell{"fish", "fish --no-config", "fish/tessal.fish"}),
                         [](const auto& each) { return std::string(each.param.name); });

TEST(Syntax, IsWhatVimShows) {
  SKIP_WITHOUT("vim");
  TemporaryFolder folder;
  std::string script = "syntax on\nset rtp+=" + kManual + "/vim\nruntime ftdetect/tessal.vim\nedit " +
                       kCases + "cases/sample.tessal\nlet out = []\n";
  const std::string expected = ReadFile(kCases + "cases/vim.txt");
  std::istringstream lines(expected);
  const std::regex form(R"((.*) (\d+) (\w+))");
  for (std::string line; std::getline(lines, line);) {
    std::smatch parts;
    ASSERT_TRUE(std::regex_match(line, parts, form)) << line;
    script += "call cursor(1, 1)\nlet [l, c] = searchpos('\\V" + parts.str(1) + "', 'c')\ncall add(out, '" +
              parts.str(1) + " " + parts.str(2) + " ' . synIDattr(synID(l, c - 1 + " + parts.str(2) +
              ", 1), 'name'))\n";
  }
  script += "call writefile(out, '" + folder.File("out") + "')\nqa!\n";
  OutputOf("vim -es -u NONE -N -S '" + folder.Write("script.vim", script) + "'");
  EXPECT_EQ(ReadFile(folder.File("out")), expected);
}

TEST(Syntax, IsWhatKateShows) {
  SKIP_WITHOUT("kate-syntax-highlighter");
  TemporaryFolder folder;
  const std::string data = folder.Path() / "org.kde.syntax-highlighting/syntax";
  std::filesystem::create_directories(data);
  std::filesystem::copy(kManual + "/kate/tessal.xml", data);
  const std::string shown =
      OutputOf("XDG_DATA_HOME='" + folder.Path().string() +
               "' QT_QPA_PLATFORM=offscreen kate-syntax-highlighter -s 'Tessal Template' '" + kCases +
               "cases/sample.tessal'");
  // Colours are the theme's: what counts is which parts look the same.
  const std::regex span("<span style=\"([^\"]*)\">");
  std::vector<std::string> looks;
  std::string text = shown.substr(shown.find("<pre>"));
  for (std::smatch found; std::regex_search(text, found, span);) {
    auto look = std::find(looks.begin(), looks.end(), found.str(1));
    if (look == looks.end()) look = looks.insert(looks.end(), found.str(1));
    text = found.prefix().str() + "<" + std::to_string(look - looks.begin()) + ">" + found.suffix().str();
  }
  test::ExpectListing("manual/cases/kate.txt", std::regex_replace(text, std::regex("</span>"), "</>"));
}

TEST(Syntax, OfTextMateIsMadeOfGoodPatterns) {
  const nlohmann::json grammar =
      nlohmann::json::parse(ReadFile(kManual + "/textmate/tessal.tmLanguage.json"));
  const std::string sample = ReadFile(kCases + "cases/sample.tessal");
  int patterns = 0;
  for (const nlohmann::json& each : grammar.flatten()) {
    const std::string text = each.is_string() ? each.get<std::string>() : "";
    if (text.find('\\') == std::string::npos) continue;
    // The one thing that this library does not know is how to leave the case alone within a pattern.
    const std::string pattern = text.starts_with("(?i)") ? text.substr(4) : text;
    const auto options = std::regex::ECMAScript | std::regex::multiline |
                         (pattern == text ? std::regex::flag_type{} : std::regex::icase);
    EXPECT_TRUE(std::regex_search(sample, std::regex(pattern, options))) << text;
    ++patterns;
  }
  EXPECT_GT(patterns, 10);
}

const std::string kPackaging = TESSAL_SOURCE_DIR "/packaging/";

TEST(Desktop, TakesTheEntryAndTheDescription) {
  SKIP_WITHOUT("desktop-file-validate");
  EXPECT_EQ(OutputOf("desktop-file-validate '" + kPackaging + "tessal-editor.desktop'"), "");
  SKIP_WITHOUT("appstreamcli");
  // As the build fills it in.
  const TemporaryFolder folder;
  const std::string description = folder.Write(
      "org.tessal.editor.metainfo.xml",
      std::regex_replace(std::regex_replace(ReadFile(kPackaging + "org.tessal.editor.metainfo.xml"),
                                            std::regex("@PROJECT_VERSION@"), "1.0.0"),
                         std::regex("@TESSAL_DATE@"), "2026-01-01"));
  const std::string said =
      OutputOf("appstreamcli validate --no-net --pedantic --no-color '" + description + "'");
  EXPECT_NE(said.find("successful"), std::string::npos) << said;
  EXPECT_EQ(said.find(": "), std::string::npos) << said;
}

TEST(Desktop, KnowsATemplateByItsContent) {
  SKIP_WITHOUT("update-mime-database");
  SKIP_WITHOUT("gio");
  const TemporaryFolder folder;
  std::filesystem::create_directories(folder.Path() / "mime/packages");
  std::filesystem::copy(kPackaging + "tessal-mime.xml", folder.Path() / "mime/packages/tessal.xml");
  const std::string home = "XDG_DATA_HOME='" + folder.Path().string() + "' ";
  EXPECT_EQ(OutputOf(home + "update-mime-database '" + folder.File("mime") + "'"), "");
  const auto typeOf = [&folder, &home](const std::string& name, const std::string& content) {
    return OutputOf(home + "gio info -a standard::content-type '" + folder.Write(name, content) + "'");
  };
  const auto isTemplate = testing::HasSubstr("application/x-tessal\n");
  EXPECT_THAT(typeOf("by_name.tessal", "anything\n"), isTemplate);
  EXPECT_THAT(typeOf("saved", ReadFile(TESSAL_SOURCE_DIR "/examples/asm1.tessal")), isTemplate);
  EXPECT_THAT(typeOf("without_head", "// of mine\n\n[TESSAL_SETUP]\n"), isTemplate);
  EXPECT_THAT(typeOf("other", "[OTHER]\nEndSect\n"), testing::Not(isTemplate));
}

}  // namespace
}  // namespace tessal::manual
