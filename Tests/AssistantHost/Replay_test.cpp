#include "AssistantHost/Replay.h"

#include <gmock/gmock.h>

#include "AssistantHost/FakeModule.h"
#include "PlatformModel/NDPlatform.h"
#include "Support/TestFolder.h"

namespace nidus {
namespace {

using ::testing::ElementsAre;
using ::testing::HasSubstr;

class ReplayTest : public ::testing::Test {
 protected:
  /// Replays a scenario of these members and keeps its lines.
  Status run(const std::string& members) {
    const std::string homes =
        R"({"format": "nidus-home/1", "homes": [
            {"uuid": "AA00AA00-0000-4000-8000-000000000001", "name": "Cottage"}]})";
    const auto scenario = readScenario(folder_.write(
        "test.json", R"({"format": "nidus-scenario/1", "home": )" + homes + ", " + members + "}"));
    if (!scenario) return scenario.failure();
    return replay(*scenario, module_.module(), [this](std::string_view line) {
      lines_.emplace_back(line);
      return failureOfWrite_;
    });
  }

  /// What a boolean preference is for the plug-in.
  static NDPreferences::BooleanReading preference(const char* key) {
    const auto platform = NDPlatform::registered();
    return platform->preferences()->booleanForKey_domain_container(
        key, "com.corvane.nidusd", platform->homeConfigurationPath());
  }

  const TestFolder folder_;
  FakeModule module_;
  std::vector<std::string> lines_;
  Status failureOfWrite_;
};

TEST_F(ReplayTest, WritesALineForEachStep) {
  module_.gather = [](const std::function<void(const NDDictionaryList&)>& /*receive*/) {};
  ASSERT_FALSE(run(R"("steps": [{"set": {}}, {"records": {}}])"));
  EXPECT_THAT(lines_, ElementsAre("{\"step\": 0}\n", "{\"step\": 1, \"records\": []}\n"));
}

TEST_F(ReplayTest, WritesEachLineBeforeTheNextStep) {
  std::size_t linesBefore = 0;
  module_.perform = [&](const VAHAReplyHandler& /*handler*/) { linesBefore = lines_.size(); };
  ASSERT_FALSE(run(R"("steps": [{"set": {}}, {"set": {}}, {"perform": {}}])"));
  EXPECT_EQ(linesBefore, 2U);
}

TEST_F(ReplayTest, StopsWhenALineCanNotBeWritten) {
  failureOfWrite_ = Failure{Failure::Kind::platform, "full"};
  const auto failure = run(R"("steps": [{"set": {}}, {"set": {}}])");
  ASSERT_TRUE(failure);
  EXPECT_EQ(failure->message, "full");
  EXPECT_EQ(lines_.size(), 1U);
}

TEST_F(ReplayTest, FailsWhenTheModuleRefuses) {
  for (const char* step :
       {R"({"perform": {}})", R"({"records": {}})", R"({"sync": {"key": "k"}})"}) {
    const auto failure = run(std::string("\"steps\": [") + step + "]");
    ASSERT_TRUE(failure) << step;
    EXPECT_EQ(failure->message, "no platform is registered");
  }
}

TEST_F(ReplayTest, RegistersThePlatformMeanwhile) {
  bool isRegistered = false;
  module_.perform = [&](const VAHAReplyHandler& /*handler*/) {
    isRegistered = NDPlatform::registered() != nullptr;
  };
  ASSERT_FALSE(run(R"("steps": [{"perform": {}}])"));
  EXPECT_TRUE(isRegistered);
  EXPECT_FALSE(NDPlatform::registered());
}

TEST_F(ReplayTest, TakesPreferencesFromTheScenarioAlone) {
  NDPreferences::BooleanReading configured;
  module_.perform = [&](const VAHAReplyHandler& /*handler*/) {
    configured = preference("kHomesConfigured");
  };
  ASSERT_FALSE(run(R"("steps": [{"perform": {}}])"));
  EXPECT_FALSE(configured.keyExistsAndIsValid);
  ASSERT_FALSE(run(R"("preferences": {"kHomesConfigured": true}, "steps": [{"perform": {}}])"));
  EXPECT_TRUE(configured.value);
  ASSERT_FALSE(run(R"("preferences": {"kHomesConfigured": 5}, "steps": [{"perform": {}}])"));
  EXPECT_FALSE(configured.keyExistsAndIsValid);
}

TEST_F(ReplayTest, ChangesAndRemovesPreferences) {
  std::vector<bool> exists;
  module_.perform = [&](const VAHAReplyHandler& /*handler*/) {
    exists.push_back(preference("kHomesConfigured").keyExistsAndIsValid);
  };
  ASSERT_FALSE(run(R"("steps": [{"set": {"preferences": {"kHomesConfigured": true}}},
                                {"perform": {}},
                                {"set": {"preferences": {"kHomesConfigured": null}}},
                                {"perform": {}}])"));
  EXPECT_THAT(exists, ElementsAre(true, false));
}

TEST_F(ReplayTest, ShowsTheRepliesOfAStepAlone) {
  VAHAReplyHandler pending;
  module_.perform = [&](VAHAReplyHandler handler) {
    if (pending) pending(NDDictionary());
    handler(NDDictionary());
    handler(NDDictionary());
    pending = std::move(handler);
  };
  ASSERT_FALSE(run(R"("steps": [{"perform": {}}, {"perform": {}}])"));
  EXPECT_THAT(lines_,
              ElementsAre(HasSubstr("\"replies\": [{}, {}]"),
                          HasSubstr("\"replies\": [{}, {}], \"platform\": [], \"log\": []")));
}

TEST_F(ReplayTest, ShowsTheLogOfAStepAlone) {
  module_.perform = [](const VAHAReplyHandler& /*handler*/) {
    const auto log = NDPlatform::registered()->systemLog();
    const auto message = log->createMessage();
    message->set("Level", "3");
    message->set("Facility", "f");
    message->set("Message", "text");
    log->openClient(nullptr, "f", 0)->send(*message);
  };
  ASSERT_FALSE(run(R"("steps": [{"perform": {}}, {"perform": {}}])"));
  const auto logged = HasSubstr(R"("log": [{"Level": "3", "Facility": "f", "Message": "text"}]})");
  EXPECT_THAT(lines_, ElementsAre(logged, logged));
}

TEST_F(ReplayTest, ExportsTheHomes) {
  ASSERT_FALSE(run(R"("steps": [{"export": {}}])"));
  EXPECT_THAT(lines_, ElementsAre(HasSubstr(R"({"step": 0, "home": {"format": "nidus-home/1")")));
  EXPECT_THAT(lines_[0], HasSubstr("Cottage"));
  EXPECT_THAT(lines_[0], ::testing::EndsWith("}}\n"));
}

/// Answers each request with the end marker.
class EmptySync final : public AFSyncHandler {
 public:
  void beginSyncWithAnchor_validity_forKey_beginInfo(
      const NDString& anchor, const NDString& validity, const NDString& /*key*/,
      std::shared_ptr<AFSyncBeginInfo> beginInfo) override {
    beginInfo->resetWithValidity(anchor);
    beginInfo->resetWithValidity(validity);
  }
  void getChangeAfterAnchor_changeInfo(const NDString& anchor,
                                       AFSyncChangeInfo& changeInfo) override {
    changeInfo.setPostAnchor(anchor);
  }
  void syncDidEnd() override { ++ended; }
  int ended = 0;
};

TEST_F(ReplayTest, SynchronisesAsAsked) {
  const auto sync = std::make_shared<EmptySync>();
  module_.syncHandler = sync;
  ASSERT_FALSE(run(R"("steps": [{"sync": {"key": "k", "anchor": "a"}},
                                {"sync": {"key": "k", "after": ["1", null]}},
                                {"sync": {"key": "k", "after": []}}])"));
  EXPECT_THAT(
      lines_,
      ElementsAre(
          HasSubstr(
              R"("resets": ["a", null], "changes": [{"after": null, "object": null, "postAnchor": null}])"),
          HasSubstr(
              R"("changes": [{"after": "1", "object": null, "postAnchor": "1"}, {"after": null, )"),
          HasSubstr(R"("changes": [], "platform": [], "log": []})")));
  EXPECT_EQ(sync->ended, 3);
}

}  // namespace
}  // namespace nidus
