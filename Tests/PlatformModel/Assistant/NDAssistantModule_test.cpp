#include "PlatformModel/Assistant/NDAssistantModule.h"

#include <gtest/gtest.h>

#include <cstddef>
#include <regex>

namespace nidus {
namespace {

// A host of any version reads these two before it touches anything else.
TEST(NDAssistantModuleTest, VersionAndAbiComeFirst) {
  EXPECT_EQ(offsetof(NDAssistantModule, interfaceVersion), 0U);
  EXPECT_EQ(offsetof(NDAssistantModule, abi), sizeof(void*));
}

TEST(NDAssistantModuleTest, AbiNamesCompilerAndLibrary) {
  const std::regex form("c\\+\\+abi-[0-9]+/libstdc\\+\\+-[0-9]+/string-[01]");
  EXPECT_TRUE(std::regex_match(kNDAssistantModuleABI, form)) << kNDAssistantModuleABI;
}

}  // namespace
}  // namespace nidus
