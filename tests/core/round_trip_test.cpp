// Templates with every kind of element and every value filled at random come back from a file as they were.
#include <gtest/gtest.h>

#include <array>
#include <fstream>
#include <optional>
#include <random>
#include <set>

#include "core/error_registry.h"
#include "core/loaded_template.h"
#include "support/template_content.h"
#include "support/template_text.h"

namespace tessal {
namespace {

using test::LoadedTemplate;
using test::ReadFile;
using test::TemplateContent;

constexpr std::array<const char*, 12> kTexts = {"",
                                                "plain",
                                                "it's the modeller's",
                                                "|bars| and \"quotes\"",
                                                "two\nlines\n\n  and a third",
                                                "// no comment",
                                                "EndSect",
                                                "[SECTION]",
                                                "A = 1, 2",
                                                "\xE9\xFC bytes of any kind \x01",
                                                "tab\tinside",
                                                "back\\slash"};
constexpr std::array<const char*, 8> kExpressions = {"0",
                                                     "k0 + S0",
                                                     "IF k0 > 1\n  THEN 2\n  ELSE it's",
                                                     "\"quoted\" inside",
                                                     "a || b",
                                                     "a +^",
                                                     "MAX(k0, 1e-3)",
                                                     ""};
constexpr std::array<double, 9> kReals = {
    0.0, 1.0, 0.1, 1.0 / 3.0, -2.5e17, 1e-300, 5e-324, 1.7976931348623157e308, -0.30000000000000004};

/// Fills templates. All its choices follow from the seed.
class Filler final {
 public:
  explicit Filler(unsigned seed) : random(seed) {}

  std::size_t Pick(std::size_t count) { return random() % count; }
  template <class Values>
  auto AnyOf(const Values& values) {
    return values[Pick(std::size(values))];
  }

  void FillTexts(CEL_Element& head) {
    for (CEL_Property* text : {&head.description, &head.onlineHelp, &head.documentation})
      text->SetText(AnyOf(kTexts));
  }

  void FillGroup(VisibilityGroup& group) {
    group.description = AnyOf(kTexts);
    for (VisibilityLevel& level : group.levels) level.description = AnyOf(kTexts);
  }

  /// Every value but those that name or number the element.
  void FillFields(CEL_Element& element) {
    std::vector<ElementField> fields;
    element.GetFields(fields);
    std::erase_if(fields, [](const ElementField& field) {
      static const std::set<std::string> kGiven = {"Caption", "Symbol",         "Name",          "ID",
                                                   "Specie",  "Tessal version", "Parser version"};
      return kGiven.contains(field.name);
    });
    for (ElementField& field : fields) {
      if (field.kind == FieldKind::Expression) field.text = AnyOf(kExpressions);
      if (field.kind == FieldKind::Text)
        field.text = field.choiceTexts.empty() ? AnyOf(kTexts) : AnyOf(field.choiceTexts);
      field.intValue = static_cast<std::int32_t>(random());
      field.realValue = AnyOf(kReals);
      field.boolValue = Pick(2) == 0;
    }
    element.SetFields(fields);
  }

  /// The choices of a search are linked; its variable is one that exists.
  void FillSearch(CEL_Lagrange_Spatial_Function& search, std::int32_t variable) {
    const auto take = [this](CEL_Property& property) {
      property.SelectIndex(static_cast<std::int32_t>(Pick(property.Choices().size())));
      property.ApplySelection();
    };
    take(search.framework);
    search.RebuildChoices();
    take(search.purpose);
    search.RebuildChoices();
    take(search.math);
    search.variableId.SetInt(variable);
  }

 private:
  std::mt19937 random;
};

void FillSpecie(CEL_Lagrange_Specie& specie, Filler& filler) {
  for (std::size_t count = 1 + filler.Pick(3); count > 0; --count) {
    filler.FillFields(specie.AddStateVariable());
    filler.FillFields(specie.AddConstant());
    filler.FillFields(specie.AddForcing());
    filler.FillFields(specie.AddSpatialFunction());
    filler.FillFields(specie.AddArithmeticExpression());
    specie.AddHorizontalVector();
    // Names are free behind a rebuild alone.
    static_cast<TemplateCore*>(specie.Owner())->RebuildSymbolTable();
  }
  for (const auto& vector : specie.horizontalVectors) filler.FillFields(*vector);
  filler.FillFields(*specie.verticalEquation);
  filler.FillFields(specie);
  // Movements have no list of their own in the file.
  constexpr std::size_t kListsWithHeads = 5;
  for (std::size_t place = 0; place < kListsWithHeads; ++place) filler.FillTexts(*specie.Heads()[place]);
}

void FillSettings(TemplateCore& core, Filler& filler) {
  CEL_Miscanellous& misc = *core.GetMisc();
  filler.FillFields(misc);
  filler.FillTexts(misc.ExternalFunctionHead());
  filler.FillTexts(misc.Visibilities());
  for (std::size_t count = 1 + filler.Pick(3); count > 0; --count) {
    filler.FillFields(misc.AddExternalFunction());
    const std::int32_t group = core.AddVisibilityGroup();
    for (std::size_t levels = filler.Pick(4); levels > 0; --levels) {
      const std::int32_t level = core.CreateLevel(group);
      for (std::size_t items = filler.Pick(5); items > 0; --items) {
        core.AddItemToLevel(group, level,
                            static_cast<std::uint32_t>(1 + filler.Pick(core.SymbolTable().size())));
      }
    }
    filler.FillGroup(misc.Visibilities().groups.back());
  }
}

/// Up to `most` elements of each kind.
void FillTemplate(TemplateCore& core, Filler& filler, std::size_t most) {
  const NotificationsOff silent;
  for (std::size_t count = 1 + filler.Pick(most); count > 0; --count) {
    filler.FillFields(core.AddStateVariable());
    filler.FillFields(core.AddConstant());
    filler.FillFields(core.AddForcing());
    filler.FillFields(core.AddAuxiliary());
    filler.FillFields(core.AddProcess());
    filler.FillFields(core.AddDerivedOutput());
    FillSpecie(core.AddSpecie(), filler);
  }
  filler.FillTexts(core.Root());
  for (const auto& head : core.ListHeads()) filler.FillTexts(*head);
  core.RebuildSymbolTable();
  for (const auto& specie : core.Species()) {
    for (const auto& search : specie->spatialFunctions) filler.FillSearch(*search, filler.Pick(2) ? 1 : -1);
  }
  core.RebuildSymbolTable();
  FillSettings(core, filler);
}

std::set<ElementKind> KindsIn(const TemplateCore& core) {
  std::set<ElementKind> kinds;
  for (const SymbolRecord& record : core.SymbolTable()) kinds.insert(record.element->Kind());
  return kinds;
}

std::string WithoutRevision(std::string text) {
  const std::size_t start = text.find("DOCUMENT_REVISION");
  return start == std::string::npos ? text : text.erase(start, text.find('\n', start) - start);
}

const std::string kStart =
    "\n[TESSAL_SETUP]\nDESCRIPTION = ''\nONLINE_HELP = ''\nDOCUMENTATION = ''\nEndSect\n"
    "[FIRST] // at its head\n// of\n// two lines\nA = 1, -0.25, 'it', |is 'path'| // behind\n"
    "[INNER]\nB = TRUE\n// alone\nEndSect // inner\nEndSect // FIRST\n"
    "[SECOND]\n// remark\nC = 'two\nlines'\nEndSect\n";

/// A template with everything, saved under its name.
class Filled final {
 public:
  Filled(unsigned seed, std::size_t most) : loaded(kStart) {
    Filler filler(seed);
    // A file without settings gets them under a new name.
    path = loaded.Path() + ".full";
    EXPECT_TRUE(loaded->SaveWrapper(path));
    FillTemplate(*loaded, filler, most);
    EXPECT_TRUE(loaded->SaveWrapper(path)) << test::Messages();
  }
  TemplateCore& Core() { return *loaded; }
  const std::string& Path() const { return path; }

 private:
  LoadedTemplate loaded;
  std::string path;
};

TEST(RoundTrip, EveryKindComesBackWithEveryValue) {
  constexpr std::size_t kKindsWithRecords = 14;
  constexpr unsigned kSeeds = 25;
  for (unsigned seed = 1; seed <= kSeeds; ++seed) {
    Filled filled(seed, 4);
    const std::string content = TemplateContent(filled.Core());
    ASSERT_EQ(KindsIn(filled.Core()).size(), kKindsWithRecords);
    ASSERT_NE(content.find("// two lines"), std::string::npos);
    const std::string once = ReadFile(filled.Path());
    TemplateCore again;
    ASSERT_TRUE(again.LoadWrapper(filled.Path())) << "seed " << seed << test::Messages();
    ASSERT_EQ(TemplateContent(again), content) << "seed " << seed;
    ASSERT_TRUE(again.SaveWrapper(filled.Path()));
    std::string twice = ReadFile(filled.Path());
    ASSERT_EQ(WithoutRevision(twice), WithoutRevision(once)) << "seed " << seed;
    TemplateCore third;
    ASSERT_TRUE(third.LoadWrapper(filled.Path()));
    ASSERT_EQ(TemplateContent(third), content) << "seed " << seed;
    ASSERT_TRUE(third.SaveWrapper(filled.Path()));
    ASSERT_EQ(WithoutRevision(ReadFile(filled.Path())), WithoutRevision(twice)) << "seed " << seed;

    std::erase(twice, '\r');
    const std::string bare = filled.Path() + ".bare";
    std::ofstream(bare, std::ios::binary) << twice;
    ASSERT_TRUE(third.LoadWrapper(bare));
    ASSERT_EQ(TemplateContent(third), content) << "bare line feeds, seed " << seed;
  }
}

/// The line with another value of the same type; nothing for one that holds no value or only a part of one.
std::optional<std::string> Altered(const std::string& line) {
  const std::size_t start = line.find(" = ");
  if (start == std::string::npos || line.starts_with("//")) return std::nullopt;
  const std::string head = line.substr(0, start + 3);
  const std::string value = line.substr(start + 3);
  if (value.size() > 1 && value.front() == value.back() && (value[0] == '\'' || value[0] == '|')) {
    if (value.find_first_of("'|", 1) != value.size() - 1) return std::nullopt;
    if (value == "'YES'" || value == "'NO'") return head + (value == "'YES'" ? "'NO'" : "'YES'");
    return head + (value[1] == '"' ? "'\"mutant\"'" : "'mutant'");
  }
  const bool isNumber = value.find_first_not_of("-+.e0123456789, ") == std::string::npos;
  if (!isNumber || value.empty()) return std::nullopt;
  return head + (value == "7" ? "8" : "7");
}

TEST(RoundTrip, AnyValueThatIsLostIsNoticed) {
  // Counts, positions, and what follows from the rest; choices that fall back to their first.
  const std::set<std::string> unnoticed = {
      "DOCUMENT_REVISION", "ID",        "ITEMCOUNT", "GROUPS", "LEVELS",
      "EXPRESSION_TYPE",   "FRAMEWORK", "PURPOSE",   "MATH",   "BUILD_SPATIAL_TREE"};
  Filled filled(5, 1);
  const std::string content = TemplateContent(filled.Core());
  std::string text = ReadFile(filled.Path());
  std::erase(text, '\r');
  const std::string altered = filled.Path() + ".altered";
  int tried = 0;
  std::vector<std::string> sections;
  for (std::size_t place = 0; place < text.size();) {
    const std::size_t end = text.find('\n', place);
    const std::string line = text.substr(place, end - place);
    const std::size_t word = std::min(line.find_first_not_of(' '), line.size());
    if (word < line.size() && line[word] == '[' && line.back() == ']') sections.push_back(line.substr(word));
    if (line.substr(word).starts_with("EndSect  //")) sections.pop_back();
    const std::string keyword = line.substr(word, line.find(' ', word) - word);
    const auto other = Altered(line);
    const bool auxiliariesHead = !sections.empty() && sections.back() == "[AUXILIARY_VARIABLES]";
    const bool forcingOfSpecie = keyword == "SCOPE" && sections.size() == 5;
    if (other && !unnoticed.contains(keyword) && !auxiliariesHead && !forcingOfSpecie) {
      std::ofstream(altered, std::ios::binary)
          << text.substr(0, place) + *other + text.substr(std::min(end, text.size()));
      TemplateCore core;
      // A variable's name that does not fit its equation's keyword, for one, is told.
      const bool loads = core.LoadWrapper(altered);
      EXPECT_TRUE(!loads || TemplateContent(core) != content) << line << " -> " << *other;
      ++tried;
    }
    place = end == std::string::npos ? text.size() : end + 1;
  }
  EXPECT_GT(tried, 150);
}

}  // namespace
}  // namespace tessal
