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

TEST(Save, FailuresOfTheFileSystemAreTold) {
  LoadedTemplate loaded(TemplateText().Constant("k").Text());
  EXPECT_FALSE(loaded->SaveWrapper("/nowhere/at/all.tessal"));
  EXPECT_NE(Messages().find("3 SAVE : can not create a file beside '/nowhere/at/all.tessal': No such file"),
            std::string::npos);
  const TemporaryFolder folder;
  std::filesystem::create_directory(folder.File("taken"));
  EXPECT_FALSE(loaded->SaveWrapper(folder.File("taken")));
  EXPECT_NE(Messages().find("directory"), std::string::npos);
  EXPECT_EQ(loaded->SaveFileName(), loaded.Path());
  // Whatever else has a name like that is the user's own.
  std::filesystem::copy_file(loaded.Path(), loaded.Path() + "$");
  EXPECT_TRUE(loaded->SaveWrapper(loaded.Path()));
  EXPECT_TRUE(std::filesystem::exists(loaded.Path() + "$"));
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
