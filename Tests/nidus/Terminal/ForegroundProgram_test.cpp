#include "nidus/Terminal/ForegroundProgram.h"

#include <gmock/gmock.h>

#include <csignal>

namespace nidus {
namespace {

TEST(RunInForegroundTest, GivesTheExitStatus) {
  EXPECT_EQ(*runInForeground({"sh", "-c", "exit 0"}), 0);
  EXPECT_EQ(*runInForeground({"sh", "-c", "exit \"$1\"", "name", "7"}), 7);
}

TEST(RunInForegroundTest, GivesTheSignal) {
  EXPECT_EQ(*runInForeground({"sh", "-c", "kill -9 $$"}), 128 + SIGKILL);
}

TEST(RunInForegroundTest, NamesWhatCanNotBeStarted) {
  const auto ended = runInForeground({"/missing/program"});
  ASSERT_FALSE(ended);
  EXPECT_EQ(ended.failure().kind, Failure::Kind::platform);
  EXPECT_THAT(ended.failure().message, ::testing::StartsWith("/missing/program: "));
}

TEST(RunInForegroundTest, GivesSignalsBack) {
  struct sigaction before = {};
  sigaction(SIGINT, nullptr, &before);
  ASSERT_TRUE(runInForeground({"true"}));
  struct sigaction after = {};
  sigaction(SIGINT, nullptr, &after);
  EXPECT_EQ(after.sa_handler, before.sa_handler);
}

TEST(RunInForegroundTest, StartsWithUsualSignals) {
  const auto earlier = std::signal(SIGPIPE, SIG_IGN);
  EXPECT_EQ(*runInForeground({"sh", "-c", "kill -PIPE $$"}), 128 + SIGPIPE);
  EXPECT_EQ(*runInForeground({"sh", "-c", "kill -INT $$"}), 128 + SIGINT);
  std::signal(SIGPIPE, earlier);
}

}  // namespace
}  // namespace nidus
