#include "PlatformModel/System/NDClock.h"

#include <gtest/gtest.h>

#include <thread>

namespace nidus {
namespace {

using namespace std::chrono_literals;

class NDSystemClockTest : public testing::Test {
 protected:
  bool waitUntil(NDClock::TimePoint deadline) {
    std::unique_lock lock(mutex_);
    const bool isDone = clock_.waitUntil(lock, changed_, deadline, [this] { return isDone_; });
    EXPECT_TRUE(lock.owns_lock());
    return isDone;
  }

  void finish() {
    const std::lock_guard lock(mutex_);
    isDone_ = true;
    changed_.notify_all();
  }

  NDSystemClock clock_;
  std::mutex mutex_;
  std::condition_variable changed_;
  bool isDone_ = false;
};

TEST_F(NDSystemClockTest, NeverGoesBack) {
  const auto before = clock_.now();
  EXPECT_LE(before, clock_.now());
}

TEST_F(NDSystemClockTest, PassedDeadlineEndsTheWait) { EXPECT_FALSE(waitUntil(clock_.now() - 1s)); }

TEST_F(NDSystemClockTest, DoneCountsThoughDeadlinePassed) {
  finish();
  EXPECT_TRUE(waitUntil(clock_.now() - 1s));
}

TEST_F(NDSystemClockTest, ChangeEndsTheWait) {
  std::thread other([this] { finish(); });
  EXPECT_TRUE(waitUntil(clock_.now() + 1h));
  other.join();
}

TEST_F(NDSystemClockTest, WaitsToTheEndOfTime) {
  std::thread other([this] { finish(); });
  EXPECT_TRUE(waitUntil(NDClock::TimePoint::max()));
  other.join();
}

}  // namespace
}  // namespace nidus
