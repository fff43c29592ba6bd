#include "Assistant/CommandTest.h"

#include <algorithm>
#include <utility>

#include "PlatformModel/System/NDMutex.h"
#include "Support/FreshProcess.h"

namespace nidus {
namespace {

TestPlatform& platform() { return *TestPlatform::shared(); }

/// The list under `key` of a reply; empty when there is none.
NDDictionaryList listAt(const NDDictionary& reply, std::string_view key) {
  const NDDictionaryValue* value = reply.find(key);
  return value ? std::get<NDDictionaryList>(value->content()) : NDDictionaryList();
}

}  // namespace

/// What the handlers of a test have in common. Replies may come on any thread.
struct CommandTest::State {
  mutable NDMutex mutex;
  ReplyTexts replies ND_GUARDED_BY(mutex);
  NDDictionary lastReply ND_GUARDED_BY(mutex);
  std::function<void()> onReply ND_GUARDED_BY(mutex);
  std::vector<std::weak_ptr<const bool>> handlers ND_GUARDED_BY(mutex);

  void take(const NDDictionary& reply) {
    std::function<void()> callback;
    {
      const NDLock lock(mutex);
      replies.push_back(summary(reply));
      lastReply = reply;
      callback = onReply;
    }
    if (callback) callback();
  }
};

CommandTest::CommandTest() : state_(std::make_unique<State>()) {
  EXPECT_EQ(NDPlatform::registerPlatform(TestPlatform::shared()), "");
  platform().setHomes({});
  platform().setSilent(false);
  setReporting(TestPlatform::Reporting::queued);
  configureHomes(true);
  setLocale(true);
  logLevel(6);
  clearLog();
}

CommandTest::~CommandTest() {
  runUntilIdle();
  platform().setHomes({});
  NDPlatform::unregisterPlatform(TestPlatform::shared());
}

void CommandTest::useHomes(const std::vector<std::shared_ptr<TestHome>>& homes) {
  platform().setHomes(homes);
}

std::shared_ptr<TestHome> CommandTest::useHome(HomeBuilder& builder) {
  auto home = builder.build();
  useHomes({home});
  return home;
}

void CommandTest::configureHomes(bool areConfigured) { platform().configureHomes(areConfigured); }

void CommandTest::silencePlatform() { platform().setSilent(true); }

void CommandTest::setReporting(TestPlatform::Reporting reporting) {
  platform().setReporting(reporting);
}

void CommandTest::setLocale(std::optional<bool> isMetric) { platform().setLocale(isMetric); }

void CommandTest::logLevel(int level) { platform().setLogLevel(level); }

void CommandTest::perform(std::shared_ptr<NDAssistantCommand> command) {
  command->performWithCompletion(handler());
  command.reset();
  runUntilIdle();
}

std::shared_ptr<NDAssistantCommand> CommandTest::performed(
    std::shared_ptr<NDAssistantCommand> command) {
  perform(command);
  clearReplies();
  clearLog();
  return command;
}

void CommandTest::actInAllHomes(const Action& action) {
  const auto command = performed(makeCommand(nullptr, {}));
  NDAssistantCommand::ObjectList services = command->allObjects();
  std::erase_if(services, [](const HomeObjectRecord* object) {
    return object->objectType != VAHAEntityTypeSERVICEValue;
  });
  const std::string_view type = action.type;
  const auto handle =
      type == VAHAActionTypeGETValue
          ? &NDAssistantCommand::handleGetActionTypes_serviceType_forObjects_completionHandler
      : type == VAHAActionTypeSETValue
          ? &NDAssistantCommand::handleSetActionTypes_serviceType_forObjects_completionHandler
          : &NDAssistantCommand::handleUpdateActionTypes_serviceType_forObjects_completionHandler;
  ((*command).*handle)(makeAction(action), nullptr, services, handler());
  runUntilIdle();
}

VAHAReplyHandler CommandTest::handler() {
  auto life = std::make_shared<const bool>(true);
  const NDLock lock(state_->mutex);
  state_->handlers.push_back(life);
  return [state = state_.get(), life](const NDDictionary& reply) { state->take(reply); };
}

void CommandTest::onReply(std::function<void()> callback) {
  const NDLock lock(state_->mutex);
  state_->onReply = std::move(callback);
}

bool CommandTest::isHandlerReleased() const {
  const NDLock lock(state_->mutex);
  return std::all_of(state_->handlers.begin(), state_->handlers.end(),
                     [](const auto& life) { return life.expired(); });
}

ReplyTexts CommandTest::replies() const {
  const NDLock lock(state_->mutex);
  return state_->replies;
}

NDDictionary CommandTest::lastReply() const {
  const NDLock lock(state_->mutex);
  return state_->lastReply;
}

void CommandTest::clearReplies() {
  const NDLock lock(state_->mutex);
  state_->replies.clear();
}

void CommandTest::runUntilIdle() { platform().runUntilIdle(); }

bool CommandTest::runOneOfMainQueue() { return platform().mainQueue()->runOne(); }

std::vector<std::string> CommandTest::log() const { return platform().log(); }

std::vector<std::string> CommandTest::log(int level) const {
  std::vector<std::string> messages = log();
  const std::string start = std::to_string(level) + " ";
  std::erase_if(messages, [&start](const auto& message) { return !message.starts_with(start); });
  return messages;
}

void CommandTest::clearLog() { platform().clearLog(); }

std::vector<NDAssistantCommand::CharacteristicList> CommandTest::batchesRead(const TestHome& home) {
  std::vector<NDAssistantCommand::CharacteristicList> batches;
  for (const auto& batch : home.reads()) batches.emplace_back(batch.begin(), batch.end());
  return batches;
}

std::vector<std::string> CommandTest::written(const TestHome& home) {
  std::vector<std::string> texts;
  for (const auto& batch : home.writes()) {
    for (const auto& [characteristic, value] : batch) {
      texts.push_back(characteristic->service()->name().str() + "=" + description(value));
    }
  }
  return texts;
}

std::vector<std::string> CommandTest::entityTexts(const NDDictionary& reply, std::string_view key) {
  std::vector<std::string> texts;
  for (const auto& result : listAt(reply, "actionResults")) {
    const NDDictionaryValue* entity = std::get<NDDictionary>(result.content()).find("entity");
    const NDDictionaryValue* text = std::get<NDDictionary>(entity->content()).find(key);
    texts.push_back(text ? std::get<NDString>(text->content()).str() : "none");
  }
  return texts;
}

void CommandTest::inProcessWithLocale(std::optional<bool> isMetric,
                                      const std::function<void()>& body) {
  inFreshProcess([&] {
    setLocale(isMetric);
    body();
  });
}

}  // namespace nidus
