#include "PlatformModel/System/NDRunOnce.h"

#include <gtest/gtest.h>

#include "PlatformModel/RunOnThreads.h"

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
  int value = 0;
  runOnThreads(4, [&once, &value](std::size_t) {
    once.run([&value] { ++value; });
    EXPECT_EQ(value, 1);
  });
}

}  // namespace
}  // namespace nidus
