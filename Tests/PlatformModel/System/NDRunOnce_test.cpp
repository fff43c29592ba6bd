#include "PlatformModel/System/NDRunOnce.h"

#include <gtest/gtest.h>

#include <latch>
#include <thread>
#include <vector>

namespace nidus {
namespace {

TEST(NDRunOnceTest, RunsFirstWorkAlone) {
  NDRunOnce once;
  int ran = 0;
  once.run([&ran] { ran += 1; });
  once.run([&ran] { ran += 10; });
  EXPECT_EQ(ran, 1);
}

TEST(NDRunOnceTest, OthersWaitForItsEnd) {
  NDRunOnce once;
  std::latch start(4);
  int value = 0;
  std::vector<std::thread> threads;
  for (int i = 0; i < 4; ++i) {
    threads.emplace_back([&] {
      start.arrive_and_wait();
      once.run([&value] { ++value; });
      EXPECT_EQ(value, 1);
    });
  }
  for (std::thread& thread : threads) thread.join();
}

}  // namespace
}  // namespace nidus
