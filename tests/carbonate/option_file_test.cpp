// The option file: what its words set, in which order, and what becomes of a faulty one.

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>
#include <string_view>

#include <unistd.h>

#include <gtest/gtest.h>

#include "carbonate/catalogue_call.h"
#include "expr/carbonate/options.h"
#include "expr/carbonate/settings.h"
#include "expr/carbonate/settings_log.h"

namespace tessal {
namespace {

namespace fs = std::filesystem;

class OptionFile : public testing::Test {
 protected:
  OptionFile() : folder(fs::path(testing::TempDir()) / ("option_file_" + std::to_string(getpid()))) {
    fs::create_directories(folder);
    ResetCarbonateForTest();
  }
  ~OptionFile() override {
    ResetCarbonateForTest();
    std::error_code error;
    fs::remove_all(folder, error);
  }

  std::string Path(std::string_view name) const { return (folder / name).string(); }

  void Read(std::string_view text) const {
    std::ofstream(Path("options.set"), std::ios::binary) << text;
    ReadOptionFile(Path("options.set"));
  }

  std::string Log() const {
    std::ifstream file(Path("ph.log"));
    std::ostringstream text;
    text << file.rdbuf();
    return text.str();
  }

 private:
  fs::path folder;
};

/// All settings as one line: the option numbers by the entry of their table, then totals and factors.
std::string Settings() {
  const CarbonateSettings& s = Carbonate();
  std::ostringstream text;
  text << "K1K2 " << s.carbonicAcid - kCarbonicAcidOptions.data() + 1 << " KW "
       << s.water - kWaterOptions.data() + 1 << " KB " << s.boricAcid - kBoricAcidOptions.data() + 1 << " KS "
       << s.bisulphate - kBisulphateOptions.data() + 1 << " fH " << s.activity - kActivityOptions.data() + 1
       << " TB " << s.boron - kBoronOptions.data() + 1 << " totals";
  const auto addAll = [&text](const PerSpecie& values) {
    for (const double v : {values.boron, values.fluoride, values.sulphate, values.phosphate, values.silicate})
      text << ' ' << v;
  };
  addAll(s.totals);
  text << " factors";
  addAll(s.factors);
  text << ' ' << s.dicFactor << ' ' << s.alkalinityFactor;
  return text.str();
}

constexpr std::string_view kDefaults =
    "K1K2 1 KW 1 KB 1 KS 1 fH 1 TB 1 totals -1 -1 -1 0 0 factors 1 1 1 1 1 1 1";

TEST_F(OptionFile, WordsSetWhatTheyName) {
  const struct {
    std::string_view text;
    std::string_view settings;
  } rows[] = {
      {"", kDefaults},
      {" \n\t ", kDefaults},
      {"KOption 9 KWOption 6", "K1K2 9 KW 6 KB 9 KS 1 fH 9 TB 1 totals -1 -1 -1 0 0 factors 1 1 1 1 1 1 1"},
      {"KWOption 6\nKOption 9", "K1K2 9 KW 6 KB 9 KS 1 fH 9 TB 1 totals -1 -1 -1 0 0 factors 1 1 1 1 1 1 1"},
      {"FHOption 7 KOption 1", kDefaults},
      {"FHOption 7", "K1K2 1 KW 1 KB 1 KS 1 fH 7 TB 1 totals -1 -1 -1 0 0 factors 1 1 1 1 1 1 1"},
      {"KSOption 2 KBOption 8 TBOption 3 K1K2Option 10",
       "K1K2 10 KW 1 KB 8 KS 2 fH 1 TB 3 totals -1 -1 -1 0 0 factors 1 1 1 1 1 1 1"},
      {"KOption 15 KSOption -2", kDefaults},
      {"KOption 0 KBOption 5 KBOption 0", kDefaults},
      {"KBOption 5 KBOption 7", "K1K2 1 KW 1 KB 7 KS 1 fH 1 TB 1 totals -1 -1 -1 0 0 factors 1 1 1 1 1 1 1"},
      {"# comment TB 5\nTP 2", "K1K2 1 KW 1 KB 1 KS 1 fH 1 TB 1 totals -1 -1 -1 2 0 factors 1 1 1 1 1 1 1"},
      {"TP 2 # TB 5", "K1K2 1 KW 1 KB 1 KS 1 fH 1 TB 1 totals -1 -1 -1 2 0 factors 1 1 1 1 1 1 1"},
      {"#note TF 3\r\nTSi 5\r\n#",
       "K1K2 1 KW 1 KB 1 KS 1 fH 1 TB 1 totals -1 3 -1 0 5 factors 1 1 1 1 1 1 1"},
      {"TP 2 ConvertTP 10 ConvertTB 2 ConvertTF 3 ConvertTS 4 ConvertTSi 5 ConvertDIC 6 ConvertALK 7e2",
       "K1K2 1 KW 1 KB 1 KS 1 fH 1 TB 1 totals -2 -3 -4 20 0 factors 2 3 4 10 5 6 700"},
      {"tb 5 Option KOption= 3 \xff\x01", kDefaults},
      {"KOption 4.9", "K1K2 4 KW 4 KB 4 KS 1 fH 4 TB 1 totals -1 -1 -1 0 0 factors 1 1 1 1 1 1 1"},
  };
  for (const auto& row : rows) {
    ResetCarbonateForTest();
    Read(row.text);
    EXPECT_EQ(Settings(), row.settings) << row.text;
    EXPECT_EQ(CarbonateProblem(), "") << row.text;
  }
}

TEST_F(OptionFile, NoFileIsNoError) {
  Read("KOption 4 Logfile " + Path("ph.log"));
  const std::string logged = Log();
  SetCarbonateDefaults();
  ReadOptionFile(Path("not there"));
  EXPECT_EQ(Settings(), kDefaults);
  EXPECT_EQ(CarbonateProblem(), "");
  EXPECT_EQ(Log(), logged);
}

TEST_F(OptionFile, FaultyValueEndsTheReadingAndBringsDefaults) {
  const struct {
    std::string_view text;
    std::string_view settings;
    std::string_view problem;
  } rows[] = {
      {"TP 2 ConvertDIC 3 KSOption 2 KBOption six TBOption 3",
       "K1K2 14 KW 14 KB 14 KS 2 fH 14 TB 1 totals -1 -1 -1 0 0 factors 1 1 1 1 1 1 1", "'KBOption'"},
      {"K1K2Option 4 TB", "K1K2 4 KW 14 KB 14 KS 1 fH 14 TB 1 totals -1 -1 -1 0 0 factors 1 1 1 1 1 1 1",
       "'TB'"},
      {"KOption", "K1K2 14 KW 14 KB 14 KS 1 fH 14 TB 1 totals -1 -1 -1 0 0 factors 1 1 1 1 1 1 1",
       "'KOption'"},
      {"KOption 99999999999", "K1K2 14 KW 14 KB 14 KS 1 fH 14 TB 1 totals -1 -1 -1 0 0 factors 1 1 1 1 1 1 1",
       "'KOption'"},
      {"TS 1e999", "K1K2 14 KW 14 KB 14 KS 1 fH 14 TB 1 totals -1 -1 -1 0 0 factors 1 1 1 1 1 1 1", "'TS'"},
      {"ConvertALK nan", "K1K2 14 KW 14 KB 14 KS 1 fH 14 TB 1 totals -1 -1 -1 0 0 factors 1 1 1 1 1 1 1",
       "'ConvertALK'"},
      {"TP # 5\n5", "K1K2 14 KW 14 KB 14 KS 1 fH 14 TB 1 totals -1 -1 -1 0 0 factors 1 1 1 1 1 1 1", "'TP'"},
      {"Logfile", "K1K2 14 KW 14 KB 14 KS 1 fH 14 TB 1 totals -1 -1 -1 0 0 factors 1 1 1 1 1 1 1",
       "'Logfile'"},
  };
  for (const auto& row : rows) {
    ResetCarbonateForTest();
    Read(row.text);
    EXPECT_EQ(Settings(), row.settings) << row.text;
    EXPECT_NE(CarbonateProblem().find(row.problem), std::string::npos)
        << row.text << ": " << CarbonateProblem();
  }
}

TEST_F(OptionFile, LogTellsSettingsInTheOrderInWhichTheyAreApplied) {
  Read("TB 5 KBOption 8 ConvertTP 0.1 KOption 10 Logfile " + Path("ph.log"));
  SetK1K2Option(99);
  SetGetSpecie(1, 5);  // as it is already
  SetGetSpecie(1, 6);
  SetGetSpecie(1, -7);
  const std::string fh =
      "Takahashi, Williams, Bos 1982, GEOSECS Pacific Expedition vol. 3, chapter 3, p. 80\n";
  EXPECT_EQ(
      Log(),
      "# Tessal pH calcualtion log file\n"
      "# Constant settings\n"
      "Using K1K2 option 10: Lueker, Dickson, Keeling 2000, Mar. Chem. 70:105-119\n"
      "Using KW option 10: Millero 1995, Geochim. Cosmochim. Acta 59:661-677\n"
      "Using KB option 10: Dickson 1990, Deep-Sea Res. A 37:755-766\n"
      "Using fH option 10: " +
          fh +
          "Using KB option 8: KB=0.0\n"
          "TB conversion factor 1\n"
          "TF conversion factor 1\n"
          "TS conversion factor 1\n"
          "TP conversion factor 0.1\n"
          "DIC conversion factor 1\n"
          "ALK conversion factor 1\n"
          "TB  = 5\n"
          "TF  = -1 (from salinity)\n"
          "TS  = -1 (from salinity)\n"
          "TP  = 0\n"
          "TSi = 0\n"
          "Using K1K2 option 1: Roy et al. 1993, Mar. Chem. 44:249-267 (errata 45:337, 1994; 52:183, 1996)\n"
          "TB  = 6\n");
}

TEST_F(OptionFile, FailureIsLogged) {
  const std::string log = Path("ph.log");
  Read("Logfile " + log + "\nKSOption two\n");
  const std::string expected =
      "# Tessal pH calcualtion log file\n"
      "# Constant settings\n"
      "Error reading file " +
      Path("options.set") +
      "\n"
      "              Line " +
      std::to_string(8 + log.size() + 1 + 8 + 1) +
      "\n"
      "Last read option   KSOption\n"
      "Exception          the value is not a number in range\n"
      "Using default settings!\n"
      "Using K1K2 option 14: Millero 2010, Mar. Freshwater Res. 61:139-142\n";
  EXPECT_EQ(Log().substr(0, expected.size()), expected);
}

TEST_F(OptionFile, LogThatCannotBeWrittenReachesTheUser) {
  Read("KOption 4 Logfile " + Path("missing/ph.log"));
  EXPECT_NE(CarbonateProblem().find("cannot be opened"), std::string::npos);
  EXPECT_EQ(Carbonate().carbonicAcid, &kCarbonicAcidOptions[3]);

  ResetCarbonateForTest();
  const std::string own = "KOption 4 Logfile " + Path("options.set");
  Read(own);
  EXPECT_NE(CarbonateProblem().find("names itself"), std::string::npos);
  EXPECT_EQ(fs::file_size(Path("options.set")), own.size());

  if (fs::exists("/dev/full")) {
    ResetCarbonateForTest();
    Read("Logfile /dev/full");
    EXPECT_NE(CarbonateProblem().find("cannot be written"), std::string::npos);
    EXPECT_FALSE(CarbonateLog().IsOpen());
  }
}

TEST_F(OptionFile, LogStaysOpenOverReleaseAndIsReplacedByAnother) {
  Read("Logfile " + Path("first.log") + " Logfile " + Path("ph.log"));
  EXPECT_FALSE(fs::exists(Path("first.log")));
  ReleaseCarbonate();
  SetKSOption(2);
  EXPECT_NE(Log().find("Using KS option 2"), std::string::npos);
  const std::string logged = Log();
  Read("Logfile " + Path("second.log"));
  SetKSOption(2);
  EXPECT_EQ(Log(), logged);
  EXPECT_GT(fs::file_size(Path("second.log")), 0U);
}

TEST_F(OptionFile, FolderAndEndlessWordsAndManyWordsAreRead) {
  ReadOptionFile(fs::temp_directory_path().string());
  EXPECT_NE(CarbonateProblem().find("cannot be opened"), std::string::npos);

  std::string text = std::string(5'000'000, 'x') + " KSOption 2 ";
  for (int word = 0; word < 200'000; ++word) text += "TP 1 # noise KSOption\nword\n";
  Read(text + std::string(5000, 'T') + std::string(1000, '\0'));
  EXPECT_EQ(CarbonateProblem(), "");
  EXPECT_EQ(Settings(), "K1K2 1 KW 1 KB 1 KS 2 fH 1 TB 1 totals -1 -1 -1 1 0 factors 1 1 1 1 1 1 1");
}

}  // namespace
}  // namespace tessal
