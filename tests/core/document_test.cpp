#include "core/document.h"

#include <gtest/gtest.h>

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
