#include "PlatformModel/System/NDWaitGroup.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <thread>
#include <vector>

#include "PlatformModel/RunOnThreads.h"
#include "PlatformModel/System/NDConcurrentQueue.h"
#include "PlatformModel/System/NDDeliveryHold.h"
#include "PlatformModel/System/NDMainQueue.h"

namespace nidus {
namespace {

using namespace std::chrono_literals;

/// A clock on which a wait that is not over at once lasts to its deadline, in no time.
class LeapingClock : public NDClock {
 public:
  TimePoint now() override { return now_; }
  bool waitUntil(std::unique_lock<std::mutex>& lock, std::condition_variable& /*changed*/,
                 TimePoint deadline, const std::function<bool()>& isDone) override {
    EXPECT_TRUE(lock.owns_lock());
    if (!isDone()) now_ = deadline;
    return isDone();
  }

 private:
  TimePoint now_{100s};
};

class NDWaitGroupTest : public testing::Test {
 protected:
  void notify(int number) {
    group_->notify(queue_, [this, number] { notified_.push_back(number); });
  }

  std::shared_ptr<LeapingClock> clock_ = std::make_shared<LeapingClock>();
  std::shared_ptr<NDMainQueue> queue_ = std::make_shared<NDMainQueue>();
  std::unique_ptr<NDWaitGroup> group_ = std::make_unique<NDWaitGroup>(clock_);
  std::vector<int> notified_;
};

TEST_F(NDWaitGroupTest, EmptyGroupNotifiesAtOnce) {
  notify(1);
  EXPECT_TRUE(notified_.empty());  // on the queue, not inside the call
  EXPECT_EQ(queue_->drain(), 1U);
  EXPECT_EQ(notified_, std::vector<int>{1});
}

TEST_F(NDWaitGroupTest, NotifiesAfterTheLastLeave) {
  group_->enter();
  group_->enter();
  notify(1);
  notify(2);
  group_->leave();
  EXPECT_EQ(queue_->drain(), 0U);
  group_->leave();
  queue_->drain();
  EXPECT_EQ(notified_, (std::vector<int>{1, 2}));
}

TEST_F(NDWaitGroupTest, NotifiesOnceForEachNotify) {
  group_->enter();
  notify(1);
  group_->leave();
  group_->enter();
  group_->leave();
  EXPECT_EQ(queue_->drain(), 1U);
}

TEST_F(NDWaitGroupTest, NotifiesThoughEnteredAgain) {
  group_->enter();
  notify(1);
  group_->leave();
  group_->enter();
  EXPECT_EQ(queue_->drain(), 1U);
}

TEST_F(NDWaitGroupTest, NotificationMayUseTheGroup) {
  group_->enter();
  group_->notify(queue_, [this] {
    group_->enter();
    notify(2);
    group_->leave();
  });
  group_->leave();
  queue_->drain();
  EXPECT_EQ(notified_, std::vector<int>{2});
}

TEST_F(NDWaitGroupTest, GroupTakesItsNotificationsAlong) {
  auto held = std::make_shared<int>();
  const std::weak_ptr<int> isHeld = held;
  group_->enter();
  group_->notify(queue_, [held = std::move(held)] { FAIL(); });
  group_.reset();
  EXPECT_TRUE(isHeld.expired());
}

TEST_F(NDWaitGroupTest, WaitOfEmptyGroupTakesNoTime) {
  const auto before = clock_->now();
  EXPECT_TRUE(group_->wait(2s));
  EXPECT_EQ(clock_->now(), before);
}

TEST_F(NDWaitGroupTest, WaitEndsAtItsDeadline) {
  const auto before = clock_->now();
  group_->enter();
  EXPECT_FALSE(group_->wait(2s));
  EXPECT_EQ(clock_->now(), before + 2s);
}

TEST_F(NDWaitGroupTest, WaitOfNoTimeOnlyAsks) {
  const auto before = clock_->now();
  group_->enter();
  EXPECT_FALSE(group_->wait(0s));
  group_->leave();
  EXPECT_TRUE(group_->wait(0s));
  EXPECT_EQ(clock_->now(), before);
}

TEST_F(NDWaitGroupTest, LongestWaitEndsWithTime) {
  group_->enter();
  EXPECT_FALSE(group_->wait(NDClock::Duration::max()));
  EXPECT_EQ(clock_->now(), NDClock::TimePoint::max());
}

TEST_F(NDWaitGroupTest, WaitLetsDeliveriesGo) {
  const NDDeliveryHold hold;
  group_->enter();
  NDDeliveryHold::whenReleased([this] { group_->leave(); });
  EXPECT_TRUE(group_->wait(2s));
}

TEST(NDWaitGroupThreadsTest, LastLeaveWakesAllWaiters) {
  NDWaitGroup group(std::make_shared<NDSystemClock>());
  group.enter();
  group.enter();
  runOnThreads(5, [&group](std::size_t number) {
    if (number < 2) {
      group.leave();
    } else {
      EXPECT_TRUE(group.wait(1h));
    }
  });
}

TEST(NDWaitGroupThreadsTest, WaiterMayDestroyTheGroup) {
  const auto clock = std::make_shared<NDSystemClock>();
  NDConcurrentQueue queue(2);
  for (int round = 0; round < 300; ++round) {
    auto group = std::make_unique<NDWaitGroup>(clock);
    group->enter();
    queue.async([&left = *group] { left.leave(); });
    EXPECT_TRUE(group->wait(1h));
    group.reset();
  }
  queue.waitUntilIdle();
}

TEST(NDWaitGroupThreadsTest, NotificationMayDestroyTheGroup) {
  const auto queue = std::make_shared<NDConcurrentQueue>(2);
  for (int round = 0; round < 300; ++round) {
    auto group = std::make_unique<NDWaitGroup>(std::make_shared<NDSystemClock>());
    NDWaitGroup& left = *group;
    group->enter();
    group->notify(queue, [&group] { group.reset(); });
    left.leave();
    queue->waitUntilIdle();
    EXPECT_EQ(group, nullptr);
  }
}

TEST(NDWaitGroupThreadsTest, NotifyMeetsLeave) {
  const auto queue = std::make_shared<NDMainQueue>();
  for (int round = 0; round < 300; ++round) {
    NDWaitGroup group(std::make_shared<NDSystemClock>());
    group.enter();
    std::thread leaver([&group] { group.leave(); });
    group.notify(queue, [] {});
    leaver.join();
    EXPECT_EQ(queue->drain(), 1U);
  }
}

TEST(NDWaitGroupThreadsTest, JoinsWorkOfManyThreads) {
  const auto queue = std::make_shared<NDConcurrentQueue>(4);
  NDWaitGroup group(std::make_shared<NDSystemClock>());
  std::atomic<int> done{0};
  for (int i = 0; i < 200; ++i) {
    group.enter();
    queue->async([&] {
      ++done;
      group.leave();
    });
  }
  EXPECT_TRUE(group.wait(1h));
  EXPECT_EQ(done, 200);
  queue->waitUntilIdle();
}

}  // namespace
}  // namespace nidus
