#include "Support/PlatformTest.h"

#include <cstdlib>

namespace nidus {

PlatformTest::PlatformTest() {
  EXPECT_EQ(NDPlatform::registerPlatform(TestPlatform::shared()), "");
  platform().setHomes({});
  platform().setSilent(false);
  platform().configureHomes(true);
  platform().setLocale(true);
  platform().setLogLevel(6);
  platform().clearLog();
}

PlatformTest::~PlatformTest() {
  platform().runUntilIdle();
  platform().setHomes({});
  NDPlatform::unregisterPlatform(TestPlatform::shared());
}

std::shared_ptr<TestHome> PlatformTest::useHome(HomeBuilder& builder) {
  auto home = builder.build();
  platform().setHomes({home});
  return home;
}

void inFreshProcess(const std::function<void()>& body) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  EXPECT_EXIT(
      {
        body();
        std::_Exit(::testing::Test::HasFailure() ? EXIT_FAILURE : EXIT_SUCCESS);
      },
      ::testing::ExitedWithCode(EXIT_SUCCESS), "");
}

}  // namespace nidus
