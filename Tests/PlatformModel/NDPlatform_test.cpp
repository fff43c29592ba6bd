#include "PlatformModel/NDPlatform.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <atomic>

#include "PlatformModel/RunOnThreads.h"

namespace nidus {
namespace {

using testing::IsEmpty;
using testing::Not;
using testing::Return;

class MockPlatform : public NDPlatform {
 public:
  MOCK_METHOD(std::shared_ptr<NDHomeManager>, createHomeManager, (), (override));
  MOCK_METHOD(NDString, homeConfigurationPath, (), (override));
  MOCK_METHOD(std::shared_ptr<NDNAPMetadata>, metadata, (), (override));
  MOCK_METHOD(std::shared_ptr<NDPreferences>, preferences, (), (override));
  MOCK_METHOD(std::shared_ptr<NDDeviceInformation>, deviceInformation, (), (override));
  MOCK_METHOD(std::shared_ptr<NDLocale>, locale, (), (override));
  MOCK_METHOD(std::shared_ptr<NDSystemLog>, systemLog, (), (override));
  MOCK_METHOD(std::shared_ptr<NDNotificationCenter>, notificationCenter, (), (override));
  MOCK_METHOD(std::shared_ptr<NDMainQueue>, mainQueue, (), (override));
  MOCK_METHOD(std::shared_ptr<NDQueue>, sharedQueue, (), (override));
  MOCK_METHOD(std::shared_ptr<NDClock>, clock, (), (override));
};

/// A manager without homes, which keeps no delegate.
class EmptyHomeManager : public NDHomeManager {
 public:
  [[nodiscard]] NDArray<NDHome> homes() const override { return {}; }
  void setDelegate(std::weak_ptr<NDHomeManagerDelegate> /*delegate*/) override {}
};

class NDPlatformTest : public testing::Test {
 protected:
  ~NDPlatformTest() override { NDPlatform::unregisterPlatform(NDPlatform::registered()); }

  std::shared_ptr<MockPlatform> platform_ = std::make_shared<MockPlatform>();
};

TEST_F(NDPlatformTest, IsAbsentUntilRegistered) {
  EXPECT_EQ(NDPlatform::registered(), nullptr);
  EXPECT_THAT(NDPlatform::registerPlatform(platform_), IsEmpty());
  EXPECT_EQ(NDPlatform::registered(), platform_);
}

TEST_F(NDPlatformTest, RefusesASecondOne) {
  ASSERT_THAT(NDPlatform::registerPlatform(platform_), IsEmpty());
  EXPECT_THAT(NDPlatform::registerPlatform(std::make_shared<MockPlatform>()), Not(IsEmpty()));
  EXPECT_THAT(NDPlatform::registerPlatform(platform_), Not(IsEmpty()));
  EXPECT_EQ(NDPlatform::registered(), platform_);
}

TEST_F(NDPlatformTest, RefusesNull) {
  EXPECT_THAT(NDPlatform::registerPlatform(nullptr), Not(IsEmpty()));
  EXPECT_EQ(NDPlatform::registered(), nullptr);
}

TEST_F(NDPlatformTest, RegistrationKeepsItAlive) {
  const std::weak_ptr<MockPlatform> isAlive = platform_;
  ASSERT_THAT(NDPlatform::registerPlatform(platform_), IsEmpty());
  platform_.reset();
  EXPECT_FALSE(isAlive.expired());
  NDPlatform::unregisterPlatform(NDPlatform::registered());
  EXPECT_TRUE(isAlive.expired());
}

TEST_F(NDPlatformTest, UnregistersOnlyTheRegisteredOne) {
  ASSERT_THAT(NDPlatform::registerPlatform(platform_), IsEmpty());
  NDPlatform::unregisterPlatform(std::make_shared<MockPlatform>());
  NDPlatform::unregisterPlatform(nullptr);
  EXPECT_EQ(NDPlatform::registered(), platform_);
  NDPlatform::unregisterPlatform(platform_);
  EXPECT_EQ(NDPlatform::registered(), nullptr);
  EXPECT_THAT(NDPlatform::registerPlatform(std::make_shared<MockPlatform>()), IsEmpty());
}

TEST_F(NDPlatformTest, OneOfManyThreadsRegisters) {
  std::atomic<int> accepted{0};
  runOnThreads(4, [&accepted](std::size_t) {
    const auto platform = std::make_shared<MockPlatform>();
    if (NDPlatform::registerPlatform(platform).empty()) ++accepted;
    EXPECT_NE(NDPlatform::registered(), nullptr);
  });
  EXPECT_EQ(accepted, 1);
}

TEST_F(NDPlatformTest, WithoutOneNothingIsMade) {
  EXPECT_EQ(NDHomeManager::create(), nullptr);
  EXPECT_FALSE(getHomeConfigurationPath());
  EXPECT_EQ(NDNAPMetadata::getSharedInstance(), nullptr);
}

TEST_F(NDPlatformTest, RegisteredOneMakesWhatIsAsked) {
  const auto manager = std::make_shared<EmptyHomeManager>();
  EXPECT_CALL(*platform_, createHomeManager).WillOnce(Return(manager));
  EXPECT_CALL(*platform_, homeConfigurationPath).WillOnce(Return(NDString("/data")));
  EXPECT_CALL(*platform_, metadata).WillOnce(Return(nullptr));
  ASSERT_THAT(NDPlatform::registerPlatform(platform_), IsEmpty());
  EXPECT_EQ(NDHomeManager::create(), manager);
  EXPECT_EQ(getHomeConfigurationPath(), "/data");
  EXPECT_EQ(NDNAPMetadata::getSharedInstance(), nullptr);
}

}  // namespace
}  // namespace nidus
