#include "PlatformModel/System/NDMainQueue.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <atomic>
#include <memory>
#include <string>
#include <thread>

#include "PlatformModel/System/NDDeliveryHold.h"

namespace nidus {
namespace {

class NDMainQueueTest : public testing::Test {
 protected:
  void add(const std::string& name) {
    queue_.async([this, name] { ran_ += name; });
  }

  NDMainQueue queue_;
  std::string ran_;
};

TEST_F(NDMainQueueTest, RunsWorkInOrder) {
  add("a");
  add("b");
  add("c");
  EXPECT_EQ(ran_, "");
  EXPECT_EQ(queue_.drain(), 3U);
  EXPECT_EQ(ran_, "abc");
}

TEST_F(NDMainQueueTest, RunOneRunsOnePiece) {
  EXPECT_FALSE(queue_.runOne());
  add("a");
  add("b");
  EXPECT_TRUE(queue_.runOne());
  EXPECT_EQ(ran_, "a");
}

TEST_F(NDMainQueueTest, DrainRunsWorkAddedMeanwhile) {
  queue_.async([this] {
    add("b");
    ran_ += "a";
  });
  EXPECT_EQ(queue_.drain(), 2U);
  EXPECT_EQ(ran_, "ab");
}

TEST_F(NDMainQueueTest, ReleasesPieceBeforeTheNext) {
  auto held = std::make_shared<int>();
  const std::weak_ptr<int> isHeld = held;
  queue_.async([held] {});
  held.reset();
  queue_.async([this, isHeld] { ran_ = isHeld.expired() ? "released" : "held"; });
  queue_.drain();
  EXPECT_EQ(ran_, "released");
}

TEST_F(NDMainQueueTest, WakesOnceUntilEmptyAgain) {
  int wakes = 0;
  queue_.setWakeHandler([&wakes] { ++wakes; });
  add("a");
  add("b");
  EXPECT_EQ(wakes, 1);
  queue_.drain();
  add("c");
  EXPECT_EQ(wakes, 2);
}

TEST_F(NDMainQueueTest, NewWakeHandlerHearsOfWorkThatWaits) {
  int wakes = 0;
  add("a");
  queue_.setWakeHandler([&wakes] { ++wakes; });
  EXPECT_EQ(wakes, 1);
  add("b");
  EXPECT_EQ(wakes, 1);
}

TEST_F(NDMainQueueTest, WakeHandlerMayUseTheQueue) {
  queue_.setWakeHandler([this] { queue_.drain(); });
  add("a");
  EXPECT_EQ(ran_, "a");
}

TEST_F(NDMainQueueTest, EmptyWakeHandlerRemovesIt) {
  auto held = std::make_shared<int>();
  const std::weak_ptr<int> isHeld = held;
  queue_.setWakeHandler([held = std::move(held)] { FAIL(); });
  queue_.setWakeHandler(nullptr);
  add("a");
  EXPECT_TRUE(isHeld.expired());
}

TEST_F(NDMainQueueTest, RunUntilAsksBeforeEachPiece) {
  add("a");
  add("b");
  add("c");
  queue_.runUntil([this] { return ran_ == "ab"; });
  EXPECT_EQ(ran_, "ab");
  queue_.runUntil([] { return true; });
  EXPECT_EQ(ran_, "ab");
}

TEST_F(NDMainQueueTest, RunUntilWaitsForWork) {
  std::thread adder([this] {
    for (int i = 0; i < 100; ++i) add("x");
  });
  queue_.runUntil([this] { return ran_.size() == 100; });
  adder.join();
  EXPECT_EQ(queue_.drain(), 0U);
}

TEST_F(NDMainQueueTest, RunUntilLetsHeldDeliveriesGo) {
  const NDDeliveryHold hold;
  bool isDelivered = false;
  NDDeliveryHold::whenReleased(
      [this, &isDelivered] { queue_.async([&isDelivered] { isDelivered = true; }); });
  queue_.runUntil([&isDelivered] { return isDelivered; });
  EXPECT_TRUE(isDelivered);
}

TEST_F(NDMainQueueTest, WakeMakesRunUntilAskAgain) {
  for (int round = 0; round < 100; ++round) {
    std::atomic<bool> isDone{false};
    std::thread other([this, &isDone] {
      isDone = true;
      queue_.wake();
    });
    queue_.runUntil([&isDone] { return isDone.load(); });
    other.join();
  }
}

TEST_F(NDMainQueueTest, DestroysWorkThatIsLeft) {
  auto held = std::make_shared<int>();
  const std::weak_ptr<int> isHeld = held;
  {
    NDMainQueue queue;
    queue.async([held = std::move(held)] {});
  }
  EXPECT_TRUE(isHeld.expired());
}

TEST_F(NDMainQueueTest, WorkThatIsLeftMayAddWork) {
  auto held = std::make_shared<int>();
  const std::weak_ptr<int> isHeld = held;
  {
    NDMainQueue queue;
    const std::shared_ptr<void> adder(
        nullptr, [&queue, held = std::move(held)](void*) { queue.async([held] { FAIL(); }); });
    queue.async([adder] {});
  }
  EXPECT_TRUE(isHeld.expired());
}

}  // namespace
}  // namespace nidus
