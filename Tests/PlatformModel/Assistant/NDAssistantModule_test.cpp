#include "PlatformModel/Assistant/NDAssistantModule.h"

#include <gtest/gtest.h>

#include <cstddef>
#include <string>

namespace nidus {
namespace {

// A host of any version reads these two before it touches anything else.
TEST(NDAssistantModuleTest, VersionAndAbiComeFirst) {
  EXPECT_EQ(offsetof(NDAssistantModule, interfaceVersion), 0U);
  EXPECT_EQ(offsetof(NDAssistantModule, abi), sizeof(void*));
}

TEST(NDAssistantModuleTest, AbiNamesCompilerAndLibrary) {
  const std::string expected = "c++abi-" + std::to_string(__GXX_ABI_VERSION) + "/libstdc++-" +
                               std::to_string(_GLIBCXX_RELEASE) + "/string-" +
                               std::to_string(_GLIBCXX_USE_CXX11_ABI);
  EXPECT_EQ(kNDAssistantModuleABI, expected);
}

}  // namespace
}  // namespace nidus
