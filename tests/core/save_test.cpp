#include <gtest/gtest.h>
#include <sys/stat.h>

#include <filesystem>

#include "core/error_registry.h"
#include "core/loaded_template.h"
#include "expr/user_function_names.h"
#include "support/template_text.h"

namespace tessal {
namespace {

using test::LoadedTemplate;
using test::Messages;
using test::ReadFile;
using test::TemplateText;
using test::TemporaryFolder;

TEST(Save, TheFileBeginsAndEndsItsLinesAsTheFormatSays) {
  LoadedTemplate loaded(test::RandomTemplate(2, 8));
  ASSERT_TRUE(loaded->SaveWrapper(loaded.Path()));
  const std::string text = ReadFile(loaded.Path());
  EXPECT_EQ(text.substr(0, text.find("[TESSAL")),
            "// Tessal template\r\n// Key-file text: sections, keywords, parameters\r\n"
            "// Written by the template editor\r\n// type = 2\r\n\r\n");
  for (std::size_t place = text.find('\n'); place != std::string::npos; place = text.find('\n', place + 1)) {
    ASSERT_EQ(text[place - 1], '\r') << place;
  }
  EXPECT_NE(text.find("[EXTRA] // kept\r\n   // remark\r\n   A = 1,0.1,'x',|y|\r\nEndSect // EXTRA\r\n"),
            std::string::npos);
  EXPECT_FALSE(loaded->Modified());
}

TEST(Save, UnderANewNameStampsTheFile) {
  LoadedTemplate loaded(TemplateText().Misc("DOCUMENT_REVISION = 41\nTRIGONOMETRICS = 'Degree'\n").Text());
  ASSERT_TRUE(loaded->SaveWrapper(loaded.Path()));
  EXPECT_EQ(loaded->GetDocumentRevision(), 42);
  EXPECT_EQ(loaded->GetMisc()->tessalVersion.RealValue(), 2017001 * 0.001);
  const std::string other = loaded.Path() + ".copy";
  ASSERT_TRUE(loaded->SaveWrapper(other));
  EXPECT_EQ(loaded->GetDocumentRevision(), 1);
  EXPECT_GT(loaded->GetMisc()->tessalVersion.RealValue(), 2017.001);
  EXPECT_EQ(loaded->GetMisc()->trigonometrics.Text(), "Degree");
  EXPECT_TRUE(loaded->GetMisc()->optimise.BoolValue());
  EXPECT_EQ(loaded->SaveFileName(), other);
}

TEST(Save, AFileWithoutSettingsGetsThemOnlyUnderANewName) {
  LoadedTemplate loaded(TemplateText().Constant("k").Text());
  ASSERT_TRUE(loaded->SaveWrapper(loaded.Path()));
  EXPECT_EQ(ReadFile(loaded.Path()).find("[MISC]"), std::string::npos);
  ASSERT_TRUE(loaded->SaveWrapper(loaded.Path() + "2"));
  const std::string text = ReadFile(loaded.Path() + "2");
  EXPECT_NE(text.find("TRIGONOMETRICS = 'Radians'"), std::string::npos);
  EXPECT_EQ(text.find("LAGRANGE"), std::string::npos);
  EXPECT_NE(text.find("[STATE_VARIABLE_EQUATIONS]"), std::string::npos);
  // A file that had no revision never starts to count.
  LoadedTemplate uncounted(TemplateText().Misc().Text());
  ASSERT_TRUE(uncounted->SaveWrapper(uncounted.Path()));
  EXPECT_EQ(uncounted->GetDocumentRevision(), -1);
}

TEST(Save, WhatTheFormatCannotHoldIsToldAndTheFileStays) {
  LoadedTemplate loaded(
      TemplateText().Misc("DOCUMENT_REVISION = 1\n").Constant("k").StateVariable("S", "0").Text());
  const std::string before = ReadFile(loaded.Path());
  loaded->GetConstant(0).description.SetText("both ' and |");
  EXPECT_FALSE(loaded->SaveWrapper(loaded.Path()));
  EXPECT_NE(Messages().find("3 k: could not write key DESCRIPTION"), std::string::npos);
  loaded->GetConstant(0).description.SetText(std::string_view("zero\0byte", 9));
  EXPECT_FALSE(loaded->SaveWrapper(loaded.Path()));
  loaded->GetConstant(0).description.SetText("fine");
  loaded->GetStateVariable(0).symbol.SetText("two words");
  EXPECT_FALSE(loaded->SaveWrapper(loaded.Path()));
  EXPECT_NE(Messages().find("3 two words: could not write key two words"), std::string::npos);
  EXPECT_EQ(ReadFile(loaded.Path()), before);
  EXPECT_EQ(loaded->GetDocumentRevision(), 1);
  EXPECT_TRUE(loaded->Modified());
  EXPECT_FALSE(std::filesystem::exists(loaded.Path() + "$"));
  // A name that only the tree reader refuses is good, and the extra sections stay.
  loaded->GetStateVariable(0).symbol.SetText("True");
  EXPECT_TRUE(loaded->SaveWrapper(loaded.Path()));
}

TEST(Save, FailuresOfTheFileSystemAreTold) {
  LoadedTemplate loaded(TemplateText().Constant("k").Text());
  EXPECT_FALSE(loaded->SaveWrapper("/nowhere/at/all.tessal"));
  EXPECT_NE(Messages().find("3 SAVE : can not open file for writing '/nowhere/at/all.tessal$': No such file"),
            std::string::npos);
  const TemporaryFolder folder;
  std::filesystem::create_directory(folder.File("taken"));
  EXPECT_FALSE(loaded->SaveWrapper(folder.File("taken")));
  EXPECT_NE(Messages().find("directory"), std::string::npos);
  EXPECT_EQ(loaded->SaveFileName(), loaded.Path());
  // A temporary file that an earlier save left behind is in nobody's way.
  std::filesystem::copy_file(loaded.Path(), loaded.Path() + "$");
  EXPECT_TRUE(loaded->SaveWrapper(loaded.Path()));
  EXPECT_FALSE(std::filesystem::exists(loaded.Path() + "$"));
}

TEST(Save, ThroughALinkTheLinkStays) {
  LoadedTemplate original(TemplateText().Constant("k").Text());
  const TemporaryFolder folder;
  std::filesystem::create_symlink(original.Path(), folder.File("link.tessal"));
  chmod(original.Path().c_str(), 0600);
  TemplateCore core;
  ASSERT_TRUE(core.LoadWrapper(folder.File("link.tessal")));
  core.AddConstant();
  ASSERT_TRUE(core.SaveWrapper(folder.File("link.tessal")));
  EXPECT_TRUE(std::filesystem::is_symlink(folder.File("link.tessal")));
  EXPECT_NE(ReadFile(original.Path()).find("Constant_2"), std::string::npos);
  EXPECT_EQ(std::filesystem::status(original.Path()).permissions(), std::filesystem::perms(0600));
}

TEST(Save, ATemporaryFileThatIsALinkLeadsNowhere) {
  LoadedTemplate loaded(TemplateText().Constant("k").Text());
  const TemporaryFolder folder;
  const std::string victim = folder.Write("victim", "precious");
  std::filesystem::create_symlink(victim, loaded.Path() + "$");
  ASSERT_TRUE(loaded->SaveWrapper(loaded.Path()));
  EXPECT_EQ(ReadFile(victim), "precious");
}

TEST(Save, TheLastRevisionStays) {
  LoadedTemplate loaded(TemplateText().Misc("DOCUMENT_REVISION = 99999999999\n").Text());
  ASSERT_TRUE(loaded->SaveWrapper(loaded.Path()));
  EXPECT_NE(ReadFile(loaded.Path()).find("DOCUMENT_REVISION = 2147483647\r\n"), std::string::npos);
}

TEST(Save, UserFunctionsComeAndGoWithTheirTemplate) {
  LoadedTemplate loaded(TemplateText().Misc().Auxiliary("a", "Mix(1)").Text());
  EXPECT_EQ(loaded.Undefined(), "Mix ");
  loaded->GetMisc()->AddExternalFunction().publicName.SetText("Mix");
  loaded->RebuildSymbolTable();
  EXPECT_EQ(loaded.Undefined(), "");
  ASSERT_TRUE(loaded->SaveWrapper(loaded.Path()));
  {
    TemplateCore again;
    ASSERT_TRUE(again.LoadWrapper(loaded.Path()));
    EXPECT_EQ(again.GetExternalFunctionCount(), 1U);
    EXPECT_EQ(Messages(), "");
  }
  EXPECT_TRUE(IsUserFunctionName("Mix")) << "the other template is still open";
  CEL_ExternalFunction& twin = loaded->GetMisc()->AddExternalFunction();
  EXPECT_TRUE(IsUserFunctionName("External"));
  twin.publicName.SetText("Mix");
  twin.publicName.SetText("Blend");
  EXPECT_TRUE(IsUserFunctionName("Mix")) << "the first one still has it";
  EXPECT_TRUE(loaded->GetMisc()->RemoveExternalFunction(0));
  EXPECT_FALSE(IsUserFunctionName("Mix"));
  twin.Reset();
  EXPECT_TRUE(IsUserFunctionName("External") && !IsUserFunctionName("Blend"));
}

}  // namespace
}  // namespace tessal
