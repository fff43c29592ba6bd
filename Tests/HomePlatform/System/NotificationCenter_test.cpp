#include "HomePlatform/System/NotificationCenter.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <vector>

#include "PlatformModel/System/NDMainQueue.h"

namespace nidus {
namespace {

using testing::ElementsAre;

class NotificationCenterTest : public testing::Test {
 protected:
  [[nodiscard]] std::shared_ptr<NDNotificationCenter::Token> count(const char* name, int& counter) {
    return center_.registerForName_queue_handler(name, queue_, [&counter] { ++counter; });
  }

  const std::shared_ptr<NDMainQueue> queue_ = std::make_shared<NDMainQueue>();
  std::vector<std::string> names_;
  NotificationCenter center_{[this](const NDString& name) { names_.push_back(name.str()); }};
  int first_ = 0;
  int second_ = 0;
};

TEST_F(NotificationCenterTest, RunsHandlersOnTheirQueue) {
  const auto token = count("changed", first_);
  center_.post("changed");
  EXPECT_EQ(first_, 0);
  queue_->drain();
  EXPECT_EQ(first_, 1);
}

TEST_F(NotificationCenterTest, TellsNamesApart) {
  const auto token = count("changed", first_);
  const auto other = count("other", second_);
  center_.post("other");
  queue_->drain();
  EXPECT_EQ(first_, 0);
  EXPECT_EQ(second_, 1);
}

TEST_F(NotificationCenterTest, RunsEveryRegistration) {
  const auto token = count("changed", first_);
  const auto other = count("changed", second_);
  center_.post("changed");
  center_.post("changed");
  queue_->drain();
  EXPECT_EQ(first_, 2);
  EXPECT_EQ(second_, 2);
}

TEST_F(NotificationCenterTest, ReleasedTokenEndsRegistration) {
  auto token = count("changed", first_);
  token.reset();
  center_.post("changed");
  EXPECT_EQ(queue_->drain(), 0U);
}

TEST_F(NotificationCenterTest, ReleasedTokenStopsQueuedHandler) {
  auto token = count("changed", first_);
  center_.post("changed");
  token.reset();
  queue_->drain();
  EXPECT_EQ(first_, 0);
}

TEST_F(NotificationCenterTest, HandlerMayEndItsOwnRegistration) {
  std::shared_ptr<NDNotificationCenter::Token> token;
  token = center_.registerForName_queue_handler("changed", queue_, [&] {
    ++first_;
    token.reset();
  });
  center_.post("changed");
  center_.post("changed");
  queue_->drain();
  EXPECT_EQ(first_, 1);
}

TEST_F(NotificationCenterTest, TellsOfRegistrations) {
  const auto token = count("changed", first_);
  EXPECT_THAT(names_, ElementsAre("changed"));
}

TEST(NotificationCenterLifeTest, TokenOutlivesCenter) {
  auto center = std::make_unique<NotificationCenter>(nullptr);
  auto token =
      center->registerForName_queue_handler("changed", std::make_shared<NDMainQueue>(), [] {});
  center.reset();
  EXPECT_EQ(token.use_count(), 1);
}

}  // namespace
}  // namespace nidus
