#include "PlatformModel/System/NDConcurrentQueue.h"

#include <gtest/gtest.h>
#include <pthread.h>

#include <atomic>
#include <future>
#include <latch>
#include <memory>
#include <string>
#include <system_error>
#include <thread>
#include <vector>

#include "PlatformModel/RunOnThreads.h"

namespace nidus {
namespace {

/// Runs a function when the last copy of it is destroyed, as the captured state of a task is.
std::shared_ptr<void> whenDestroyed(NDTask task) {
  return {nullptr, [task = std::move(task)](void*) { task(); }};
}

/// While it lives, the machine has no thread to give: a new one would ask for too large a stack.
class ThreadShortage {
 public:
  ThreadShortage() {
    pthread_getattr_default_np(&usual_);
    pthread_attr_t greedy;
    pthread_getattr_default_np(&greedy);
    constexpr std::size_t kMoreThanThereIs = std::size_t{1} << 60;
    pthread_attr_setstacksize(&greedy, kMoreThanThereIs);
    pthread_setattr_default_np(&greedy);
    pthread_attr_destroy(&greedy);
  }
  ~ThreadShortage() {
    pthread_setattr_default_np(&usual_);
    pthread_attr_destroy(&usual_);
  }
  ThreadShortage(const ThreadShortage&) = delete;
  ThreadShortage& operator=(const ThreadShortage&) = delete;

 private:
  pthread_attr_t usual_{};
};

TEST(NDConcurrentQueueTest, OneThreadDoesTheWorkOfMore) {
  NDConcurrentQueue queue(2);
  std::latch isShort(1);
  std::vector<int> order;
  queue.async([&] {
    isShort.wait();
    order.push_back(1);
  });
  {
    const ThreadShortage shortage;
    queue.async([&order] { order.push_back(2); });
  }
  isShort.count_down();
  queue.waitUntilIdle();
  EXPECT_EQ(order, (std::vector<int>{1, 2}));
}

TEST(NDConcurrentQueueTest, WithoutAThreadWorkIsRefused) {
  NDConcurrentQueue queue(2);
  bool hasRun = false;
  {
    const ThreadShortage shortage;
    EXPECT_THROW(queue.async([&hasRun] { hasRun = true; }), std::system_error);
  }
  queue.async([] {});
  queue.waitUntilIdle();
  EXPECT_FALSE(hasRun);
}

TEST(NDConcurrentQueueTest, RunsEachPieceOnce) {
  NDConcurrentQueue queue(4);
  std::vector<std::atomic<int>> runs(1000);
  for (auto& count : runs) queue.async([&count] { ++count; });
  queue.waitUntilIdle();
  for (const auto& count : runs) EXPECT_EQ(count, 1);
}

TEST(NDConcurrentQueueTest, TakesWorkFromManyThreads) {
  NDConcurrentQueue queue(3);
  std::atomic<int> runs{0};
  runOnThreads(4, [&queue, &runs](std::size_t) {
    for (int piece = 0; piece < 250; ++piece) queue.async([&runs] { ++runs; });
  });
  queue.waitUntilIdle();
  EXPECT_EQ(runs, 1000);
}

TEST(NDConcurrentQueueTest, WidthOneRunsInOrder) {
  NDConcurrentQueue queue(1);
  std::vector<int> order;
  for (int i = 0; i < 200; ++i) queue.async([&order, i] { order.push_back(i); });
  queue.waitUntilIdle();
  for (int i = 0; i < 200; ++i) EXPECT_EQ(order[static_cast<std::size_t>(i)], i);
}

TEST(NDConcurrentQueueTest, RunsAsManyAsItsWidth) {
  NDConcurrentQueue queue(3);
  std::latch allRun(3);  // no piece ends before all three run
  for (int i = 0; i < 3; ++i) queue.async([&allRun] { allRun.arrive_and_wait(); });
  queue.waitUntilIdle();
}

TEST(NDConcurrentQueueTest, NeverRunsMoreThanItsWidth) {
  NDConcurrentQueue queue(2);
  std::atomic<int> running{0};
  std::atomic<bool> isExceeded{false};
  for (int i = 0; i < 500; ++i) {
    queue.async([&] {
      if (++running > 2) isExceeded = true;
      --running;
    });
  }
  queue.waitUntilIdle();
  EXPECT_FALSE(isExceeded);
}

TEST(NDConcurrentQueueTest, RunsOnThreadsOfItsOwn) {
  NDConcurrentQueue queue(2);
  std::thread::id ranOn;
  queue.async([&ranOn] { ranOn = std::this_thread::get_id(); });
  queue.waitUntilIdle();
  EXPECT_NE(ranOn, std::thread::id());
  EXPECT_NE(ranOn, std::this_thread::get_id());
}

TEST(NDConcurrentQueueTest, IdleMeansThatWorkIsDestroyed) {
  NDConcurrentQueue queue(2);
  for (int round = 0; round < 200; ++round) {
    bool isDestroyed = false;
    auto held = whenDestroyed([&isDestroyed] { isDestroyed = true; });
    queue.async([held = std::move(held)] {});
    queue.waitUntilIdle();
    EXPECT_TRUE(isDestroyed);
  }
}

TEST(NDConcurrentQueueTest, IsIdleWithoutWork) {
  NDConcurrentQueue queue(1);
  queue.waitUntilIdle();
  queue.shutDown();
  queue.waitUntilIdle();
}

TEST(NDConcurrentQueueTest, DropsWorkAddedAfterShutDown) {
  NDConcurrentQueue queue(1);
  queue.shutDown();
  auto held = std::make_shared<int>();
  const std::weak_ptr<int> isHeld = held;
  queue.async([held = std::move(held)] { FAIL(); });
  EXPECT_TRUE(isHeld.expired());
  queue.waitUntilIdle();
}

/// A queue of one thread, which is busy until `release` is called.
class BusyQueueTest : public testing::Test {
 protected:
  BusyQueueTest() {
    queue_->async([busy = busy_.get_future().share(), this] {
      started_.count_down();
      busy.wait();
    });
    started_.wait();
  }

  void release() { busy_.set_value(); }

  std::latch started_{1};
  std::promise<void> busy_;
  std::shared_ptr<NDConcurrentQueue> queue_ = std::make_shared<NDConcurrentQueue>(1);
};

TEST_F(BusyQueueTest, ShutDownDropsWaitingWork) {
  std::promise<void> dropped;
  auto held = whenDestroyed([&dropped] { dropped.set_value(); });
  queue_->async([held = std::move(held)] { FAIL(); });
  std::thread closer([this] { queue_->shutDown(); });
  dropped.get_future().wait();  // while the first piece still runs
  release();
  closer.join();
}

TEST_F(BusyQueueTest, DroppedWorkMayUseTheQueue) {
  std::promise<void> dropped;
  auto held = whenDestroyed([&, queue = queue_.get()] {
    queue->async([] { FAIL(); });
    dropped.set_value();
  });
  queue_->async([held = std::move(held)] { FAIL(); });
  std::thread closer([this] { queue_->shutDown(); });
  dropped.get_future().wait();
  release();
  closer.join();
}

TEST_F(BusyQueueTest, TwoThreadsMayShutDownTogether) {
  std::atomic<bool> isReleased{false};
  std::latch start(3);
  const auto close = [&] {
    start.arrive_and_wait();
    queue_->shutDown();
    EXPECT_TRUE(isReleased);
  };
  std::thread first(close);
  std::thread second(close);
  start.arrive_and_wait();
  isReleased = true;
  release();
  first.join();
  second.join();
}

TEST_F(BusyQueueTest, ReleaseOfQueueWaitsForWork) {
  std::atomic<bool> isReleased{false};
  std::thread owner([&] {
    queue_.reset();
    EXPECT_TRUE(isReleased);
  });
  isReleased = true;
  release();
  owner.join();
}

TEST(NDConcurrentQueueTest, WorkMayShutDownItsQueue) {
  for (int round = 0; round < 100; ++round) {
    NDConcurrentQueue queue(2);
    std::promise<void> isShutDown;
    queue.async([&] {
      queue.shutDown();
      queue.shutDown();
      isShutDown.set_value();
    });
    isShutDown.get_future().wait();
  }
}

TEST(NDConcurrentQueueTest, AllWorkMayShutDownItsQueue) {
  NDConcurrentQueue queue(2);
  std::latch bothRun(2);
  for (int i = 0; i < 2; ++i) {
    queue.async([&] {
      bothRun.arrive_and_wait();
      queue.shutDown();
    });
  }
  bothRun.wait();
  queue.waitUntilIdle();
}

TEST(NDConcurrentQueueTest, WorkMayReleaseItsQueue) {
  for (int round = 0; round < 100; ++round) {
    auto queue = std::make_shared<NDConcurrentQueue>(2);
    NDConcurrentQueue& queueItself = *queue;
    std::promise<void> isRun;
    std::future<void> whenRun = isRun.get_future();
    auto ends = std::make_shared<std::promise<void>>(std::move(isRun));
    std::promise<void> isOnlyOwner;
    queueItself.async([queue, ends, go = isOnlyOwner.get_future().share()]() mutable {
      go.wait();
      queue.reset();
      ends->set_value();
    });
    queue.reset();
    isOnlyOwner.set_value();
    whenRun.wait();
  }
}

}  // namespace
}  // namespace nidus
