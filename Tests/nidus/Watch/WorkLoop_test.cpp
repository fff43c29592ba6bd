#include "nidus/Watch/WorkLoop.h"

#include <gmock/gmock.h>

#include <csignal>

#include "Support/FileShortage.h"

namespace nidus {
namespace {

using ::testing::HasSubstr;

TEST(RunUntilInterruptedTest, RunsWorkUntilItIsDone) {
  NDMainQueue queue;
  int left = 3;
  const std::function<void()> countDown = [&] {
    if (--left > 0) queue.async(countDown);
  };
  queue.async(countDown);
  EXPECT_FALSE(runUntilInterrupted(queue, [&left] { return left == 0; }));
}

TEST(RunUntilInterruptedTest, SignalEndsItAndIsTakenBack) {
  for (const int signal : {SIGINT, SIGTERM}) {
    SCOPED_TRACE(signal);
    struct sigaction before = {};
    sigaction(signal, nullptr, &before);
    NDMainQueue queue;
    queue.async([signal] { std::raise(signal); });
    EXPECT_FALSE(runUntilInterrupted(queue, [] { return false; }));
    struct sigaction after = {};
    sigaction(signal, nullptr, &after);
    EXPECT_EQ(after.sa_handler, before.sa_handler);
  }
}

TEST(RunUntilInterruptedTest, NeedsAFileToBeLeft) {
  NDMainQueue queue;
  const Status failure = [&] {
    const FileShortage shortage;
    return runUntilInterrupted(queue, [] { return true; });
  }();
  ASSERT_TRUE(failure);
  EXPECT_EQ(failure->kind, Failure::Kind::platform);
  EXPECT_THAT(failure->message,
              HasSubstr("interruptions cannot be waited for: Too many open files; "));
}

}  // namespace
}  // namespace nidus
