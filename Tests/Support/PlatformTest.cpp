#include "Support/PlatformTest.h"

namespace nidus {

PlatformTest::PlatformTest() {
  EXPECT_EQ(NDPlatform::registerPlatform(TestPlatform::shared()), "");
  platform().setHomes({});
  platform().setSilent(false);
  platform().setReporting(TestPlatform::Reporting::queued);
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

}  // namespace nidus
