#include "Load/Judge.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Load/LoadHome.h"
#include "PlatformModel/Assistant/VAHAConstants.h"

namespace nidus {
namespace {

using Aim = LoadCommand::Aim;
using ::testing::Contains;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

LoadCommand lampCommand(Aim aim) {
  return {.aim = aim, .service = "Lamp 0.0.1", .actionType = "GET", .attribute = "POWER"};
}

/// The facts of a command for which the homes came and one batch was asked.
PlatformFacts factsOf(Ledger::Kind kind, PlatformFacts::Calls calls) {
  PlatformFacts facts;
  facts.wasAskedForHomes = true;
  facts.homes = 1;
  facts.*kind = calls;
  return facts;
}

NDDictionary resultOf(const char* name, std::string_view outcome) {
  NDDictionary entity;
  entity.setIfPresent("name", name);
  entity.setIfPresent("entityType", "SERVICE");
  NDDictionary result;
  result.setIfPresent("outcome", outcome);
  result.setIfPresent("resultAttribute", "POWER");
  result.set("entity", NDDictionaryValue(entity));
  return result;
}

NDDictionary replyOf(std::string_view outcome, const std::vector<NDDictionary>& results = {}) {
  NDDictionaryList list;
  for (const auto& result : results) list.emplace_back(result);
  NDDictionary reply;
  reply.setIfPresent("commandOutcome", outcome);
  reply.set("actionResults", NDDictionaryValue(list));
  return reply;
}

NDDictionary success(const char* name = "Lamp 0.0.1") {
  return replyOf("COMMAND_SUCCESS", {resultOf(name, "SUCCESS")});
}

const PlatformFacts kOneRead =
    factsOf(&PlatformFacts::reads, {.asked = 1, .answered = 1, .successes = 1});
const PlatformFacts kOneLocked =
    factsOf(&PlatformFacts::reads, {.asked = 1, .answered = 1, .locked = 1, .successes = 1});

TEST(JudgeTest, AcceptsOneReportOfAllResults) {
  EXPECT_THAT(judge(lampCommand(Aim::read), kOneRead, {success()}), IsEmpty());
}

TEST(JudgeTest, MissesALostReply) {
  EXPECT_THAT(judge(lampCommand(Aim::read), kOneRead, {}), ElementsAre("a reply is missing"));
  EXPECT_THAT(judge(lampCommand(Aim::read), std::nullopt, {}), ElementsAre("a reply is missing"));
}

TEST(JudgeTest, NoticesAnInventedReply) {
  EXPECT_THAT(judge(lampCommand(Aim::read), kOneRead, {success(), success()}),
              ElementsAre("a reply too many"));
  PlatformFacts pending = kOneRead;
  pending.reads.answered = 0;
  pending.reads.successes = 0;
  EXPECT_THAT(judge(lampCommand(Aim::read), pending, {success()}), Contains("a reply too many"));
}

TEST(JudgeTest, NoticesALostResult) {
  PlatformFacts facts = kOneRead;
  facts.reads.successes = 2;
  EXPECT_THAT(judge(lampCommand(Aim::read), facts, {success()}),
              ElementsAre("successes are lost or invented"));
}

TEST(JudgeTest, NoticesAResultOfAnotherObject) {
  EXPECT_THAT(judge(lampCommand(Aim::read), kOneRead, {success("Lamp 0.0.2")}),
              ElementsAre("a result of an object that the command does not name"));
}

TEST(JudgeTest, AcceptsAnotherNameOfARenamedObjectAlone) {
  PlatformFacts facts = kOneRead;
  facts.haveHomesChanged = true;
  EXPECT_THAT(judge(lampCommand(Aim::read), facts, {success("Lamp 0.0.1 bis")}), IsEmpty());
  EXPECT_EQ(judge(lampCommand(Aim::read), facts, {success("Lamp 0.0.2")}).size(), 1U);
  EXPECT_EQ(judge(lampCommand(Aim::read), kOneRead, {success("Lamp 0.0.1 bis")}).size(), 1U);
}

TEST(JudgeTest, NoticesAnOutcomeThatTheResultsBelie) {
  EXPECT_THAT(judge(lampCommand(Aim::read), std::nullopt, {replyOf("COMMAND_SUCCESS")}),
              ElementsAre("the outcome does not agree with the results"));
}

TEST(JudgeTest, WantsTwoRepliesToALockedRead) {
  const Replies both = {replyOf("REQUIRES_UNLOCK"), success()};
  EXPECT_THAT(judge(lampCommand(Aim::read), kOneLocked, both), IsEmpty());
  EXPECT_THAT(judge(lampCommand(Aim::read), kOneLocked, {success()}),
              ElementsAre("an unlock is missing"));
}

TEST(JudgeTest, WantsTheUnlockAloneForALockedUpdate) {
  EXPECT_THAT(judge(lampCommand(Aim::update), kOneLocked, {replyOf("REQUIRES_UNLOCK")}), IsEmpty());
  EXPECT_THAT(judge(lampCommand(Aim::update), kOneLocked,
                    {replyOf("REQUIRES_UNLOCK"), replyOf("FOUND_NO_MATCHING_ENTITIES")}),
              ElementsAre("a reply too many"));
}

TEST(JudgeTest, AcceptsSilenceOfAGoneSceneAlone) {
  const LoadCommand command{.aim = Aim::scene, .scene = "Scene 0.0", .attribute = "ENABLED"};
  PlatformFacts facts = factsOf(&PlatformFacts::executions, {});
  EXPECT_THAT(judge(command, facts, {}), ElementsAre("a reply is missing"));
  facts.haveHomesChanged = true;
  EXPECT_THAT(judge(command, facts, {}), IsEmpty());
}

TEST(JudgeTest, WantsNoReplyWhenHomesNeverCome) {
  PlatformFacts facts;
  facts.wasAskedForHomes = true;
  EXPECT_THAT(judge(lampCommand(Aim::read), facts, {}), IsEmpty());
  EXPECT_THAT(judge(lampCommand(Aim::read), facts, {replyOf("FOUND_NO_MATCHING_ENTITIES")}),
              ElementsAre("a reply too many"));
}

TEST(JudgeTest, WantsWhatMustBeRefusedRefused) {
  PlatformFacts facts = factsOf(&PlatformFacts::reads, {});
  EXPECT_THAT(judge(lampCommand(Aim::refuse), facts, {replyOf("COMMAND_FAILURE")}), IsEmpty());
  EXPECT_THAT(judge(lampCommand(Aim::refuse), facts, {success()}),
              ElementsAre("what must be refused was done"));
  EXPECT_THAT(judge(lampCommand(Aim::read), facts, {replyOf("COMMAND_FAILURE")}),
              ElementsAre("a failure without a reason"));
}

}  // namespace
}  // namespace nidus
