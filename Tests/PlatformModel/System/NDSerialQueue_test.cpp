#include "PlatformModel/System/NDSerialQueue.h"

#include <gtest/gtest.h>

#include <array>
#include <atomic>
#include <future>
#include <memory>
#include <string>
#include <vector>

#include "PlatformModel/RunOnThreads.h"
#include "PlatformModel/System/NDConcurrentQueue.h"
#include "PlatformModel/System/NDMainQueue.h"

namespace nidus {
namespace {

TEST(NDSerialQueueTest, KeepsItsLabel) {
  const NDSerialQueue queue("sync", std::make_shared<NDMainQueue>());
  EXPECT_EQ(queue.label(), "sync");
}

TEST(NDSerialQueueTest, KeepsOrderUnderLoad) {
  constexpr std::size_t kThreads = 4;
  constexpr int kEach = 500;
  const auto target = std::make_shared<NDConcurrentQueue>(4);
  NDSerialQueue queue("load", target);
  std::array<std::vector<int>, kThreads> seen;  // written by the queue's work alone
  runOnThreads(seen.size(), [&queue, &seen](std::size_t number) {
    auto& numbers = seen[number];
    for (int i = 0; i < kEach; ++i) queue.async([&numbers, i] { numbers.push_back(i); });
  });
  target->waitUntilIdle();
  for (const auto& numbers : seen) {
    ASSERT_EQ(numbers.size(), std::size_t{kEach});
    for (int i = 0; i < kEach; ++i) ASSERT_EQ(numbers[static_cast<std::size_t>(i)], i);
  }
}

TEST(NDSerialQueueTest, RunsOnePieceAtATime) {
  const auto target = std::make_shared<NDConcurrentQueue>(4);
  NDSerialQueue queue("one", target);
  std::atomic<int> running{0};
  std::atomic<bool> isExceeded{false};
  for (int i = 0; i < 500; ++i) {
    queue.async([&] {
      if (++running > 1) isExceeded = true;
      --running;
    });
  }
  target->waitUntilIdle();
  EXPECT_FALSE(isExceeded);
}

/// Serial queues on a target that the test runs piece by piece.
class DrainedSerialQueueTest : public testing::Test {
 protected:
  void add(NDSerialQueue& queue, const std::string& name) {
    queue.async([this, name] { ran_ += name; });
  }

  std::shared_ptr<NDMainQueue> target_ = std::make_shared<NDMainQueue>();
  std::shared_ptr<NDSerialQueue> queue_ = std::make_shared<NDSerialQueue>("drained", target_);
  std::string ran_;
};

TEST_F(DrainedSerialQueueTest, NeverRunsInsideAsync) {
  add(*queue_, "a");
  EXPECT_EQ(ran_, "");
  target_->drain();
  EXPECT_EQ(ran_, "a");
}

TEST_F(DrainedSerialQueueTest, QueuesOfOneTargetTakeTurns) {
  NDSerialQueue other("other", target_);
  add(*queue_, "a");
  add(*queue_, "b");
  add(other, "1");
  add(other, "2");
  target_->drain();
  EXPECT_EQ(ran_, "a1b2");
}

TEST_F(DrainedSerialQueueTest, WorkAddsWorkBehindWhatWaits) {
  queue_->async([this] {
    add(*queue_, "c");
    ran_ += "a";
  });
  add(*queue_, "b");
  target_->drain();
  EXPECT_EQ(ran_, "abc");
}

TEST_F(DrainedSerialQueueTest, RunsAgainAfterItWasEmpty) {
  add(*queue_, "a");
  target_->drain();
  add(*queue_, "b");
  target_->drain();
  EXPECT_EQ(ran_, "ab");
}

TEST_F(DrainedSerialQueueTest, ReleasesPieceBeforeTheNext) {
  auto held = std::make_shared<int>();
  const std::weak_ptr<int> isHeld = held;
  queue_->async([held] {});
  held.reset();
  queue_->async([this, isHeld] { ran_ = isHeld.expired() ? "released" : "held"; });
  target_->drain();
  EXPECT_EQ(ran_, "released");
}

TEST_F(DrainedSerialQueueTest, ReleaseOfQueueKeepsItsWork) {
  add(*queue_, "a");
  add(*queue_, "b");
  queue_.reset();
  target_->drain();
  EXPECT_EQ(ran_, "ab");
}

TEST_F(DrainedSerialQueueTest, WorkMayReleaseItsQueue) {
  queue_->async([this] { queue_.reset(); });
  add(*queue_, "a");
  target_->drain();
  EXPECT_EQ(ran_, "a");
  EXPECT_EQ(queue_, nullptr);
}

TEST(NDSerialQueueTest, TargetThatEndsDropsAllWork) {
  const auto target = std::make_shared<NDConcurrentQueue>(1);
  auto queue = std::make_shared<NDSerialQueue>("dropped", target);
  const std::weak_ptr<NDSerialQueue> isQueueAlive = queue;
  queue->async([queue, target] { target->shutDown(); });
  queue->async([queue] { FAIL(); });
  queue->async([queue] { FAIL(); });
  queue.reset();
  target->waitUntilIdle();
  EXPECT_TRUE(isQueueAlive.expired());
}

TEST(NDSerialQueueTest, DropsWorkOfEndedTarget) {
  const auto target = std::make_shared<NDConcurrentQueue>(1);
  NDSerialQueue queue("ended", target);
  target->shutDown();
  for (int i = 0; i < 2; ++i) {
    auto held = std::make_shared<int>();
    const std::weak_ptr<int> isHeld = held;
    queue.async([held = std::move(held)] { FAIL(); });
    EXPECT_TRUE(isHeld.expired());
  }
}

TEST(NDSerialQueueTest, LastReferenceToTargetMayEndInWork) {
  for (int round = 0; round < 100; ++round) {
    auto target = std::make_shared<NDConcurrentQueue>(2);
    const auto ran = std::make_shared<std::promise<void>>();
    std::future<void> whenRun = ran->get_future();
    {
      NDSerialQueue queue("last", std::move(target));
      queue.async([ran] { ran->set_value(); });
    }
    whenRun.wait();
  }
}

}  // namespace
}  // namespace nidus
