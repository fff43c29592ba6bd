#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <utility>

#include "Assistant/CommandTest.h"

namespace nidus {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

class SceneTest : public CommandTest {
 protected:
  void runScene(const char* attribute, VAHAValueRef value) {
    perform(makeCommand({.scene = "Good night"},
                        {{.type = "SET", .attribute = attribute, .value = std::move(value)}}));
  }

  /// Hands a scene over by itself, as a command whose objects hold one does.
  void runScene(const std::shared_ptr<NDActionSet>& scene, const Action& action) {
    const auto command = performed(makeCommand(nullptr, {}));
    command->executeActionSet_action_withCompletionHandler(scene, makeAction(action), handler());
    runUntilIdle();
  }
};

TEST_F(SceneTest, RunsTheScene) {
  const auto home = useHome(HomeBuilder("Cottage").scene("Good night"));
  runScene("ENABLED", booleanValue(true));
  EXPECT_THAT(home->executions(), ElementsAre(home->scene("Good night")));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Good night SUCCESS ENABLED=true"));
  EXPECT_TRUE(isHandlerReleased());
}

TEST_F(SceneTest, TellsTheSceneInTheReply) {
  useHome(HomeBuilder("Cottage").scene("Good night"));
  runScene("ENABLED", booleanValue(true));
  EXPECT_THAT(entityTexts(lastReply(), "entityType"), ElementsAre("SCENE"));
}

TEST_F(SceneTest, RunsForAnyTrueNumber) {
  const auto home = useHome(HomeBuilder("Cottage").scene("Good night"));
  runScene("ENABLED", integerValue(2));
  runScene("ENABLED", floatValue(0.5F));
  EXPECT_THAT(home->executions(), SizeIs(2));
}

TEST_F(SceneTest, RefusesOtherAttributes) {
  logLevel(4);
  const auto home = useHome(HomeBuilder("Cottage").scene("Good night"));
  runScene("POWER", booleanValue(true));
  runScene("enabled", booleanValue(true));
  EXPECT_THAT(home->executions(), IsEmpty());
  EXPECT_THAT(replies(), ElementsAre("COMMAND_FAILURE", "COMMAND_FAILURE"));
  EXPECT_THAT(log(4), ElementsAre("4 Invalid action.attribute POWER for actionSet",
                                  "4 Invalid action.attribute enabled for actionSet"));
}

TEST_F(SceneTest, RefusesMissingAttribute) {
  const auto home = useHome(HomeBuilder("Cottage").scene("Good night"));
  runScene(home->scene("Good night"), {.type = "SET", .value = booleanValue(true)});
  EXPECT_THAT(replies(), ElementsAre("COMMAND_FAILURE"));
  EXPECT_THAT(log(4), ElementsAre("4 Invalid action.attribute (null) for actionSet"));
}

TEST_F(SceneTest, RefusesWhatIsNotTrue) {
  logLevel(4);
  const auto home = useHome(HomeBuilder("Cottage").scene("Good night"));
  runScene("ENABLED", booleanValue(false));
  runScene("ENABLED", nullptr);
  runScene("ENABLED", stringValue("true"));
  EXPECT_THAT(home->executions(), IsEmpty());
  EXPECT_THAT(replies(), ElementsAre("COMMAND_FAILURE", "COMMAND_FAILURE", "COMMAND_FAILURE"));
  EXPECT_THAT(log(4), ElementsAre("4 ActionSet action value 0 not true",
                                  "4 ActionSet action value (null) not true",
                                  "4 ActionSet action value true not true"));
}

TEST_F(SceneTest, RefusesQuietlyBelowTheLevel) {
  logLevel(3);
  useHome(HomeBuilder("Cottage").scene("Good night"));
  runScene("ENABLED", booleanValue(false));
  runScene("POWER", booleanValue(true));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_FAILURE", "COMMAND_FAILURE"));
  EXPECT_THAT(log(), IsEmpty());
}

TEST_F(SceneTest, ReportsFailureAsResult) {
  const auto home = useHome(HomeBuilder("Cottage").scene("Good night"));
  home->failExecutions(kNDErrorUnreachable);
  runScene("ENABLED", booleanValue(true));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Good night FAILURE ENABLED=false"));
  EXPECT_THAT(log(4), IsEmpty());
}

TEST_F(SceneTest, ReportsUnlockAlone) {
  const auto home = useHome(HomeBuilder("Cottage").scene("Good night"));
  home->failExecutions(kNDErrorMustUnlock);
  runScene("ENABLED", booleanValue(true));
  EXPECT_THAT(replies(), ElementsAre("REQUIRES_UNLOCK"));
  EXPECT_TRUE(isHandlerReleased());
}

TEST_F(SceneTest, RunsInTheScenesOwnHome) {
  const auto cottage = HomeBuilder("Cottage").primary().scene("Party").build();
  const auto flat = HomeBuilder("Flat").scene("Good night").build();
  useHomes({cottage, flat});
  runScene(flat->scene("Good night"), {.attribute = "ENABLED", .value = booleanValue(true)});
  EXPECT_THAT(flat->executions(), SizeIs(1));
  EXPECT_THAT(cottage->executions(), IsEmpty());
}

TEST_F(SceneTest, IsSilentWithoutScene) {
  useHome(HomeBuilder("Cottage"));
  runScene(nullptr, {.attribute = "ENABLED", .value = booleanValue(true)});
  EXPECT_THAT(replies(), IsEmpty());
  EXPECT_THAT(log(), IsEmpty());
  EXPECT_TRUE(isHandlerReleased());
}

TEST_F(SceneTest, RefusesWithoutSceneAllTheSame) {
  useHome(HomeBuilder("Cottage"));
  runScene(nullptr, {.attribute = "ENABLED", .value = booleanValue(false)});
  EXPECT_THAT(replies(), ElementsAre("COMMAND_FAILURE"));
}

TEST_F(SceneTest, IsSilentForSceneThatDoesNotResolve) {
  useHome(HomeBuilder("Cottage").scene("Good night"));
  const auto command = performed(makeCommand(nullptr, {}));
  HomeObjectRecord gone = *command->allObjects().back();
  gone.objectIdentifier = NDURL::make("x-corvane-nidus", "local", "/actionSet?id=1&home=2");
  command->handleSetActionTypes_serviceType_forObjects_completionHandler(
      makeAction({.type = "SET", .attribute = "ENABLED", .value = booleanValue(true)}), nullptr,
      {&gone}, handler());
  runUntilIdle();
  EXPECT_THAT(replies(), IsEmpty());
  EXPECT_TRUE(isHandlerReleased());
}

TEST_F(SceneTest, RepliesFromTheThreadOfTheAnswer) {
  const auto home = useHome(HomeBuilder("Cottage").scene("Good night"));
  home->holdAnswers();
  runScene("ENABLED", booleanValue(true));
  EXPECT_THAT(replies(), IsEmpty());
  home->releaseAnswers();
  EXPECT_THAT(replies(), SizeIs(1));
}

TEST_F(SceneTest, LetsGoWhenTheAnswerNeverComes) {
  const auto home = useHome(HomeBuilder("Cottage").scene("Good night"));
  home->holdAnswers();
  runScene("ENABLED", booleanValue(true));
  EXPECT_FALSE(isHandlerReleased());
  home->dropAnswers();
  EXPECT_TRUE(isHandlerReleased());
  EXPECT_THAT(replies(), IsEmpty());
}

}  // namespace
}  // namespace nidus
