#include "core/document.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "core/error_registry.h"
#include "support/template_text.h"
#include "support/temporary_folder.h"

namespace tessal {
namespace {

using test::ReadFile;
using test::TemplateText;
using test::TemporaryFolder;

class ScriptedDialogs final : public DocumentDialogs {
 public:
  void ShowMessage(const std::string& text) override { shown = text; }
  bool AskYesNo(const std::string& question) override {
    asked = question;
    return yes;
  }
  LossAnswer AskAboutLosses(const std::string& /*path*/, const std::vector<std::string>& texts) override {
    losses = texts;
    return lossAnswer;
  }
  std::vector<std::string> losses;
  LossAnswer lossAnswer;
  std::string shown;
  std::string asked;
  bool yes = true;
};

TEST(Document, AFailedOpenShowsEveryMessage) {
  ScriptedDialogs dialogs;
  CTessalDoc document(dialogs);
  EXPECT_FALSE(document.OnOpenDocument("/nowhere.tessal"));
  EXPECT_EQ(dialogs.shown,
            "Failed to load file '/nowhere.tessal'\n\n-FATAL-Can not open file /nowhere.tessal\n\n.");
  EXPECT_TRUE(NotifyChanges());
}

TEST(Document, AFileThatASaveWouldHarmIsReplacedOnlyOnDemand) {
  const TemporaryFolder folder;
  const std::string text = TemplateText().Constant("k", "3").Without("UNIT").Text();
  const std::string path = folder.Write("m.tessal", text);
  ScriptedDialogs dialogs;
  CTessalDoc document(dialogs);
  ASSERT_TRUE(document.OnOpenDocument(path));
  EXPECT_FALSE(document.OnSaveDocument(path)) << "cancelled";
  EXPECT_EQ(dialogs.losses.size(), 3U) << "the values, and not the missing unit";
  dialogs.lossAnswer = {LossAnswer::Wish::SaveCopy, folder.File("copy.tessal")};
  EXPECT_FALSE(document.OnSaveDocument(path));
  EXPECT_EQ(ReadFile(path), text);
  EXPECT_NE(ReadFile(folder.File("copy.tessal")).find("DEFAULT_VALUE = 0\r"), std::string::npos);
  dialogs.losses.clear();
  EXPECT_TRUE(document.OnSaveDocument(folder.File("other.tessal"))) << "harms no file";
  EXPECT_TRUE(dialogs.losses.empty());
  ASSERT_TRUE(document.OnOpenCopy(folder.File("copy.tessal"), path));
  dialogs.lossAnswer.wish = LossAnswer::Wish::Cancel;
  EXPECT_FALSE(document.OnSaveDocument(path)) << "recovered work would replace the file";
  dialogs.lossAnswer.wish = LossAnswer::Wish::Replace;
  EXPECT_TRUE(document.OnSaveDocument(path));
  EXPECT_NE(ReadFile(path), text);
}

TEST(Document, AsksBeforeItSavesWhatHasMessages) {
  const TemporaryFolder folder;
  const std::string path = folder.Write("m.tessal", TemplateText().Constant("k", "-1").Text());
  ScriptedDialogs dialogs;
  CTessalDoc document(dialogs);
  document.visibilityGroup = document.visibilityLevel = 2;
  ASSERT_TRUE(document.OnOpenDocument(path));
  document.SetPathName(path);
  EXPECT_TRUE(document.visibilityRecursive);
  EXPECT_EQ(document.visibilityGroup + document.visibilityLevel, 0) << "the filter of another file";
  const std::string before = ReadFile(path);
  document.Core().GetConstant(0).unit.SetText("kg");
  document.SetModifiedFlag(document.Core().Modified());
  EXPECT_EQ(document.Title(), "m.tessal - Modified");
  dialogs.yes = false;
  EXPECT_FALSE(document.OnSaveDocument(path));
  EXPECT_EQ(dialogs.asked, "This setup contains some errors or warnings.\nProceed anyway?");
  EXPECT_EQ(ReadFile(path), before);
  EXPECT_TRUE(document.IsModified());
  dialogs.yes = true;
  EXPECT_TRUE(document.OnSaveDocument(path));
  EXPECT_FALSE(document.IsModified());
  EXPECT_NE(ReadFile(path), before);
  document.SetModifiedFlag(true);
  EXPECT_EQ(document.Title(), "m.tessal - Modified") << "not twice";
}

TEST(Document, AFailedSaveLeavesItModified) {
  ScriptedDialogs dialogs;
  CTessalDoc document(dialogs);
  Errors().Reset();
  document.Core().AddConstant();
  document.SetModifiedFlag(true);
  EXPECT_FALSE(document.OnSaveDocument("/nowhere/m.tessal"));
  EXPECT_EQ(dialogs.shown.substr(0, 40), "Failed to save file '/nowhere/m.tessal'\n");
  EXPECT_NE(dialogs.shown.find("No such file"), std::string::npos);
  EXPECT_TRUE(document.IsModified());
}

}  // namespace
}  // namespace tessal
