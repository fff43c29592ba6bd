#include "HomePlatform/System/PlatformQueues.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <atomic>
#include <thread>
#include <vector>

#include "HomePlatform/System/CallerClock.h"
#include "HomePlatform/System/TrackedQueue.h"

namespace nidus {
namespace {

using testing::ElementsAre;

TEST(PlatformQueuesTest, CallerRunsAllWorkInOrder) {
  const auto queues = PlatformQueues::makeOnCaller(nullptr);
  const auto caller = std::this_thread::get_id();
  std::vector<int> order;
  queues->shared()->async([&] { order.push_back(1); });
  queues->deliveries()->async([&] {
    order.push_back(2);
    EXPECT_EQ(std::this_thread::get_id(), caller);
  });
  queues->main()->async([&] { order.push_back(3); });
  queues->drain();
  EXPECT_THAT(order, ElementsAre(1, 2, 3));
}

TEST(PlatformQueuesTest, DeliveriesHaveTheirOwnThread) {
  const auto queues = PlatformQueues::makeThreaded(nullptr);
  std::atomic<bool> isDelivered{false};
  for (int task = 0; task < 8; ++task) {
    queues->shared()->async([&] { isDelivered.wait(false); });
  }
  queues->deliveries()->async([&] {
    isDelivered = true;
    isDelivered.notify_all();
  });
  queues->drain();
  EXPECT_TRUE(isDelivered.load());
  queues->shutDown();
}

TEST(PlatformQueuesTest, TokenKeepsDrainWaiting) {
  const auto queues = PlatformQueues::makeThreaded(nullptr);
  bool hasRun = false;
  std::thread other([&hasRun, main = queues->main(), token = queues->token()] {
    main->async([&hasRun] { hasRun = true; });
  });
  queues->drain();
  EXPECT_TRUE(hasRun);
  other.join();
  queues->shutDown();
}

TEST(PlatformQueuesTest, TakesTheOpenersClock) {
  const auto clock = std::make_shared<NDSystemClock>();
  EXPECT_EQ(PlatformQueues::makeThreaded(clock)->clock(), clock);
  EXPECT_EQ(PlatformQueues::makeOnCaller(clock)->clock(), clock);
}

TEST(TrackedQueueTest, CountsUntilWorkIsReleased) {
  const auto tracker = std::make_shared<WorkTracker>(std::weak_ptr<NDMainQueue>());
  TrackedQueue queue(1, tracker);
  const auto held = std::make_shared<int>(0);
  queue.async([held] {});
  queue.shutDown();
  EXPECT_TRUE(tracker->isIdle());
  EXPECT_EQ(held.use_count(), 1);
}

TEST(CallerQueueTest, DropsWorkAfterShutDown) {
  CallerQueue queue;
  const auto held = std::make_shared<int>(0);
  queue.async([held] {});
  queue.shutDown();
  queue.async([held] {});
  EXPECT_EQ(held.use_count(), 1);
  EXPECT_FALSE(queue.runOne());
}

class CallerClockTest : public testing::Test {
 protected:
  bool waitUntil(NDClock::Duration time, const std::function<bool()>& isDone) {
    std::mutex mutex;
    std::condition_variable changed;
    std::unique_lock<std::mutex> lock(mutex);
    const bool result = clock_.waitUntil(lock, changed, NDClock::TimePoint(time), isDone);
    EXPECT_TRUE(lock.owns_lock());
    return result;
  }

  const std::shared_ptr<CallerQueue> queue_ = std::make_shared<CallerQueue>();
  CallerClock clock_{queue_};
};

TEST_F(CallerClockTest, WaitRunsWorkUntilDone) {
  int steps = 0;
  for (int task = 0; task < 5; ++task) queue_->async([&steps] { ++steps; });
  EXPECT_TRUE(waitUntil(std::chrono::seconds(1), [&steps] { return steps == 3; }));
  EXPECT_EQ(steps, 3);
  EXPECT_EQ(clock_.now(), NDClock::TimePoint());
}

TEST_F(CallerClockTest, HopelessWaitJumpsToDeadline) {
  EXPECT_FALSE(waitUntil(std::chrono::seconds(1), [] { return false; }));
  EXPECT_EQ(clock_.now(), NDClock::TimePoint(std::chrono::seconds(1)));
}

TEST_F(CallerClockTest, TimeNeverGoesBack) {
  EXPECT_FALSE(waitUntil(std::chrono::seconds(2), [] { return false; }));
  EXPECT_FALSE(waitUntil(std::chrono::seconds(1), [] { return false; }));
  EXPECT_EQ(clock_.now(), NDClock::TimePoint(std::chrono::seconds(2)));
}

}  // namespace
}  // namespace nidus
