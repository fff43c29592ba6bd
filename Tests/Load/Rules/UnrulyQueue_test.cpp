#include "Load/UnrulyQueue.h"

#include <gtest/gtest.h>

#include <atomic>
#include <memory>

#include "Load/Ledger.h"

namespace nidus {
namespace {

TEST(UnrulyQueueTest, RunsAllThatIsNotParked) {
  UnrulyQueue queue({.seed = 1, .threads = 2, .parksOneIn = 1'000'000});
  std::atomic<int> count = 0;
  for (int i = 0; i < 100; ++i) queue.async([&count] { ++count; });
  queue.waitUntilIdle();
  EXPECT_EQ(count, 100);
}

TEST(UnrulyQueueTest, KeepsWhatIsParkedUntilTheShutdown) {
  UnrulyQueue queue({.seed = 1, .threads = 1, .parksOneIn = 1});
  const auto ledger = std::make_shared<Ledger>();
  auto held = std::make_shared<bool>(false);
  const std::weak_ptr<bool> life = held;
  {
    const Ledger::Scope scope(ledger);
    queue.async([held = std::move(held)] { *held = true; });
  }
  queue.waitUntilIdle();
  EXPECT_TRUE(ledger->facts().isParked);
  EXPECT_FALSE(life.expired());
  queue.shutDown();
  EXPECT_TRUE(life.expired());
}

TEST(UnrulyQueueTest, DestroysWhatComesAfterTheShutdown) {
  UnrulyQueue queue({.seed = 1});
  queue.shutDown();
  bool isRun = false;
  queue.async([&isRun] { isRun = true; });
  queue.waitUntilIdle();
  EXPECT_FALSE(isRun);
}

}  // namespace
}  // namespace nidus
