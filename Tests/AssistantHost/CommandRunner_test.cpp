#include "AssistantHost/CommandRunner.h"

#include <gtest/gtest.h>

#include <thread>

#include "AssistantHost/FakeModule.h"

namespace nidus {
namespace {

NDDictionary replyOf(const char* outcome) {
  NDDictionary reply;
  reply.set("commandOutcome", NDDictionaryValue(NDString(outcome)));
  return reply;
}

class CommandRunnerTest : public ::testing::Test {
 protected:
  FakeModule module_;
  const std::shared_ptr<NDMainQueue> mainQueue_ = std::make_shared<NDMainQueue>();
  CommandRunner runner_{module_.module(), mainQueue_};
  VAHACommand command_;
};

TEST_F(CommandRunnerTest, GivesTheReply) {
  module_.perform = [](const VAHAReplyHandler& handler) { handler(replyOf("A")); };
  const auto replies = runner_.perform(command_);
  ASSERT_TRUE(replies);
  EXPECT_EQ(*replies, std::vector<NDDictionary>{replyOf("A")});
}

TEST_F(CommandRunnerTest, KeepsTheOrderOfReplies) {
  module_.perform = [](const VAHAReplyHandler& handler) {
    handler(replyOf("B"));
    handler(replyOf("A"));
  };
  const auto replies = runner_.perform(command_);
  ASSERT_TRUE(replies);
  EXPECT_EQ(*replies, (std::vector<NDDictionary>{replyOf("B"), replyOf("A")}));
}

TEST_F(CommandRunnerTest, DrainsTheMainQueueMeanwhile) {
  module_.perform = [this](const VAHAReplyHandler& handler) {
    mainQueue_->async([handler] { handler(replyOf("A")); });
  };
  const auto replies = runner_.perform(command_);
  ASSERT_TRUE(replies);
  EXPECT_EQ(replies->size(), 1U);
}

TEST_F(CommandRunnerTest, WaitsForAnotherThread) {
  std::thread platform;
  module_.perform = [&platform](VAHAReplyHandler handler) {
    platform = std::thread([handler = std::move(handler)]() mutable {
      handler(replyOf("A"));
      handler(replyOf("B"));
      handler = nullptr;
    });
  };
  const auto replies = runner_.perform(command_);
  platform.join();
  ASSERT_TRUE(replies);
  EXPECT_EQ(replies->size(), 2U);
}

TEST_F(CommandRunnerTest, TellsThatThereIsNoReply) {
  module_.perform = [](const VAHAReplyHandler& /*handler*/) {};
  const auto replies = runner_.perform(command_);
  ASSERT_TRUE(replies);
  EXPECT_TRUE(replies->empty());
}

TEST_F(CommandRunnerTest, FailsWhenThereIsNoCommand) {
  const auto replies = runner_.perform(command_);
  ASSERT_FALSE(replies);
  EXPECT_EQ(replies.failure().kind, Failure::Kind::platform);
  EXPECT_EQ(replies.failure().message, "no platform is registered");
}

TEST_F(CommandRunnerTest, DrainsOncePerWaitWithADrain) {
  int drained = 0;
  VAHAReplyHandler pending;
  module_.perform = [&pending](VAHAReplyHandler handler) { pending = std::move(handler); };
  CommandRunner runner(module_.module(), mainQueue_, [&] {
    ++drained;
    pending(replyOf("A"));
  });
  const auto replies = runner.perform(command_);
  ASSERT_TRUE(replies);
  EXPECT_EQ(replies->size(), 1U);
  EXPECT_EQ(drained, 1);
}

TEST_F(CommandRunnerTest, LeavesAPendingCommandAfterTheDrain) {
  VAHAReplyHandler pending;
  module_.perform = [&pending](VAHAReplyHandler handler) { pending = std::move(handler); };
  CommandRunner runner(module_.module(), mainQueue_, [] {});
  const auto replies = runner.perform(command_);
  ASSERT_TRUE(replies);
  EXPECT_TRUE(replies->empty());
}

TEST_F(CommandRunnerTest, GivesTheRecords) {
  const NDDictionaryList records = {NDDictionaryValue(replyOf("A"))};
  module_.gather = [&](const std::function<void(const NDDictionaryList&)>& receive) {
    mainQueue_->async([receive, records] { receive(records); });
  };
  const auto taken = runner_.records();
  ASSERT_TRUE(taken);
  EXPECT_EQ(*taken, records);
}

TEST_F(CommandRunnerTest, GivesNoRecordsWithoutAnAnswer) {
  module_.gather = [](const std::function<void(const NDDictionaryList&)>& /*receive*/) {};
  const auto taken = runner_.records();
  ASSERT_TRUE(taken);
  EXPECT_TRUE(taken->empty());
}

TEST_F(CommandRunnerTest, FailsWhenThereIsNoSnapshot) {
  const auto taken = runner_.records();
  ASSERT_FALSE(taken);
  EXPECT_EQ(taken.failure().message, "no platform is registered");
}

}  // namespace
}  // namespace nidus
