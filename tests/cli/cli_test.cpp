#include <gtest/gtest.h>
#include <unistd.h>

#include <algorithm>
#include <filesystem>
#include <nlohmann/json.hpp>

#include "cli/tool_run.h"
#include "support/template_text.h"
#include "support/temporary_folder.h"

namespace tessal {
namespace {

using nlohmann::json;
using test::ReadFile;
using test::RunShell;
using test::RunTool;
using test::TemplateText;
using test::TemporaryFolder;

TEST(Tool, AnswersCallsThatAreOffWithOneLineAndTwo) {
  const std::pair<std::vector<std::string>, const char*> rows[] = {
      {{}, "a command is required"},
      {{"nonsense"}, "unknown command 'nonsense'"},
      {{"check"}, "FILE"},
      {{"check", "--nonsense", "x"}, "--nonsense"},
      {{"check", "--format", "xml", "x"}, "xml"},
      {{"symbols", "--format", "sarif", "x"}, "sarif"},
      {{"expr", "nonsense"}, "unknown command 'nonsense'"},
      {{"expr", "parse"}, "EXPR"},
      {{"expr", "parse", "--nonsense"}, "--nonsense"},
      {{"eval", "SIN", "one"}, "number"},
      {{"call", "SIN", "1", "--set", "nonsense"}, "NAME=VALUE"},
  };
  for (const auto& [arguments, part] : rows) {
    const auto run = RunTool(arguments);
    EXPECT_EQ(run.exitCode, 2) << part;
    EXPECT_EQ(run.output, "") << part;
    EXPECT_NE(run.errors.find(part), std::string::npos) << part << ": " << run.errors;
    EXPECT_EQ(run.errors.find('\n'), run.errors.size() - 1) << run.errors;
  }
  EXPECT_EQ(RunTool({"--help"}).exitCode, 0);
  EXPECT_EQ(RunTool({"--version"}).output.substr(0, 7), "tessal ");
}

TEST(Tool, LooksAtExpressions) {
  struct Row {
    std::vector<std::string> arguments;
    const char* input;
    int exitCode;
    const char* output;
  };
  const Row rows[] = {
      {{"expr", "parse", "-1"},
       "",
       0,
       "{\"kind\":21,\"text\":\"negate\",\"children\":[{\"kind\":3,\"text\":\"1\"}]}\n"},
      {{"expr", "parse", "--", "-a"},
       "",
       0,
       "{\"kind\":21,\"text\":\"negate\",\"children\":[{\"kind\":2,\"text\":\"a\"}]}\n"},
      {{"expr", "parse", "a b"},
       "",
       1,
       "Line 1 position 3 : syntax error, unexpected IDENTIFIER, expecting $end\n"},
      {{"expr", "parse", "-"}, "a\n\n", 0, "{\"kind\":2,\"text\":\"a\"}\n"},
      {{"expr", "parse", "--lines"},
       "a\n*\nb",
       1,
       "{\"kind\":2,\"text\":\"a\"}\nLine 1 position 1 : syntax error, unexpected MUL_OP_MULTIPLY\n"
       "{\"kind\":2,\"text\":\"b\"}\n"},
      {{"expr", "tokens", "a^1"},
       "",
       1,
       "258\tIDENTIFIER\t0\t0\t0\t0\ta\n291\t-\t1\t1\t1\t1\t^\n259\tINT_NUM\t2\t2\t2\t2\t1\n"},
      {{"expr", "tokens", "\x01"}, "", 1, "291\t-\t0\t0\t0\t0\t\x01\n"},
      {{"expr", "tokens", "--lines"},
       "a+b\r\n\na /*\n*/ c ^\n",
       1,
       "258:a 262:+ 258:b\n\n258:a\n258:c 291:^ !\n"},
      {{"expr", "check", "SIN(1,2)"}, "", 1, "Wrong number of arguments for function SIN(x)!\n"},
      {{"expr", "check", "SIN(1)"}, "", 0, ""},
      {{"expr", "check", "--lines"},
       "foo(1)+bar(2)\nPI()\na+\n",
       1,
       "Unknown function 'bar' !\tUnknown function 'foo' !\n\nLine 1 position 2 : syntax error, unexpected "
       "$end\n"},
      {{"expr", "identifiers", "\"a + b*a\""}, "", 0, "a\nb\na\n"},
      {{"expr", "identifiers", "a ^ b"}, "", 0, ""},
      {{"expr", "identifiers", "--lines"}, "a+b\nc\n", 0, "a\tb\nc\n"},
      {{"expr", "rewrite", "IF a>1 THEN b ELSE c"}, "", 0, "IF((a>1),b,c)\n"},
      {{"expr", "rewrite", "a +"}, "", 1, ""},
      {{"expr", "rewrite", "--lines"},
       "YEAR+1\n(a+b)*c\n[XPOS]*2\nAge ::+ 1\nF(a,b)\n",
       0,
       "(YEAR()+1)\n(a+b)*c\n_GetProperty(XPOS)*2\n1Age\nF(a,b)\n"},
      {{"expr", "mathml", "a +"}, "", 1, ""},
  };
  for (const Row& row : rows) {
    const auto run = RunTool(row.arguments, row.input);
    EXPECT_EQ(run.output, row.output) << row.arguments[1] << " " << row.input;
    EXPECT_EQ(run.exitCode, row.exitCode) << row.arguments[1] << " " << row.input;
  }
  EXPECT_NE(
      RunTool({"expr", "mathml", "a", "--symbol", "S", "--derivative"}).output.find("<mi>d</mi><mi>S</mi>"),
      std::string::npos);
  EXPECT_EQ(
      RunShell("head -c 2000001 /dev/zero | tr '\\0' a | sed 's/aa/a*/g' | \"$T\" expr parse - | wc -c | "
               "grep -q '^[0-9]\\{8\\}$'"),
      0)
      << "a million operands";
}

TEST(Tool, AsksTheCatalogues) {
  struct Row {
    std::vector<std::string> arguments;
    int exitCode;
    const char* output;
  };
  const Row rows[] = {
      {{"functions", "arctan2"}, 0, "4\tARCTAN2\t1\t2\tx,y\n"},
      {{"functions", "nonsense"}, 1, ""},
      {{"functions", ""}, 1, ""},
      {{"eval", "abs", "-1.5"}, 0, "1.5\n"},
      {{"eval", "FLOOR", "1.5"}, 1, ""},
      {{"eval", "SIN"}, 1, ""},
      {{"call", "FLOOR", "-1.5"}, 0, "-2\n"},
      {{"call", "MAX", "1", "2"}, 0, "1\n"},
      {{"call", "F1", "1"}, 1, ""},
      {{"call", "nonsense"}, 1, ""},
      {{"call", "SIN", "1", "2"}, 1, ""},
      {{"call", "LOAD", "5", "--set", "SAVE=5,-2.5"}, 0, "0\n"},
  };
  for (const Row& row : rows) {
    const auto run = RunTool(row.arguments);
    EXPECT_EQ(run.output, row.output) << row.arguments[1];
    EXPECT_EQ(run.exitCode, row.exitCode) << row.arguments[1];
  }
  const std::string builtins = RunTool({"builtins"}).output;
  EXPECT_EQ(std::count(builtins.begin(), builtins.end(), '\n'), 73);
  EXPECT_NE(builtins.find("73\tRELATIVE_DEPTH\t2\tWS\tHORISONTAL\t()\t-1\t-1\t1e+10\t0\n"),
            std::string::npos);
}

TEST(Tool, ChecksFiles) {
  const TemporaryFolder folder;
  const std::string good = folder.Write("good.tessal", TemplateText().Constant("k").Text());
  const std::string bad = folder.Write(
      "bad.tessal",
      TemplateText().Constant("k", "-1").Auxiliary("a", "nobody").With("DESCRIPTION", "'\xE9!'").Text());
  EXPECT_EQ(RunTool({"check", good}).exitCode, 0);
  auto run = RunTool({"check", bad, folder.File("missing"), good});
  EXPECT_EQ(run.exitCode, 2);
  EXPECT_EQ(run.output,
            bad + ": Warning: k: The (default) value is lower than the minimum!\n" + bad +
                ": Warning: a: Decription, online help or documentation contain illegal characters ('!')\n" +
                bad + ": Undefined: a: Undefined symbol nobody\n" + folder.File("missing") +
                ": -FATAL-: LOAD : Can not open file " + folder.File("missing") + "\n");
  EXPECT_EQ(RunTool({"check", "--level", "3", good}).exitCode, 0);
  EXPECT_EQ(RunTool({"check", bad, "--level", "3"}).output,
            bad + ": Undefined: a: Undefined symbol nobody\n");
  EXPECT_EQ(RunTool({"check", "--level", "-1", good}).exitCode, 0);
  EXPECT_EQ(RunTool({"check", "--level", "2.5", good}).exitCode, 2);

  run = RunTool({"check", "--format", "json", bad});
  EXPECT_EQ(run.exitCode, 1);
  const json report = json::parse(run.output)["files"][0];
  EXPECT_EQ(report["path"], bad);
  EXPECT_EQ(report["loaded"], true);
  EXPECT_EQ(report["errors"][0]["kind"], 2);
  EXPECT_EQ(report["errors"][0]["word"], "Warning");
  EXPECT_EQ(report["undefined"][0]["usedBy"], json::array({"a"}));

  const json sarif = json::parse(RunTool({"check", "--format", "sarif", bad}).output);
  EXPECT_EQ(sarif["version"], "2.1.0");
  const json& results = sarif["runs"][0]["results"];
  ASSERT_EQ(results.size(), 3U);
  for (const json& result : results) {
    EXPECT_FALSE(result["message"]["text"].get<std::string>().empty());
    EXPECT_GT(result["locations"][0]["physicalLocation"]["region"]["startLine"], 1);
  }
}

TEST(Tool, TellsWhereMessagesStand) {
  const TemporaryFolder folder;
  const std::string text = TemplateText()
                               .Misc()
                               .Constant("two\nlines")
                               .Without("UNIT")
                               .Auxiliary("a", "nobody")
                               .Auxiliary("b", "nobody")
                               .Text();
  std::string marked = text;
  marked.replace(marked.find("''"), 2, "'!'");                         // the template's description
  marked.replace(marked.find("''", marked.find("[MISC]")), 2, "'!'");  // the settings'
  const std::string file = folder.Write("m.tessal", marked);
  const auto lineOf = [&text](std::string_view part) {
    const auto end = text.begin() + static_cast<std::ptrdiff_t>(text.find(part));
    return 1 + static_cast<int>(std::count(text.begin(), end, '\n'));
  };
  const json report = json::parse(RunTool({"check", "--format", "sarif", file}).output);
  std::string found;
  for (const json& result : report["runs"][0]["results"]) {
    const json& location = result["locations"][0]["physicalLocation"];
    found += std::to_string(location["region"]["startLine"].get<int>()) + " ";
  }
  std::string expected;
  for (const char* part : {"[CONSTANT_1]", "[CONSTANT_1]", "[TESSAL_SETUP]", "[MISC]",
                           "[AUXILIARY_VARIABLE_1]", "[AUXILIARY_VARIABLE_2]"}) {
    expected += std::to_string(lineOf(part)) + " ";
  }
  EXPECT_EQ(found, expected);
  const json errors = json::parse(RunTool({"check", "--format", "json", file}).output)["files"][0]["errors"];
  EXPECT_EQ(errors[2]["kind"], 21);
  EXPECT_EQ(errors[3]["kind"], 15);
  EXPECT_EQ(errors[1]["text"], "two\nlines, illegal symbol name (keyword or illegal characters used)");
  // What one file leaves open is closed before the next.
  const std::string open = folder.Write("open.tessal", TemplateText().Auxiliary("a", "1 /* open").Text());
  const std::string next = folder.Write("next.tessal", TemplateText().Auxiliary("a", "1").Text());
  EXPECT_EQ(RunTool({"check", open, next}).output.find(next), std::string::npos);
  // A text of several lines is one line for people and scripts.
  const std::string output = RunTool({"check", file}).output;
  EXPECT_EQ(std::count(output.begin(), output.end(), '\n'), 6);
}

TEST(Tool, BadFilesGiveAMessageAndEnd) {
  const TemporaryFolder folder;
  const int depth = 100'000;
  std::string nested = "\n[TESSAL_SETUP]\n";
  for (int level = 0; level < depth; ++level) nested += "[A]\n";
  for (int level = 0; level <= depth; ++level) nested += "EndSect\n";
  const std::string longText(10'000'000, 'x');
  const std::string longName(100'000, 'x');
  struct Row {
    std::string path;
    int exitCode;
    const char* part;
  };
  const Row rows[] = {
      {folder.File("missing"), 2, "Can not open file"},
      {folder.Path().string(), 2, "Can not open file"},
      {"/dev/zero", 2, "Can not open file"},
      {folder.Write("empty", ""), 1, "the file is empty"},
      {folder.Write("zeros", std::string(1000, '\0')), 1, "could not read template"},
      {folder.Write("noise", "\x7f\x1b[31m\xff\x01"), 2, "Synthax error near line 1 position 1 :   [31m"},
      {folder.Write("nested", nested), 1, "could not find key DESCRIPTION"},
      {folder.Write("open", nested.substr(0, nested.size() - 9)), 2, "Synthax error"},
      {folder.Write("long", TemplateText().Constant("k").With("UNIT", "'" + longText + "'").Text()), 0, ""},
      {folder.Write("symbol", TemplateText().Constant(longName).Text()), 0, ""},
      {folder.Write("number", TemplateText().Constant("k", "1e99999").Text()), 1, "higher than the maximum"},
      {folder.Write("token", TemplateText().Auxiliary("a", longName).Text()), 1, "token too long"},
      {folder.Write("deep", TemplateText().Auxiliary("a", std::string(20'000, '(')).Text()), 1,
       "memory exhausted"},
  };
  for (const Row& row : rows) {
    const auto run = RunTool({"check", row.path});
    EXPECT_EQ(run.exitCode, row.exitCode) << row.path << run.output.substr(0, 500);
    EXPECT_NE(run.output.find(row.part), std::string::npos) << row.path << run.output.substr(0, 500);
    EXPECT_EQ(run.errors, "") << row.path;
  }
}

TEST(Tool, EveryExampleIsCleanButTheOneWithFaults) {
  const std::filesystem::path folder = std::filesystem::path(TESSAL_SOURCE_DIR) / "examples";
  int clean = 0;
  for (const auto& entry : std::filesystem::directory_iterator(folder)) {
    if (entry.path().extension() != ".tessal") continue;
    const auto run = RunTool({"check", entry.path().string()});
    if (entry.path().stem() == "faults") {
      EXPECT_EQ(run.exitCode, 1);
      EXPECT_GT(std::count(run.output.begin(), run.output.end(), '\n'), 45);
      continue;
    }
    ++clean;
    EXPECT_EQ(run.exitCode, 0) << run.output;
    EXPECT_EQ(run.output + run.errors, "");
    // Saved, with bare line feeds, and saved again: nothing but the revision differs.
    const TemporaryFolder scratch;
    std::string text = ReadFile(entry.path().string());
    std::erase(text, '\r');
    const std::string copy = scratch.Write("copy.tessal", text);
    EXPECT_EQ(RunTool({"save", copy}).exitCode, 0);
    EXPECT_EQ(RunTool({"diff", entry.path().string(), copy, "--ignore", "^DOCUMENT_REVISION$"}).output,
              "Ignored names : ^DOCUMENT_REVISION$\nNo differences detected!\n");
    EXPECT_EQ(RunTool({"check", copy}).output, "");
    EXPECT_EQ(RunTool({"html", copy}).exitCode, 0);
    EXPECT_TRUE(std::filesystem::exists(scratch.Path() / "HTML_doc" / "copy.html"));
    EXPECT_GT(RunTool({"overview", copy}).output.size(), 100U);
  }
  EXPECT_EQ(clean, 5);
}

TEST(Tool, TellsWhyAPageCannotBeWritten) {
  const TemporaryFolder folder;
  const std::string text = TemplateText().Constant("k").Text();
  const std::string file = folder.Write("m.tessal", text);
  folder.Write("HTML_doc", "a file");
  const std::pair<std::vector<std::string>, const char*> rows[] = {
      {{"html", file}, "HTML_doc/m.html': Not a directory"},
      {{"html", file, "--output", folder.Path().string()}, "Is a directory"},
      {{"html", file, "--output", folder.File("no/page.html")}, "No such file"},
      {{"html", file, "--output", "/dev/full"}, "No space left"},
      {{"html", file, "--output", file}, "over its template"},
      {{"html", folder.File("none.tessal")}, "none.tessal"},
      {{"overview", folder.File("none.tessal")}, "none.tessal"},
  };
  for (const auto& [arguments, part] : rows) {
    const auto run = RunTool(arguments);
    EXPECT_EQ(run.exitCode, 2) << part;
    EXPECT_EQ(run.output, "") << part;
    EXPECT_NE(run.errors.find(part), std::string::npos) << part << ": " << run.errors;
  }
  EXPECT_EQ(ReadFile(file), text);
  EXPECT_EQ(ReadFile(folder.File("HTML_doc")), "a file");
  EXPECT_EQ(RunShell("\"$T\" html '" + file + "' --output /dev/stdout | grep -q '</html>'"), 0);
  if (geteuid() != 0) {
    std::filesystem::create_directory(folder.File("locked"));
    std::filesystem::permissions(folder.File("locked"), std::filesystem::perms::owner_read);
    const auto run = RunTool({"html", file, "--output", folder.File("locked/page.html")});
    EXPECT_EQ(run.exitCode, 2) << run.errors;
    std::filesystem::permissions(folder.File("locked"), std::filesystem::perms::owner_all);
  }
}

TEST(Tool, SavesMakesAndRenames) {
  const TemporaryFolder folder;
  const std::string fresh = folder.File("new.tessal");
  EXPECT_EQ(RunTool({"new", fresh}).exitCode, 0);
  EXPECT_EQ(RunTool({"new", fresh}).exitCode, 2) << "it exists";
  EXPECT_EQ(RunTool({"new", fresh, "--force"}).exitCode, 0);
  EXPECT_EQ(RunTool({"check", fresh}).exitCode, 0);
  EXPECT_EQ(RunTool({"save", folder.File("missing")}).exitCode, 2);
  EXPECT_EQ(RunTool({"save", fresh, "--output", "/nowhere/x"}).exitCode, 2);

  const auto lossy = RunTool(
      {"save", folder.Write("l.tessal", "\n[TESSAL_SETUP]\nEndSect\n// stray\n[X]\nA = 1\nEndSect\n")});
  EXPECT_EQ(lossy.exitCode, 0);
  EXPECT_NE(lossy.errors.find("not kept"), std::string::npos) << "a loss is told";

  const std::string file =
      folder.Write("m.tessal", TemplateText().Constant("k").Auxiliary("a", "k+k").Text());
  auto run = RunTool({"rename", file, "k", "sin"});
  EXPECT_EQ(run.exitCode, 1);
  EXPECT_EQ(run.output, "'sin' is invalid because it is an Tessal keyword!\n");
  EXPECT_EQ(RunTool({"rename", file, "nobody", "b"}).output, "An error occured when renaming 'b' !\n");
  EXPECT_EQ(RunTool({"rename", file, "k", "rate", "--output", folder.File("r.tessal")}).exitCode, 0);
  EXPECT_NE(ReadFile(folder.File("r.tessal")).find("\"rate+rate\""), std::string::npos);
  EXPECT_EQ(RunTool({"rename", file, "k", "rate", "--only-symbol"}).exitCode, 0);
  EXPECT_NE(ReadFile(file).find("\"k+k\""), std::string::npos);
  EXPECT_EQ(RunTool({"symbols", folder.File("r.tessal")}).output,
            "1\trate\tConstant\t1\n2\ta\tAuxiliary\trate+rate\n");
  const json table = json::parse(RunTool({"symbols", "--format", "json", folder.File("r.tessal")}).output);
  EXPECT_EQ(table[1]["references"], json::array({1}));
  EXPECT_EQ(table[0]["referencedBy"], json::array({2}));
}

TEST(Tool, TellsOfAnInputThatCannotBeRead) {
  for (const char* input : {"</", "<&-"}) {
    EXPECT_EQ(RunShell(std::string("\"$T\" expr parse - 2>/dev/null ") + input), 2) << input;
    EXPECT_EQ(RunShell(std::string("\"$T\" expr check --lines 2>&1 ") + input +
                       " | grep -q '^tessal: can not read standard input: '"),
              0)
        << input;
  }
}

TEST(Tool, ComparesKeyFiles) {
  const TemporaryFolder folder;
  const std::string left = folder.Write("a", "\n[T]\nA = 1\nEndSect\n");
  const std::string right = folder.Write("b", "\n[T]\nA = 2\nEndSect\n");
  EXPECT_EQ(RunTool({"diff", left, left}).exitCode, 0);
  EXPECT_EQ(RunTool({"diff", left, right}).exitCode, 1);
  EXPECT_EQ(RunTool({"diff", left, right, "--ignore", "^A$", "--ignore", "x"}).exitCode, 0);
  EXPECT_EQ(RunTool({"diff", left, right, "--ignore", "["}).exitCode, 2);
  EXPECT_EQ(RunTool({"diff", left, right, "--ignore", std::string(100'000, '(')}).exitCode, 2);
  EXPECT_EQ(RunTool({"diff", left, folder.File("missing")}).exitCode, 2);
  // A pipe gives its text only once, and has no size.
  EXPECT_EQ(RunShell("cat '" + left + "' | \"$T\" diff /dev/stdin '" + left + "' >/dev/null"), 0);
  EXPECT_EQ(RunTool({"tree", left}).output, "[T]\n   A = 1\nEndSect\n\n\n\n");
  const auto broken = RunTool({"tree", folder.Write("c", "[T]\n")});
  EXPECT_EQ(broken.exitCode, 1);
  EXPECT_NE(broken.errors.find("syntax error"), std::string::npos);
  EXPECT_EQ(RunTool({"tree", folder.Path().string()}).exitCode, 2);
}

TEST(Tool, EndsQuietlyAndTellsOfAFullDisk) {
  EXPECT_EQ(RunShell("\"$T\" functions 2>&1 | head -n 1 | grep -q ABS"), 0);
  EXPECT_EQ(RunShell("\"$T\" functions >/dev/full 2>/dev/null"), 2);
  EXPECT_EQ(
      RunShell(
          "test \"$(\"$T\" functions 2>&1 >/dev/full)\" = 'tessal: can not write the result: No space left "
          "on device'"),
      0);
}

}  // namespace
}  // namespace tessal
