#include "nidus/Explain/Judgement.h"

#include <gtest/gtest.h>

namespace nidus {
namespace {

NDDictionary reply(const char* outcome, const std::vector<const char*>& results) {
  NDDictionaryList list;
  for (const char* result : results) {
    NDDictionary dictionary;
    dictionary.set("outcome", NDDictionaryValue(NDString(result)));
    list.emplace_back(dictionary);
  }
  NDDictionary reply;
  reply.set("commandOutcome", NDDictionaryValue(NDString(outcome)));
  reply.set("actionResults", NDDictionaryValue(list));
  return reply;
}

std::string judged(const std::vector<NDDictionary>& replies) {
  Rehearsal rehearsal;
  rehearsal.replies = replies;
  return judgementText(VAHACommand(), rehearsal);
}

TEST(JudgementTest, TellsThatThereIsNoReply) {
  EXPECT_EQ(judged({}),
            "There is no reply: the plug-in can not find again what the filter found.\n");
}

TEST(JudgementTest, CountsOutcomesOfResults) {
  EXPECT_EQ(judged({reply("COMMAND_SUCCESS", {"READ_ONLY", "SUCCESS", "READ_ONLY"})}),
            "COMMAND_SUCCESS, because there is a result; each result has an outcome of its own.\n"
            "  1 x SUCCESS, because no error is met.\n"
            "  2 x READ_ONLY, because the value can not be written.\n");
}

TEST(JudgementTest, JudgesEachReply) {
  EXPECT_EQ(judged({reply("REQUIRES_UNLOCK", {}), reply("FOUND_NO_MATCHING_ENTITIES", {})}),
            "REQUIRES_UNLOCK, because a device answers that this one must be unlocked first.\n"
            "FOUND_NO_MATCHING_ENTITIES, because there is no result.\n");
}

TEST(JudgementTest, ShowsWarningsOfTheLogAlone) {
  Rehearsal rehearsal;
  for (const char* level : {"3", "4", "5", "6"}) {
    NDSystemLogMessage message;
    message.set("Level", level);
    message.set("Message", std::string("level ") + level);
    rehearsal.log.push_back(message);
  }
  rehearsal.replies = {reply("COMMAND_FAILURE", {})};
  EXPECT_EQ(judgementText(VAHACommand(), rehearsal),
            "The plug-in logs: level 3\nThe plug-in logs: level 4\n"
            "COMMAND_FAILURE, because the plug-in refuses the command as it stands.\n");
}

TEST(JudgementTest, TellsThatOnlyWhatStatesALimitCounts) {
  const auto judgedLimit = [](const char* type, std::size_t reached) {
    const auto action = std::make_shared<VAHAAction>();
    action->setActionType(type);
    VAHACommand command;
    command.setActions({action});
    Rehearsal rehearsal;
    rehearsal.reached.resize(reached);
    rehearsal.replies = {reply("FOUND_NO_MATCHING_ENTITIES", {})};
    return judgementText(command, rehearsal);
  };
  const std::string none = "FOUND_NO_MATCHING_ENTITIES, because there is no result.\n";
  const std::string omission = " of its own gives a result.\n";
  const std::string start = none + "Of what is reached, only what states a ";
  EXPECT_EQ(judgedLimit("GET_MINIMUM", 1), start + "minimum" + omission);
  EXPECT_EQ(judgedLimit("GET_MAXIMUM", 1), start + "maximum" + omission);
  EXPECT_EQ(judgedLimit("GET_STEP_VALUE", 1), start + "step" + omission);
  EXPECT_EQ(judgedLimit("GET_MINIMUM", 0), none);
  EXPECT_EQ(judgedLimit("SET", 1), none);
}

TEST(JudgementTest, PassesOverUnknownOutcomes) {
  EXPECT_EQ(judged({reply("SOMETHING_NEW", {"SOMETHING_ELSE"})}), "");
}

}  // namespace
}  // namespace nidus
