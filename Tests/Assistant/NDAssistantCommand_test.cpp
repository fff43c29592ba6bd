#include "Assistant/NDAssistantCommand.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <thread>
#include <utility>
#include <vector>

#include "Assistant/CommandTest.h"
#include "Support/TestTypes.h"

namespace nidus {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

constexpr const char* kNoMatch = "FOUND_NO_MATCHING_ENTITIES";

class PerformTest : public CommandTest {};

TEST_F(PerformTest, FindsNoMatchWithoutConfiguredHomes) {
  logLevel(5);
  configureHomes(false);
  perform(makeCommand(Search(), {}));
  EXPECT_THAT(replies(), ElementsAre(kNoMatch));
  EXPECT_THAT(log(), ElementsAre("5 No homes configured - short-circuiting"));
  EXPECT_TRUE(isHandlerReleased());
}

TEST_F(PerformTest, RepliesWithoutConfiguredHomesAtOnce) {
  configureHomes(false);
  makeCommand(Search(), {})->performWithCompletion(handler());
  EXPECT_THAT(replies(), SizeIs(1));
}

TEST_F(PerformTest, LogsNothingOfConfigurationBelowItsLevel) {
  logLevel(4);
  configureHomes(false);
  perform(makeCommand(Search(), {}));
  EXPECT_THAT(log(), IsEmpty());
}

TEST_F(PerformTest, FindsNoMatchInNoHomes) {
  useHomes({});
  perform(makeCommand(Search(), {}));
  EXPECT_THAT(replies(), ElementsAre(kNoMatch));
  EXPECT_THAT(log(), IsEmpty());
  EXPECT_TRUE(isHandlerReleased());
}

TEST_F(PerformTest, HoldsTheReportUntilItHasAsked) {
  useHome(HomeBuilder("Cottage").light("Lamp"));
  setReporting(TestPlatform::Reporting::prompt);
  perform(makeCommand({.service = "Lamp"}, {}));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS"));
}

TEST_F(PerformTest, TakesAnEarlyReportForNoHomes) {
  useHome(HomeBuilder("Cottage").light("Lamp"));
  setReporting(TestPlatform::Reporting::early);
  perform(makeCommand({.service = "Lamp"}, {}));
  EXPECT_THAT(replies(), ElementsAre(kNoMatch));
}

TEST_F(PerformTest, FindsNoMatchInEmptySnapshot) {
  silencePlatform();
  const auto command = makeCommand(Search(), {{.type = "GET"}});
  command->performWithCompletion(handler());
  // The homes that were counted are gone by the time they are gathered.
  useHome(HomeBuilder("Cottage").light("Lamp"));
  command->gather()->homeManagerDidUpdateHomes(NDHomeManager::create());
  EXPECT_EQ(command->numberOfHomes(), 1);
  EXPECT_THAT(replies(), ElementsAre(kNoMatch));
  EXPECT_THAT(log(), IsEmpty());
}

TEST_F(PerformTest, KeepsWhatItHasGathered) {
  useHomes({HomeBuilder("Flat").build(), HomeBuilder("Cottage").primary().light("Lamp").build()});
  const auto command = performed(makeCommand(Search(), {}));
  EXPECT_TRUE(command->gather());
  EXPECT_EQ(command->numberOfHomes(), 2);
  EXPECT_EQ(command->primaryHomeName(), "Cottage");
  EXPECT_EQ(command->primaryHomeID(), command->gather()->getPrimaryHomeID());
  EXPECT_EQ(command->metadata(), NDNAPMetadata::getSharedInstance());
  EXPECT_THAT(command->nidusObjects(), SizeIs(3));
}

TEST_F(PerformTest, RepliesNothingWhileThePlatformIsSilent) {
  useHome(HomeBuilder("Cottage").light("Lamp"));
  silencePlatform();
  auto command = makeCommand(Search(), {});
  const std::weak_ptr<NDAssistantCommand> watched = command;
  perform(std::move(command));
  EXPECT_THAT(replies(), IsEmpty());
  EXPECT_FALSE(isHandlerReleased());
  EXPECT_FALSE(watched.expired());
  const auto gather = watched.lock()->gather();
  gather->homeManagerWillNotUpdateHomes(gather->manager());
  EXPECT_TRUE(isHandlerReleased());
  EXPECT_THAT(replies(), IsEmpty());
}

TEST_F(PerformTest, OutlivesItsOwner) {
  useHome(HomeBuilder("Cottage").light("Lamp"));
  auto command = makeCommand({.service = "Lamp"}, {{.type = "GET", .attribute = "POWER"}});
  const std::weak_ptr<NDAssistantCommand> watched = command;
  command->performWithCompletion(handler());
  command.reset();
  EXPECT_FALSE(watched.expired());
  runUntilIdle();
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS POWER=false"));
  EXPECT_TRUE(watched.expired());
  EXPECT_TRUE(isHandlerReleased());
}

TEST_F(PerformTest, LetsGoOfTheHandlerWhileTheCommandIsKept) {
  useHome(HomeBuilder("Cottage").light("Lamp").scene("Good night"));
  const std::vector<Action> actions = {
      {.type = "GET", .attribute = "POWER"},
      {.type = "GET"},
      {.type = "GET_MINIMUM", .attribute = "POWER"},
      {.type = "SET", .attribute = "ENABLED", .value = booleanValue(true)},
      {.type = "TOGGLE", .attribute = "POWER"},
      {.type = "MELT"}};
  for (const Action& action : actions) {
    const auto command = performed(makeCommand(Search(), {action}));
    EXPECT_TRUE(isHandlerReleased());
  }
}

TEST_F(PerformTest, PerformsWithoutHandler) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp"));
  makeCommand({.service = "Lamp"},
              {{.type = "SET", .attribute = "POWER", .value = booleanValue(true)}})
      ->performWithCompletion(nullptr);
  runUntilIdle();
  EXPECT_THAT(written(*home), ElementsAre("Lamp=1"));
}

class HandleCommandTest : public CommandTest {};

TEST_F(HandleCommandTest, FailsWithoutPrimaryHome) {
  useHomes({HomeBuilder("Cottage").light("Lamp").build(), HomeBuilder("Flat").build()});
  perform(makeCommand({.service = "Lamp"}, {{.type = "GET"}}));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_FAILURE"));
  EXPECT_THAT(log(), IsEmpty());
}

TEST_F(HandleCommandTest, SearchesThePrimaryHome) {
  useHomes({HomeBuilder("Cottage").light("Lamp").build(),
            HomeBuilder("Flat").primary().light("Lamp").light("Fan").build()});
  perform(makeCommand({.entityType = "SERVICE"}, {}));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS; Fan SUCCESS"));
  EXPECT_THAT(entityTexts(lastReply(), "home"), ElementsAre("Flat", "Flat"));
  EXPECT_THAT(log(), ElementsAre("6 Incoming Filter: home=Flat/"));
}

TEST_F(HandleCommandTest, SearchesTheNamedHome) {
  useHomes({HomeBuilder("Cottage").light("Lamp").build(),
            HomeBuilder("Flat").primary().light("Fan").build()});
  perform(makeCommand({.home = "Cottage"}, {}));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS"));
}

TEST_F(HandleCommandTest, SearchesAllOfOneHome) {
  useHome(HomeBuilder("Cottage").light("Lamp"));
  perform(makeCommand(Search(), {}));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Cottage SUCCESS; Lamp SUCCESS"));
  EXPECT_THAT(log(), ElementsAre("6 Incoming Filter: "));
}

TEST_F(HandleCommandTest, SearchesAllOfOnePrimaryHome) {
  useHome(HomeBuilder("Cottage").primary().light("Lamp"));
  perform(makeCommand(Search(), {}));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Cottage SUCCESS; Lamp SUCCESS"));
  EXPECT_THAT(log(), ElementsAre("6 Incoming Filter: "));
}

TEST_F(HandleCommandTest, ComparesTheNumberOfHomesSigned) {
  useHome(HomeBuilder("Cottage"));
  const auto command = performed(makeCommand(Search(), {}));
  clearReplies();
  command->setNumberOfHomes(-1);
  command->handleCommandWithCompletionHandler(handler());
  command->setNumberOfHomes(2);
  command->handleCommandWithCompletionHandler(handler());
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Cottage SUCCESS", "COMMAND_FAILURE"));
}

TEST_F(HandleCommandTest, FindsNoMatchForHomesOfOneName) {
  useHomes({HomeBuilder("Home").build(), HomeBuilder("Home").build(),
            HomeBuilder("Flat").primary().build()});
  perform(makeCommand({.home = "Home"}, {{.type = "GET"}}));
  EXPECT_THAT(replies(), ElementsAre(kNoMatch));
  EXPECT_THAT(log(), ElementsAre("4 Multiple homes with same name but no primary home"));
}

TEST_F(HandleCommandTest, FindsNoMatchForUnknownServiceType) {
  useHome(HomeBuilder("Cottage").light("Lamp"));
  perform(makeCommand({.serviceType = "WARP_DRIVE"}, {{.type = "GET"}}));
  EXPECT_THAT(replies(), ElementsAre(kNoMatch));
  EXPECT_THAT(log(), IsEmpty());
}

TEST_F(HandleCommandTest, LogsNoActionWhenNothingMatches) {
  useHome(HomeBuilder("Cottage"));
  perform(makeCommand({.service = "Lamp"}, {{.type = "MELT"}}));
  EXPECT_THAT(replies(), ElementsAre(kNoMatch));
  EXPECT_THAT(log(), ElementsAre("6 Incoming Filter: service=Lamp/"));
}

TEST_F(HandleCommandTest, ResolvesIdentifiersToNothing) {
  const auto home = HomeBuilder("Cottage").light("Lamp").build();
  useHomes({home, HomeBuilder("Flat").build()});
  const auto known = performed(makeCommand({.home = "Cottage"}, {}))->nidusObjects();
  clearReplies();
  auto filter = std::make_shared<VAHAIdentifierFilter>();
  filter->setIdentifiers({known.front().objectIdentifier, known.back().objectIdentifier});
  clearLog();
  perform(makeCommand(filter, {{.type = "GET"}}));
  EXPECT_THAT(replies(), ElementsAre(kNoMatch));
  EXPECT_THAT(log(), IsEmpty());
}

TEST_F(HandleCommandTest, TakesMissingFilterForIdentifiers) {
  useHomes({HomeBuilder("Cottage").build(), HomeBuilder("Flat").build()});
  perform(makeCommand(nullptr, {{.type = "GET"}}));
  EXPECT_THAT(replies(), ElementsAre(kNoMatch));
}

/// A filter of a class that the plug-in does not know.
class OtherFilter final : public VAHAFilter {
 public:
  [[nodiscard]] std::string_view encodedClassName() const override { return "VAHAOtherFilter"; }
  [[nodiscard]] std::string description() const override { return "other"; }
};

TEST_F(HandleCommandTest, TakesOtherFiltersForIdentifiers) {
  useHome(HomeBuilder("Cottage"));
  perform(makeCommand(std::make_shared<OtherFilter>(), {{.type = "GET"}}));
  EXPECT_THAT(replies(), ElementsAre(kNoMatch));
}

TEST_F(HandleCommandTest, PerformsTheFirstActionOnly) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp"));
  perform(makeCommand({.service = "Lamp"},
                      {{.type = "GET", .attribute = "POWER"},
                       {.type = "SET", .attribute = "POWER", .value = booleanValue(true)}}));
  EXPECT_THAT(home->reads(), SizeIs(1));
  EXPECT_THAT(home->writes(), IsEmpty());
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS POWER=false"));
}

TEST_F(HandleCommandTest, ReadsForMissingActionType) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp", {power(true)}));
  perform(makeCommand({.service = "Lamp"}, {{.attribute = "POWER"}}));
  EXPECT_THAT(home->reads(), SizeIs(1));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS POWER=true"));
}

TEST_F(HandleCommandTest, PassesTheServiceTypeOn) {
  useHome(HomeBuilder("Cottage")
              .accessory("Outlet")
              .service("Lamp", NDString(kOutletService), {power(false)})
              .associated(NDString(kLightService)));
  perform(makeCommand({.serviceType = "LIGHT"}, {{.type = "GET", .attribute = "POWER"}}));
  EXPECT_THAT(entityTexts(lastReply(), "serviceType"), ElementsAre("LIGHT"));
}

TEST_F(HandleCommandTest, GivesEachActionTypeToItsHandler) {
  struct Case {
    const char* type;
    std::size_t reads;
    std::size_t writes;
    const char* reply;
  };
  const Case cases[] = {
      {"GET", 1, 0, "COMMAND_SUCCESS; Lamp SUCCESS BRIGHTNESS=40 PERCENTAGE"},
      {"GET_TARGET_VALUE", 1, 0, "COMMAND_SUCCESS; Lamp SUCCESS BRIGHTNESS=40 PERCENTAGE"},
      {"GET_MINIMUM", 0, 0, "COMMAND_SUCCESS; Lamp SUCCESS BRIGHTNESS=0 percentage"},
      {"GET_MAXIMUM", 0, 0, "COMMAND_SUCCESS; Lamp SUCCESS BRIGHTNESS=100 percentage"},
      {"GET_STEP_VALUE", 0, 0, "COMMAND_SUCCESS; Lamp SUCCESS BRIGHTNESS=1 percentage"},
      {"SET", 0, 1, "COMMAND_SUCCESS; Lamp SUCCESS BRIGHTNESS=7 PERCENTAGE"},
      {"SET_TO_MINIMUM", 0, 1, "COMMAND_SUCCESS; Lamp SUCCESS BRIGHTNESS=0 percentage"},
      {"SET_TO_MAXIMUM", 0, 1, "COMMAND_SUCCESS; Lamp SUCCESS BRIGHTNESS=100 percentage"},
      {"INCREASE", 1, 1, "COMMAND_SUCCESS; Lamp SUCCESS BRIGHTNESS=47 PERCENTAGE"},
      {"DECREASE", 1, 1, "COMMAND_SUCCESS; Lamp SUCCESS BRIGHTNESS=33 PERCENTAGE"},
      {"TOGGLE", 0, 0, "COMMAND_FAILURE"},
      {"get", 0, 0, "COMMAND_FAILURE"}};
  for (const Case& test : cases) {
    SCOPED_TRACE(test.type);
    clearReplies();
    const auto home = useHome(HomeBuilder("Cottage").light("Lamp", {brightness(40)}));
    const bool isQuestion = std::string(test.type).starts_with("GET");
    perform(makeCommand({.service = "Lamp"}, {{.type = test.type,
                                               .attribute = "BRIGHTNESS",
                                               .value = isQuestion ? nullptr : integerValue(7)}}));
    EXPECT_THAT(home->reads(), SizeIs(test.reads));
    EXPECT_THAT(home->writes(), SizeIs(test.writes));
    EXPECT_THAT(replies(), ElementsAre(test.reply));
  }
}

TEST_F(HandleCommandTest, RefusesUnknownActionTypes) {
  useHome(HomeBuilder("Cottage").light("Lamp"));
  perform(makeCommand(Search(), {{.type = "MELT", .attribute = "POWER"}}));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_FAILURE"));
  EXPECT_THAT(log(), ElementsAre("6 Incoming Filter: ",
                                 "6 Incoming Action: MELT/attribute=POWER/value=(null)",
                                 "3 -[NDAssistantCommand handleCommandWithCompletionHandler:] ### "
                                 "Vela sent an unsupported action type: MELT"));
}

TEST_F(HandleCommandTest, LogsRefusalsAtEveryThreshold) {
  logLevel(3);
  useHome(HomeBuilder("Cottage").light("Lamp"));
  perform(makeCommand(Search(), {{.type = "MELT", .attribute = "POWER"}}));
  EXPECT_THAT(log(), SizeIs(1));
}

TEST_F(HandleCommandTest, LogsTheActionWithItsValue) {
  useHome(HomeBuilder("Cottage"));
  const std::pair<VAHAValueRef, const char*> cases[] = {{booleanValue(true), "1"},
                                                        {integerValue(-7), "-7"},
                                                        {floatValue(72.5F), "72.5"},
                                                        {stringValue("HEAT"), "HEAT"},
                                                        {nullptr, "(null)"}};
  for (const auto& [value, text] : cases) {
    clearLog();
    perform(makeCommand(Search(), {{.type = "GET", .attribute = "POWER", .value = value}}));
    EXPECT_THAT(log(),
                ElementsAre("6 Incoming Filter: ",
                            std::string("6 Incoming Action: GET/attribute=POWER/value=") + text));
  }
}

TEST_F(HandleCommandTest, LogsTheActionWithoutAttribute) {
  useHome(HomeBuilder("Cottage"));
  perform(makeCommand(Search(), {{.type = "GET", .value = booleanValue(true)}}));
  perform(makeCommand(Search(), {Action()}));
  EXPECT_THAT(log(), ElementsAre("6 Incoming Filter: ", "6 Incoming Action: GET",
                                 "6 Incoming Filter: ", "6 Incoming Action: (null)"));
}

TEST_F(HandleCommandTest, LogsNothingBelowItsLevel) {
  logLevel(5);
  useHome(HomeBuilder("Cottage"));
  perform(makeCommand(Search(), {{.type = "GET", .attribute = "POWER"}}));
  EXPECT_THAT(log(), IsEmpty());
}

class ReportTest : public CommandTest {
 protected:
  static NDAssistantCommand::Results failedResult() {
    auto result = std::make_shared<VAHAActionResult>();
    result->setOutcome(VAHAActionOutcomeFAILUREValue);
    return {result};
  }

  const std::shared_ptr<NDAssistantCommand> command_ = makeCommand(nullptr, {});
};

TEST_F(ReportTest, CarriesEmptyListForNoResults) {
  command_->reportOutcome_results_handler("ANY", std::nullopt, handler());
  EXPECT_THAT(replies(), ElementsAre("ANY"));
  ASSERT_TRUE(lastReply().find("actionResults"));
  EXPECT_EQ(*lastReply().find("actionResults"), NDDictionaryValue(NDDictionaryList()));
}

TEST_F(ReportTest, CarriesOutcomeAndResults) {
  command_->reportOutcome_results_handler("ANY", failedResult(), handler());
  EXPECT_THAT(replies(), ElementsAre("ANY; no entity FAILURE"));
}

TEST_F(ReportTest, TakesAnyResultForSuccess) {
  command_->reportResults_handler(failedResult(), handler());
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; no entity FAILURE"));
}

TEST_F(ReportTest, FindsNoMatchWithoutResults) {
  command_->reportResults_handler(std::nullopt, handler());
  command_->reportResults_handler(NDAssistantCommand::Results(), handler());
  EXPECT_THAT(replies(), ElementsAre(kNoMatch, kNoMatch));
  EXPECT_TRUE(lastReply().find("actionResults"));
}

TEST_F(ReportTest, RequiresUnlockWithoutResults) {
  command_->reportUnlockRequired(handler());
  EXPECT_THAT(replies(), ElementsAre("REQUIRES_UNLOCK"));
  EXPECT_TRUE(lastReply().find("actionResults"));
}

TEST_F(ReportTest, DoesNothingWithoutHandler) {
  command_->reportOutcome_results_handler("ANY", failedResult(), nullptr);
  command_->reportResults_handler(failedResult(), nullptr);
  command_->reportUnlockRequired(nullptr);
  EXPECT_THAT(replies(), IsEmpty());
}

TEST_F(ReportTest, CopiesTheRequest) {
  const auto request = makeCommand({.room = "Hall"}, {{.type = "GET"}, {.type = "SET"}});
  const NDAssistantCommand command(*request);
  EXPECT_EQ(command.filter(), request->filter());
  EXPECT_EQ(command.actions(), request->actions());
  EXPECT_FALSE(command.gather());
  EXPECT_EQ(command.numberOfHomes(), 0);
  EXPECT_FALSE(command.primaryHomeName());
  EXPECT_FALSE(command.primaryHomeID());
  EXPECT_FALSE(command.metadata());
  EXPECT_THAT(command.nidusObjects(), IsEmpty());
}

/// Homes that answer on threads of their own, all at once.
class ThreadedCommandTest : public CommandTest {
 protected:
  static constexpr int kHomes = 8;

  void act(const Action& action) {
    std::vector<std::shared_ptr<TestHome>> homes;
    for (int i = 0; i < kHomes; ++i) {
      homes.push_back(HomeBuilder("Home " + std::to_string(i)).light("Lamp").light("Bulb").build());
      homes.back()->holdAnswers();
    }
    useHomes(homes);
    actInAllHomes(action);
    for (int round = 0; round < 2; ++round) releaseAtOnce(homes);
    runUntilIdle();
  }

  static void releaseAtOnce(const std::vector<std::shared_ptr<TestHome>>& homes) {
    std::vector<std::thread> threads;
    for (const auto& home : homes) threads.emplace_back([home] { home->releaseAnswers(); });
    for (auto& thread : threads) thread.join();
  }

  [[nodiscard]] std::size_t resultsOfLastReply() const {
    return entityTexts(lastReply(), "name").size();
  }
};

TEST_F(ThreadedCommandTest, ReadsInParallel) {
  act({.type = "GET", .attribute = "POWER"});
  EXPECT_THAT(replies(), SizeIs(1));
  EXPECT_EQ(resultsOfLastReply(), 2U * kHomes);
  EXPECT_TRUE(isHandlerReleased());
}

TEST_F(ThreadedCommandTest, WritesInParallel) {
  act({.type = "SET", .attribute = "POWER", .value = booleanValue(true)});
  EXPECT_THAT(replies(), SizeIs(1));
  EXPECT_EQ(resultsOfLastReply(), 2U * kHomes);
}

TEST_F(ThreadedCommandTest, UpdatesInParallel) {
  act({.type = "TOGGLE", .attribute = "POWER"});
  EXPECT_THAT(replies(), SizeIs(1));
  EXPECT_EQ(resultsOfLastReply(), 2U * kHomes);
}

}  // namespace
}  // namespace nidus
