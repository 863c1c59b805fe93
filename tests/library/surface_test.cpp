// The library as a program sees it that links it.
#include <gtest/gtest.h>
#include <tessal/tessal.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <map>
#include <set>
#include <sstream>
#include <string>
#include <vector>

namespace {

std::string Example(const std::string& name) {
  return std::string(TESSAL_SOURCE_DIR) + "/examples/" + name + ".tessal";
}

tessal::Template Loaded(const std::string& name) {
  tessal::Template model;
  const tessal::Outcome outcome = model.Load(Example(name));
  EXPECT_TRUE(outcome) << outcome.reason;
  return model;
}

std::vector<std::string> SymbolsOf(const std::vector<tessal::Element>& elements) {
  std::vector<std::string> symbols;
  for (const tessal::Element& element : elements) symbols.push_back(element.Symbol());
  return symbols;
}

std::string TextOf(const std::filesystem::path& path) {
  std::ostringstream text;
  text << std::ifstream(path).rdbuf();
  return text.str();
}

class Folder final {
 public:
  Folder() { std::filesystem::create_directories(path); }
  Folder(const Folder&) = delete;
  Folder& operator=(const Folder&) = delete;
  ~Folder() { std::filesystem::remove_all(path); }

  const std::filesystem::path path =
      std::filesystem::temp_directory_path() /
      ("tessal_surface_" + std::to_string(::testing::UnitTest::GetInstance()->random_seed()) +
       ::testing::UnitTest::GetInstance()->current_test_info()->name());
};

}  // namespace

TEST(Surface, ShowsElementsFieldsAndUses) {
  const tessal::Template model = Loaded("streeter_phelps");
  const auto process = model.Find("deoxygenation");
  ASSERT_TRUE(process);
  EXPECT_EQ(process->GetKind(), tessal::Kind::Process);
  EXPECT_EQ(process->Get("Unit"), "mg/l/d");
  EXPECT_EQ(process->Get("Expression"), "k1_20*ARRHENIUS20(theta1, temp)*BOD");
  EXPECT_EQ(process->Get("Caption"), std::nullopt);
  EXPECT_EQ(SymbolsOf(process->Uses()), (std::vector<std::string>{"k1_20", "theta1", "temp", "BOD"}));
  EXPECT_EQ(SymbolsOf(model.Find("k1_20")->UsedBy()), std::vector<std::string>{"deoxygenation"});
  EXPECT_FALSE(model.Find("nobody"));
  EXPECT_TRUE(model.LoadMessages().empty());
}

TEST(Surface, ShowsMembersOfParticleClassesOnce) {
  const tessal::Template model = Loaded("fish_larvae");
  std::map<tessal::Kind, std::set<std::string>> classes;
  for (const tessal::Element& element : model.Elements()) {
    classes[element.GetKind()].insert(element.ClassSymbol());
  }
  EXPECT_EQ(classes[tessal::Kind::Process], std::set<std::string>{""});
  for (const tessal::Kind kind :
       {tessal::Kind::ParticleStateVariable, tessal::Kind::AreaSearch, tessal::Kind::VerticalMovement}) {
    EXPECT_EQ(classes[kind], (std::set<std::string>{"Larva", "Predator"}));
  }
  const std::vector<std::string> symbols = SymbolsOf(model.Elements());
  EXPECT_EQ(std::set<std::string>(symbols.begin(), symbols.end()).size(), symbols.size());
}

TEST(Surface, ChangesAreStepsThatAreTakenBack) {
  tessal::Template model = Loaded("streeter_phelps");
  const std::string before = model.Text().value();
  tessal::Element rate = model.Find("k1_20").value();
  EXPECT_TRUE(rate.Set("Default Value", "0.5"));
  EXPECT_EQ(rate.Get("Default Value"), "0.5");
  EXPECT_TRUE(model.Rename("k1_20", "kd"));
  EXPECT_EQ(rate.Symbol(), "kd");
  EXPECT_EQ(model.Find("deoxygenation")->Get("Expression"), "kd*ARRHENIUS20(theta1, temp)*BOD");
  tessal::Element process = model.Find("deoxygenation").value();
  EXPECT_TRUE(process.Set("Expression", "kd*lost*BOD"));
  ASSERT_EQ(model.UndefinedNames().size(), 1U);
  EXPECT_EQ(model.UndefinedNames()[0].name, "lost");
  EXPECT_EQ(model.UndefinedNames()[0].usedBy, std::vector<std::string>{"deoxygenation"});
  const auto created = model.Create(tessal::Kind::Constant, "lost");
  ASSERT_TRUE(created);
  EXPECT_TRUE(model.UndefinedNames().empty());
  EXPECT_FALSE(model.Remove(*created));
  EXPECT_TRUE(process.Set("Expression", "kd*BOD"));
  EXPECT_TRUE(model.Remove(*created));
  EXPECT_FALSE(created->Exists());
  EXPECT_TRUE(model.IsModified());
  int steps = 0;
  while (model.Undo()) ++steps;
  EXPECT_EQ(steps, 6);
  EXPECT_EQ(model.Text(), before);
  EXPECT_FALSE(model.IsModified());
  EXPECT_EQ(rate.Symbol(), "k1_20");
}

TEST(Surface, RefusesWhatAFormWouldNotTake) {
  tessal::Template model = Loaded("streeter_phelps");
  const std::string before = model.Text().value();
  tessal::Element rate = model.Find("k1_20").value();
  struct Refused {
    const char* label;
    const char* value;
  };
  for (const Refused& refused : std::initializer_list<Refused>{{"Symbol", "kd"},
                                                               {"ID", "7"},
                                                               {"Colour", "red"},
                                                               {"Default Value", "0,5"},
                                                               {"Default Value", "nan"},
                                                               {"Default Value", ""},
                                                               {"Scope", "EVERYWHERE"},
                                                               {"Is user specified", "maybe"}}) {
    EXPECT_FALSE(rate.Set(refused.label, refused.value)) << refused.label << ' ' << refused.value;
  }
  EXPECT_TRUE(rate.Set("Scope", "WC"));
  EXPECT_TRUE(model.Undo());
  EXPECT_FALSE(model.Create(tessal::Kind::Constant, "BOD"));
  EXPECT_FALSE(model.Create(tessal::Kind::Constant, "1st"));
  EXPECT_FALSE(model.Create(tessal::Kind::ParticleConstant, "weight", "nobody"));
  EXPECT_FALSE(model.Create(static_cast<tessal::Kind>(99), "weight"));
  EXPECT_FALSE(model.Rename("k1_20", "BOD"));
  EXPECT_FALSE(model.Move(rate, tessal::Side::Before, model.Find("BOD").value()));
  const tessal::Template other = Loaded("streeter_phelps");
  EXPECT_FALSE(model.Remove(other.Find("DO").value()));
  EXPECT_EQ(model.Text(), before);
}

TEST(Surface, MovesAndCreatesWhereItIsTold) {
  tessal::Template model = Loaded("fish_larvae");
  const auto places = [&model](const std::vector<std::string>& symbols) {
    const std::vector<std::string> all = SymbolsOf(model.Elements());
    std::vector<std::size_t> found;
    for (const std::string& symbol : symbols) {
      found.push_back(static_cast<std::size_t>(std::find(all.begin(), all.end(), symbol) - all.begin()));
    }
    return found;
  };
  const tessal::Element growth = model.Find("kp").value();
  EXPECT_TRUE(model.Move(growth, tessal::Side::After, model.Find("kq").value()));
  EXPECT_EQ(places({"cap", "kq", "kp"}), (std::vector<std::size_t>{1, 2, 3}));
  EXPECT_TRUE(model.Move(growth, tessal::Side::Before, model.Find("kq").value()));
  EXPECT_EQ(places({"cap", "kp", "kq"}), (std::vector<std::size_t>{1, 2, 3}));
  const auto fat = model.Create(tessal::Kind::ParticleStateVariable, " Larva_fat ", "Larva");
  ASSERT_TRUE(fat);
  EXPECT_EQ(fat->Symbol(), "Larva_fat");
  EXPECT_EQ(fat->ClassSymbol(), "Larva");
  // What a choice means for other fields follows, also after another template was loaded.
  const tessal::Template other = Loaded("streeter_phelps");
  tessal::Element cap = model.Find("cap").value();
  EXPECT_TRUE(cap.Set("Build in ID", "BED_LEVEL"));
  EXPECT_EQ(cap.Get("Unit"), "m");
  EXPECT_FALSE(cap.Set("Unit", "km"));
}

TEST(Surface, SavesNothingThatWouldBeLostWithoutAWord) {
  const Folder folder;
  const std::filesystem::path file = folder.path / "river.tessal";
  const std::string text = TextOf(Example("streeter_phelps"));
  const std::string key = "DEFAULT_VALUE = ";
  std::string broken = text;
  broken.insert(broken.find(key) + key.size(), "'a third' // ");
  std::ofstream(file) << broken;
  tessal::Template model;
  ASSERT_TRUE(model.Load(file.string()));
  EXPECT_FALSE(model.Losses().empty());
  const tessal::Outcome refused = model.Save();
  EXPECT_FALSE(refused);
  EXPECT_FALSE(refused.reason.empty());
  EXPECT_EQ(TextOf(file), broken);
  EXPECT_TRUE(model.SaveInSpiteOfLosses());
  EXPECT_NE(TextOf(file), broken);
  EXPECT_FALSE(model.SaveAs((folder.path / "none" / "river.tessal").string()));
  EXPECT_TRUE(model.SaveAs((folder.path / "other.tessal").string()));
  EXPECT_FALSE(tessal::Template().Save());
}

TEST(Surface, SaysWhyAFileIsNotLoaded) {
  tessal::Template model = Loaded("streeter_phelps");
  EXPECT_NE(model.Load("/nowhere/river.tessal").reason.find("/nowhere/river.tessal"), std::string::npos);
  EXPECT_TRUE(model.Elements().empty());
  // What is no template at all loads as an empty one, with a word about it.
  EXPECT_TRUE(model.LoadText(std::string("\0\1\2", 3)));
  EXPECT_FALSE(model.LoadMessages().empty());
  // What a file lacks is nothing that a save would lose.
  EXPECT_TRUE(model.LoadText(""));
  EXPECT_TRUE(model.Losses().empty());
}

TEST(Surface, KeepsTemplatesApart) {
  tessal::Template faulty = Loaded("faults");
  tessal::Template clean = Loaded("streeter_phelps");
  EXPECT_TRUE(clean.Check().empty());
  const std::size_t faults = faulty.Check().size();
  EXPECT_GT(faults, 0U);
  EXPECT_EQ(faulty.Check().size(), faults);
  // A comment that one leaves open does not reach the next.
  EXPECT_TRUE(clean.Find("reaeration")->Set("Expression", "DO /* open"));
  clean.Check();
  clean = Loaded("streeter_phelps");
  EXPECT_TRUE(clean.LoadMessages().empty());
  tessal::Template moved = std::move(faulty);
  ASSERT_FALSE(moved.LoadMessages().empty());
  for (const tessal::TemplateMessage& message : moved.LoadMessages()) {
    EXPECT_NE(message.text.back(), '\n') << message.text;
  }
}

TEST(Surface, AnalysesSayWhatTheToolSays) {
  const tessal::Template model = Loaded("eutrophication");
  const auto balances = tessal::Balance(model);
  ASSERT_FALSE(balances.empty());
  for (const tessal::BalanceOfPool& balance : balances) {
    EXPECT_EQ(balance.verdict, tessal::Verdict::Closed) << balance.pool;
  }
  EXPECT_TRUE(tessal::UnitMessages(model).empty());
  const auto lint = tessal::LintMessages(model);
  ASSERT_FALSE(lint.empty());
  EXPECT_EQ(lint[0].code, "unused-auxiliary");
  tessal::Template broken = Loaded("streeter_phelps");
  EXPECT_TRUE(broken.Find("deoxygenation")->Set("Expression", "k1_20*BOD*BOD"));
  EXPECT_FALSE(tessal::UnitMessages(broken).empty());
  tessal::Template mixed = Loaded("asm1");
  EXPECT_TRUE(mixed.Find("S_S")->Set("Equation", "ammonification"));
  EXPECT_TRUE(tessal::UnitMessages(mixed).empty());
  EXPECT_FALSE(tessal::StrictUnitMessages(mixed).empty());
  const tessal::MatrixOfProcesses matrix = tessal::ProcessesOf(Loaded("streeter_phelps"));
  EXPECT_EQ(matrix.states, (std::vector<std::string>{"DO", "BOD"}));
  ASSERT_FALSE(matrix.factors.empty());
  EXPECT_EQ(matrix.factors[0], (std::vector<std::string>{"-1", "-1"}));
}

TEST(Surface, MakesPages) {
  const tessal::Template model = Loaded("streeter_phelps");
  EXPECT_NE(tessal::HtmlPage(model).find("<math"), std::string::npos);
  EXPECT_NE(tessal::OverviewTable(model).find("deoxygenation"), std::string::npos);
  EXPECT_EQ(tessal::ExpressionAsLatex("a/b"), "\\frac{\\mathrm{a}}{\\mathrm{b}}");
  EXPECT_TRUE(tessal::ExpressionAsLatex("a/").empty());
  EXPECT_EQ(std::string(tessal::Version()).rfind(std::to_string(TESSAL_VERSION_MAJOR) + ".", 0), 0U);
}
