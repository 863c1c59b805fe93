// What the editor does not know of a file stays in it, and what one file held never gets into another.
#include <gtest/gtest.h>

#include "core/error_registry.h"
#include "core/loaded_template.h"
#include "support/template_text.h"

namespace tessal {
namespace {

using test::LoadedTemplate;
using test::ReadFile;
using test::TemplateText;

std::size_t CountOf(const std::string& text, const std::string& part) {
  std::size_t count = 0;
  for (std::size_t place = text.find(part); place != std::string::npos; place = text.find(part, place + 1))
    ++count;
  return count;
}

TEST(KeptContent, SectionsStayByteForByteWhereverTheyStood) {
  const std::string setup = TemplateText().Constant("k").Text().substr(1);
  const std::string first =
      "[FIRST] // ahead\r\n\t // of it\r\n\r\n   A = 007 ,1.2345678901234567 // x\r\nEndSect";
  const std::string last =
      "// of the last\r\n[LAST]\r\n B = 'two\r\nlines'\r\n[INNER]\r\nEndSect\r\nEndSect //";
  std::string remarks;
  for (int line = 0; line < 10000; ++line) remarks += "// " + std::to_string(line) + "\r\n";
  const std::string both = first + "\r\n" + last;
  for (const std::string& text :
       {"\n" + setup + both + "\n", "\n" + first + "\n" + setup + last + "\n", "\n" + both + "\n" + setup,
        "\n" + both + "\n", setup + both, first + "\n" + setup + last + "\n" + remarks,
        setup + "\r\n" + remarks + both}) {
    LoadedTemplate loaded(text);
    ASSERT_TRUE(loaded.Loaded()) << test::Messages();
    for (int save = 1; save <= 2; ++save) {
      ASSERT_TRUE(loaded->SaveWrapper(loaded.Path()));
      const std::string saved = ReadFile(loaded.Path());
      EXPECT_EQ(CountOf(saved, first + "\r\n"), 1U) << saved;
      EXPECT_EQ(CountOf(saved, last + "\r\n"), 1U) << saved;
      EXPECT_EQ(CountOf(saved, "[TESSAL_SETUP]"), 1U) << saved;
      EXPECT_EQ(CountOf(saved, remarks), CountOf(text, remarks)) << saved;
      ASSERT_TRUE(loaded->LoadWrapper(loaded.Path()));
    }
  }
}

TEST(KeptContent, NothingOfOneFileGetsIntoTheNext) {
  LoadedTemplate full(
      TemplateText()
          .Misc("[EXTERNAL_FUNCTIONS]\nDESCRIPTION = 'leak'\nONLINE_HELP = ''\nDOCUMENTATION = ''\n"
                "EndSect\n[VISIBILITY_GROUPS]\nDESCRIPTION = 'leak'\nONLINE_HELP = ''\n"
                "DOCUMENTATION = ''\nGROUPS = 0\nEndSect\n")
          .After("[EXTRA]\nA = 'leak'\nEndSect\n")
          .Text());
  for (const auto& head : full->ListHeads()) head->description.SetText("leak");
  ASSERT_TRUE(full.Loaded());
  LoadedTemplate bare("\n[TESSAL_SETUP]\nDESCRIPTION = 'x'\nONLINE_HELP = ''\nDOCUMENTATION = ''\nEndSect\n");
  ASSERT_TRUE(full->LoadWrapper(bare.Path()));
  ASSERT_TRUE(full->SaveWrapper(full.Path() + ".copy"));
  full->GetMisc()->AddExternalFunction();
  full->AddVisibilityGroup();
  ASSERT_TRUE(full->SaveWrapper(full.Path() + ".copy"));
  EXPECT_EQ(CountOf(ReadFile(full.Path() + ".copy"), "leak"), 0U);
}

}  // namespace
}  // namespace tessal
