#include "AssistantHost/AssistantModule.h"

#include <gmock/gmock.h>

#include "Support/TestFolder.h"

namespace nidus {
namespace {

using ::testing::AllOf;
using ::testing::HasSubstr;

TEST(AssistantModuleTest, OpensTheModule) {
  const auto module = openAssistantModule(NIDUS_MODULE_FILE);
  ASSERT_TRUE(module) << module.failure().message;
  EXPECT_EQ((*module)->interfaceVersion, kNDAssistantModuleInterfaceVersion);
  EXPECT_STREQ((*module)->abi, kNDAssistantModuleABI);
}

TEST(AssistantModuleTest, GivesOneModuleTwice) {
  const auto first = openAssistantModule(NIDUS_MODULE_FILE);
  const auto second = openAssistantModule(NIDUS_MODULE_FILE);
  ASSERT_TRUE(first && second);
  EXPECT_EQ(*first, *second);
}

TEST(AssistantModuleTest, FindsTheModuleBesideTheProgram) {
  const auto file = findAssistantModule();
  ASSERT_TRUE(file) << file.failure().message;
  EXPECT_TRUE(std::filesystem::equivalent(*file, NIDUS_MODULE_FILE));
}

struct BadModule {
  const char* label;
  std::string file;
  const char* reason;
};

TEST(AssistantModuleTest, RefusesWhatIsNoModule) {
  const TestFolder folder;
  const BadModule table[] = {
      {"missing", folder.file("missing.so"), "cannot be opened"},
      {"text", folder.write("text.so", "no library"), "cannot be opened"},
      {"a library without the entry", NIDUS_PLATFORM_MODEL_FILE, "is not a plug-in module"},
  };
  for (const BadModule& bad : table) {
    SCOPED_TRACE(bad.label);
    const auto module = openAssistantModule(bad.file);
    ASSERT_FALSE(module);
    EXPECT_EQ(module.failure().kind, Failure::Kind::platform);
    EXPECT_THAT(module.failure().message,
                AllOf(HasSubstr(bad.file + ": "), HasSubstr(bad.reason), HasSubstr("; install")));
  }
}

TEST(CheckAssistantModuleTest, AcceptsItsOwnVersion) {
  NDAssistantModule offered = {};
  offered.interfaceVersion = kNDAssistantModuleInterfaceVersion;
  offered.abi = kNDAssistantModuleABI;
  EXPECT_FALSE(checkAssistantModule(&offered, "module.so"));
}

TEST(CheckAssistantModuleTest, RefusesAnotherInterface) {
  NDAssistantModule offered = {};
  offered.interfaceVersion = kNDAssistantModuleInterfaceVersion + 1;
  const auto failure = checkAssistantModule(&offered, "module.so");
  ASSERT_TRUE(failure);
  EXPECT_THAT(failure->message, HasSubstr("module.so: offers interface"));
}

TEST(CheckAssistantModuleTest, RefusesAnotherCompiler) {
  NDAssistantModule offered = {};
  offered.interfaceVersion = kNDAssistantModuleInterfaceVersion;
  offered.abi = "c++abi-1";
  const auto failure = checkAssistantModule(&offered, "module.so");
  ASSERT_TRUE(failure);
  EXPECT_THAT(failure->message, HasSubstr("module.so: was built for c++abi-1, this program for "));
}

TEST(CheckAssistantModuleTest, RefusesNothingAtAll) {
  EXPECT_TRUE(checkAssistantModule(nullptr, "module.so"));
}

}  // namespace
}  // namespace nidus
