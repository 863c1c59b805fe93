// The option file: what its words set, in which order, and what becomes of a faulty one. In the files of
// cases the input is the file's text; FOLDER in it is the folder that the file lies in.
#include <gtest/gtest.h>
#include <sys/resource.h>

#include <csignal>
#include <filesystem>
#include <sstream>

#include "expr/carbonate/options.h"
#include "expr/carbonate/settings.h"
#include "expr/carbonate/settings_log.h"
#include "support/case_file.h"
#include "support/catalogue_call.h"
#include "support/temporary_folder.h"

namespace tessal {
namespace {

namespace fs = std::filesystem;

/// The numbers of the options that differ from 1, then totals and factors that differ from their defaults.
std::string Settings() {
  const CarbonateSettings& s = Carbonate();
  std::ostringstream text;
  const auto add = [&text](const char* name, double value, double usual) {
    if (value != usual) text << (text.str().empty() ? "" : " ") << name << ' ' << value;
  };
  const auto number = [](const auto* option, const auto& options) {
    return static_cast<double>(option - options.data() + 1);
  };
  add("K1K2", number(s.carbonicAcid, kCarbonicAcidOptions), 1);
  add("KW", number(s.water, kWaterOptions), 1);
  add("KB", number(s.boricAcid, kBoricAcidOptions), 1);
  add("KS", number(s.bisulphate, kBisulphateOptions), 1);
  add("fH", number(s.activity, kActivityOptions), 1);
  add("TB", number(s.boron, kBoronOptions), 1);
  const auto addEach = [&add](const PerSpecie& values, const std::string& kind, double computed,
                              double others) {
    add((kind + "boron").c_str(), values.boron, computed);
    add((kind + "fluoride").c_str(), values.fluoride, computed);
    add((kind + "sulphate").c_str(), values.sulphate, computed);
    add((kind + "phosphate").c_str(), values.phosphate, others);
    add((kind + "silicate").c_str(), values.silicate, others);
  };
  addEach(s.totals, "total ", -1, 0);
  addEach(s.factors, "factor ", 1, 1);
  add("factor DIC", s.dicFactor, 1);
  add("factor ALK", s.alkalinityFactor, 1);
  return text.str().empty() ? "defaults\n" : text.str() + "\n";
}

std::string Replaced(std::string text, const std::string& from, const std::string& to) {
  for (std::size_t at = text.find(from); at != std::string::npos; at = text.find(from, at + to.size())) {
    text.replace(at, from.size(), to);
  }
  return text;
}

class OptionFile : public testing::Test {
 protected:
  OptionFile() { test::ResetNumbers(); }
  ~OptionFile() override { test::ResetNumbers(); }

  std::string Path(const char* name) const { return folder.File(name); }

  /// Reads the text as an option file, from the settings of a fresh process.
  void Read(const std::string& text) const {
    test::ResetNumbers();
    ReadOptionFile(folder.Write("options.set", text));
  }

  std::string Log() const { return test::ReadFile(Path("ph.log")); }

  /// Settings and problem, the folder's own path hidden.
  std::string Outcome() const {
    return Settings() + Replaced(CarbonateProblem().empty() ? "" : CarbonateProblem() + "\n",
                                 folder.Path().string(), "FOLDER");
  }

  test::TemporaryFolder folder;
};

TEST_F(OptionFile, WordsSetWhatTheyName) {
  test::RunCases("carbonate/cases/option_words.txt", [this](const test::Case& each) -> test::Answer {
    return [this, input = each.input](const test::CaseCall&) {
      return test::AnswerEach(input, [this](const std::string& line) {
        // Two signs make lines of a line.
        Read(Replaced(line, "^", "\r\n"));
        return Outcome();
      });
    };
  });
}

TEST_F(OptionFile, TheLogSaysWhatIsApplied) {
  test::RunCases("carbonate/cases/option_log.txt", [this](const test::Case& each) -> test::Answer {
    const std::string text = Replaced(each.input, "FOLDER", folder.Path().string());
    fs::remove(Path("ph.log"));
    Read(text);
    return [this](const test::CaseCall& call) {
      if (call.words == "settings") return Outcome();
      if (call.words == "log") return Replaced(Log(), folder.Path().string(), "FOLDER");
      test::Call(call.words);
      return std::string();
    };
  });
}

TEST_F(OptionFile, NoFileIsNoError) {
  Read("KOption 4 Logfile " + Path("ph.log"));
  SetKSOption(2);
  const std::string logged = Log();
  SetCarbonateDefaults();
  ReadOptionFile(Path("not there"));
  EXPECT_EQ(Outcome(), "defaults\n");
  EXPECT_EQ(Log(), logged);
  ReadOptionFile(folder.Path().string());
  EXPECT_NE(CarbonateProblem().find("cannot be opened"), std::string::npos);
}

TEST_F(OptionFile, AFileThatNamesItselfAsItsLogIsNotOverwritten) {
  const std::string own = "KOption 4 Logfile " + Path("options.set");
  Read(own);
  EXPECT_NE(CarbonateProblem().find("names itself"), std::string::npos);
  EXPECT_EQ(test::ReadFile(Path("options.set")), own);
}

TEST_F(OptionFile, ALogThatTakesNoMoreIsGivenUp) {
  Read("Logfile " + Path("ph.log"));
  SetKSOption(2);
  rlimit former = {};
  getrlimit(RLIMIT_FSIZE, &former);
  const rlimit none = {0, former.rlim_max};
  const auto handler = std::signal(SIGXFSZ, SIG_IGN);
  setrlimit(RLIMIT_FSIZE, &none);
  SetKSOption(1);
  setrlimit(RLIMIT_FSIZE, &former);
  std::signal(SIGXFSZ, handler);
  EXPECT_NE(CarbonateProblem().find("cannot be written"), std::string::npos);
  EXPECT_FALSE(CarbonateLog().IsOpen());
}

TEST_F(OptionFile, ALogTakesThePlaceOfAnEarlierLogAlone) {
  const std::string logStart = "# Tessal pH calcualtion log file\n# Constant settings\n";
  folder.Write("ph.log", logStart + "older");
  const std::string notes = folder.Write("notes.txt", "# Tessal, my notes");
  folder.Write("empty", "");
  fs::create_symlink("ph.log", Path("link"));
  fs::create_symlink("not there", Path("dangling"));
  folder.Write("twin", logStart);
  fs::create_hard_link(Path("twin"), Path("hard"));
  for (const char* name : {"notes.txt", "empty", "link", "dangling", "hard", "."}) {
    Read("Logfile " + Path(name));
    EXPECT_EQ(CarbonateProblem(), "") << name;
    SetKSOption(2);
    EXPECT_EQ(Replaced(CarbonateProblem(), Path(name), "NAME"),
              "The log file 'NAME' is not replaced: it is no earlier log");
  }
  EXPECT_EQ(test::ReadFile(notes) + test::ReadFile(Path("empty")), "# Tessal, my notes");
  EXPECT_EQ(Log(), logStart + "older");
  EXPECT_EQ(test::ReadFile(Path("twin")), logStart);
  EXPECT_FALSE(fs::exists(Path("not there")));
  // Even that is left as it is until something is computed.
  Read("Logfile " + Path("ph.log"));
  EXPECT_EQ(Log(), logStart + "older");
  SetKSOption(2);
  EXPECT_TRUE(Log().starts_with(logStart + "TB conversion factor 1\n")) << Log();
}

TEST_F(OptionFile, LogStaysOpenOverReleaseAndIsReplacedByAnother) {
  Read("Logfile " + Path("first.log") + " Logfile " + Path("ph.log"));
  ReleaseCarbonate();
  SetKSOption(2);
  EXPECT_FALSE(fs::exists(Path("first.log")));
  const std::string logged = Log();
  EXPECT_NE(logged.find("Using KS option 2"), std::string::npos);
  ReadOptionFile(folder.Write("options.set", "Logfile " + Path("second.log")));
  EXPECT_FALSE(fs::exists(Path("second.log")));
  SetKSOption(2);
  EXPECT_EQ(Log(), logged);
  EXPECT_GT(fs::file_size(Path("second.log")), 0U);
}

TEST_F(OptionFile, EndlessWordsAndManyWordsAreRead) {
  std::string text = std::string(5'000'000, 'x') + " KSOption 2 ";
  for (int word = 0; word < 200'000; ++word) text += "TP 1 # noise KSOption\nword\n";
  Read(text + std::string(5000, 'T') + std::string(1000, '\0'));
  EXPECT_EQ(Outcome(), "KS 2 total phosphate 1\n");
}

}  // namespace
}  // namespace tessal
