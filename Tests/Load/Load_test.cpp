#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <array>
#include <atomic>
#include <cstdlib>
#include <functional>
#include <future>
#include <map>
#include <mutex>
#include <set>
#include <thread>

#include "Assistant/NDAssistantCommand.h"
#include "Assistant/NDAssistantSyncHome.h"
#include "HomePlatform/HomePlatform.h"
#include "Load/LoadHome.h"
#include "PlatformModel/Assistant/VAHAConstants.h"

namespace nidus {
namespace {

#if defined(__SANITIZE_THREAD__) || defined(__SANITIZE_ADDRESS__)
constexpr std::size_t kCommands = 4'000;
#else
constexpr std::size_t kCommands = 100'000;
#endif
constexpr std::size_t kThreads = 8;
constexpr std::size_t kCommandsPerSync = 50;

/// A number from the environment, so that the same test runs short here and long on demand.
std::size_t countOf(const char* variable, std::size_t otherwise) {
  const char* text = std::getenv(variable);
  return text ? std::strtoull(text, nullptr, 10) : otherwise;
}

/// A clock that stands still: no wait of the plug-in can time out, however loaded the machine is.
class StandingClock final : public NDClock {
 public:
  TimePoint now() override { return TimePoint(); }
  bool waitUntil(std::unique_lock<std::mutex>& lock, std::condition_variable& changed,
                 TimePoint /*deadline*/, const std::function<bool()>& isDone) override {
    changed.wait(lock, isDone);
    return true;
  }
};

/// Collects the replies of one command; the command is over when its handler has been destroyed.
class Replies {
 public:
  void add(const NDDictionary& reply) {
    const std::scoped_lock lock(mutex_);
    replies_.push_back(reply);
  }
  std::vector<NDDictionary> take() {
    const std::scoped_lock lock(mutex_);
    return std::move(replies_);
  }

 private:
  std::mutex mutex_;
  std::vector<NDDictionary> replies_;
};

std::vector<NDDictionary> perform(const VAHACommand& request) {
  Replies replies;
  std::promise<void> ended;
  {
    std::shared_ptr<void> end(nullptr, [&ended](void*) { ended.set_value(); });
    std::make_shared<NDAssistantCommand>(request)->performWithCompletion(
        [&replies, end](const NDDictionary& reply) { replies.add(reply); });
  }
  ended.get_future().wait();
  return replies.take();
}

NDString textOf(const NDDictionary& dictionary, std::string_view key) {
  const NDDictionaryValue* value = dictionary.find(key);
  const NDString* text = value ? std::get_if<NDString>(&value->content()) : nullptr;
  return text ? *text : NDString();
}

const NDDictionaryList& resultsOf(const NDDictionary& reply) {
  return std::get<NDDictionaryList>(reply.find("actionResults")->content());
}

const NDDictionary& resultOf(const NDDictionary& reply, std::size_t index) {
  return std::get<NDDictionary>(resultsOf(reply).at(index).content());
}

std::int64_t integerOf(const NDDictionary& result) {
  const auto& value = std::get<NDDictionary>(result.find("resultValue")->content());
  return std::get<std::int64_t>(value.find("integer")->content());
}

/// A command in short: what it names and what it does.
struct Request : VAHACommand {
  Request(const std::function<void(VAHASearchCriteriaFilter&)>& name, std::string_view type,
          std::string_view attribute, VAHAValueRef value = nullptr) {
    auto filter = std::make_shared<VAHASearchCriteriaFilter>();
    name(*filter);
    setFilter(std::move(filter));
    auto action = std::make_shared<VAHAAction>();
    action->setActionType(type);
    action->setAttribute(attribute);
    action->setValue(std::move(value));
    setActions({std::move(action)});
  }
};

VAHAValueRef integerValue(std::int64_t number) {
  auto value = VAHAIntegerValue::integerValue();
  value->setValue(number);
  return value;
}

VAHAValueRef yes() {
  auto value = VAHABooleanValue::booleanValue();
  value->setValue(true);
  return value;
}

/// One of the threads: gives commands on the room of its own and judges every reply.
class Caller {
 public:
  Caller(std::size_t room, std::size_t commands) : room_(room), commands_(commands) {}

  void run() {
    for (std::size_t i = 0; i < commands_; ++i) {
      (this->*kCommandsInTurn[i % kCommandsInTurn.size()])(i);
    }
  }
  [[nodiscard]] const std::map<std::string, std::size_t>& complaints() const { return complaints_; }

 private:
  using Step = void (Caller::*)(std::size_t);
  static const std::array<Step, 8> kCommandsInTurn;

  void expect(bool holds, const std::string& what) {
    if (!holds) ++complaints_[what];
  }
  void expectOne(const std::vector<NDDictionary>& replies, std::string_view outcome,
                 std::size_t results, const std::string& what) {
    expect(replies.size() == 1, what + ": number of replies");
    if (replies.size() != 1) return;
    expect(textOf(replies[0], "commandOutcome") == outcome, what + ": outcome");
    expect(resultsOf(replies[0]).size() == results, what + ": number of results");
  }
  [[nodiscard]] static auto lamp(NDString name) {
    return
        [name = std::move(name)](VAHASearchCriteriaFilter& filter) { filter.setServiceName(name); };
  }

  void readRoom(std::size_t /*i*/) {
    const auto replies = perform(
        Request([this](VAHASearchCriteriaFilter& filter) { filter.setRoomName(roomName(room_)); },
                VAHAActionTypeGETValue, "BRIGHTNESS"));
    // The unlock report, and what was read before the locked lamp.
    expect(replies.size() == 2, "read of a room with a locked lamp: number of replies");
    std::multiset<std::string> outcomes;
    for (const auto& reply : replies) outcomes.insert(textOf(reply, "commandOutcome").str());
    expect(outcomes == std::multiset<std::string>{"COMMAND_SUCCESS", "REQUIRES_UNLOCK"},
           "read of a room with a locked lamp: outcomes");
  }
  void writeLamp(std::size_t i) {
    level_ = static_cast<std::int64_t>(i % 60);
    const auto replies = perform(Request(lamp(lampName(room_, 1)), VAHAActionTypeSETValue,
                                         "BRIGHTNESS", integerValue(level_)));
    expectOne(replies, VAHACommandOutcomeCOMMAND_SUCCESSValue, 1, "write");
    if (replies.size() == 1 && resultsOf(replies[0]).size() == 1) {
      expect(integerOf(resultOf(replies[0], 0)) == level_, "write: value");
    }
  }
  void raiseLamp(std::size_t /*i*/) {
    const auto replies =
        perform(Request(lamp(lampName(room_, 1)), VAHAActionTypeINCREASEValue, "BRIGHTNESS"));
    level_ += 5;
    expectOne(replies, VAHACommandOutcomeCOMMAND_SUCCESSValue, 1, "raise");
    if (replies.size() == 1 && resultsOf(replies[0]).size() == 1) {
      expect(integerOf(resultOf(replies[0], 0)) == level_, "raise: value");
    }
  }
  void toggleLocked(std::size_t /*i*/) {
    expectOne(perform(Request(lamp(lockedLampName(room_)), VAHAActionTypeTOGGLEValue, "POWER")),
              VAHACommandOutcomeREQUIRES_UNLOCKValue, 0, "toggle of a locked lamp");
  }
  void readUnreachable(std::size_t /*i*/) {
    const auto replies =
        perform(Request(lamp(unreachableLampName(room_)), VAHAActionTypeGETValue, "POWER"));
    expectOne(replies, VAHACommandOutcomeCOMMAND_SUCCESSValue, 1, "unreachable");
    if (replies.size() == 1 && resultsOf(replies[0]).size() == 1) {
      expect(textOf(resultOf(replies[0], 0), "outcome") == VAHAActionOutcomeUNREACHABLEValue,
             "unreachable: outcome of the object");
    }
  }
  void runScene(std::size_t /*i*/) {
    expectOne(
        perform(Request(
            [this](VAHASearchCriteriaFilter& filter) { filter.setSceneName(sceneName(room_)); },
            VAHAActionTypeSETValue, VAHAAttributeENABLEDValue, yes())),
        VAHACommandOutcomeCOMMAND_SUCCESSValue, 1, "scene");
  }
  void nameNothing(std::size_t /*i*/) {
    expectOne(perform(Request(lamp("Nothing"), VAHAActionTypeGETValue, "POWER")),
              VAHACommandOutcomeFOUND_NO_MATCHING_ENTITIESValue, 0, "no match");
  }
  void askUnknown(std::size_t /*i*/) {
    expectOne(perform(Request(lamp(lampName(room_, 2)), "FLY", "POWER")),
              VAHACommandOutcomeCOMMAND_FAILUREValue, 0, "unknown action");
  }

  const std::size_t room_;
  const std::size_t commands_;
  std::int64_t level_ = 0;
  std::map<std::string, std::size_t> complaints_;
};

const std::array<Caller::Step, 8> Caller::kCommandsInTurn = {
    &Caller::readRoom,        &Caller::writeLamp, &Caller::raiseLamp,   &Caller::toggleLocked,
    &Caller::readUnreachable, &Caller::runScene,  &Caller::nameNothing, &Caller::askUnknown};

class BeginInfo final : public AFSyncBeginInfo {
 public:
  void resetWithValidity(const NDString& validity) override {
    const std::scoped_lock lock(mutex_);
    resets_.push_back(validity);
  }
  std::vector<NDString> resets() {
    const std::scoped_lock lock(mutex_);
    return resets_;
  }

 private:
  std::mutex mutex_;
  std::vector<NDString> resets_;
};

class ChangeInfo final : public AFSyncChangeInfo {
 public:
  void setObject(std::shared_ptr<const VAHAEntity> object) override { object_ = std::move(object); }
  void setPostAnchor(const NDString& anchor) override { anchor_ = anchor; }
  [[nodiscard]] bool isEnd() const { return object_ == nullptr; }
  [[nodiscard]] const NDString& anchor() const { return anchor_; }

 private:
  std::shared_ptr<const VAHAEntity> object_;
  NDString anchor_;
};

/// Performs one sync; the number of entities pulled, or none unless it was reset exactly once.
std::optional<std::size_t> syncOnce() {
  const auto sync = NDAssistantSyncHome::init();
  auto begin = std::make_shared<BeginInfo>();
  sync->beginSyncWithAnchor_validity_forKey_beginInfo(nullptr, nullptr, "com.corvane.nidus.name",
                                                      begin);
  if (begin->resets() != std::vector<NDString>{NDString("3405691582")}) return std::nullopt;
  std::size_t entities = 0;
  ChangeInfo change;
  for (NDString anchor;; anchor = change.anchor(), ++entities) {
    sync->getChangeAfterAnchor_changeInfo(anchor, change);
    if (change.isEnd()) break;
  }
  sync->syncDidEnd();
  return entities;
}

TEST(LoadTest, EveryCommandAndSyncIsAnsweredAsItShould) {
  const std::size_t commands = countOf("NIDUS_LOAD_COMMANDS", kCommands);
  const std::size_t syncs = countOf("NIDUS_LOAD_SYNCS", commands / kCommandsPerSync);
  auto platform = HomePlatform::open({.locked = true,
                                      .clock = std::make_shared<StandingClock>(),
                                      .logSink = [](const NDSystemLogMessage&) {}});
  ASSERT_TRUE(platform) << platform.failure().message;
  ASSERT_FALSE((*platform)->importHomes(loadHomes(kThreads), false));
  ASSERT_EQ(NDPlatform::registerPlatform(*platform), "");

  std::vector<Caller> callers;
  callers.reserve(kThreads);
  for (std::size_t room = 0; room < kThreads; ++room) {
    callers.emplace_back(room, commands / kThreads);
  }
  std::atomic<std::size_t> running = kThreads;
  std::atomic<std::size_t> badSyncs = 0;
  std::vector<std::thread> threads;
  threads.reserve(kThreads);
  const auto mainQueue = (*platform)->mainQueue();
  for (auto& caller : callers) {
    threads.emplace_back([&] {
      caller.run();
      for (std::size_t i = 0; i < syncs / kThreads; ++i) {
        if (syncOnce() != entityCount(kThreads)) ++badSyncs;
      }
      --running;
      mainQueue->wake();
    });
  }
  mainQueue->runUntil([&running] { return running == 0; });
  for (auto& thread : threads) thread.join();

  for (const auto& caller : callers) {
    EXPECT_THAT(caller.complaints(), testing::IsEmpty());
  }
  EXPECT_EQ(badSyncs, 0U);
  (*platform)->shutDown();
  NDPlatform::unregisterPlatform(*platform);
}

}  // namespace
}  // namespace nidus
