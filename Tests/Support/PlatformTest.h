#pragma once

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "Support/HomeBuilder.h"
#include "Support/TestPlatform.h"

namespace nidus {

/// A test with the test platform registered: the homes are configured but there are none, and
/// levels up to 6 are logged.
class PlatformTest : public ::testing::Test {
 protected:
  PlatformTest();
  ~PlatformTest() override;

  [[nodiscard]] static TestPlatform& platform() { return *TestPlatform::shared(); }
  /// The one home that is found from now on.
  static std::shared_ptr<TestHome> useHome(HomeBuilder& builder);
  static std::shared_ptr<TestHome> useHome(HomeBuilder&& builder) { return useHome(builder); }
  /// The messages in order, each behind its level; those of before the test are left out.
  [[nodiscard]] static std::vector<std::string> log() { return platform().log(); }
};

}  // namespace nidus
