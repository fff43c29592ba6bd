#include "AssistantHost/CommandRunner.h"

#include <string>
#include <utility>

#include "AssistantHost/AnswerCollector.h"

namespace nidus {

CommandRunner::CommandRunner(const NDAssistantModule& module,
                             std::shared_ptr<NDMainQueue> mainQueue, std::function<void()> drain)
    : module_(module), mainQueue_(std::move(mainQueue)), drain_(std::move(drain)) {}

Result<std::vector<NDDictionary>> CommandRunner::perform(
    const VAHACommand& request, std::shared_ptr<NDAssistantCommandObserver> observer) {
  using Replies = AnswerCollector<NDDictionary>;
  const auto replies = std::make_shared<Replies>();
  std::string message;
  if (auto command = module_.makeCommand(request, std::move(observer), message)) {
    command->performWithCompletion(Replies::handler(replies, mainQueue_));
  } else {
    return Failure{Failure::Kind::platform, message};
  }
  waitUntil([&replies] { return replies->isOver(); });
  return replies->take();
}

Result<NDDictionaryList> CommandRunner::records() {
  using Snapshots = AnswerCollector<NDDictionaryList>;
  const auto snapshots = std::make_shared<Snapshots>();
  std::string message;
  if (!module_.gatherRecords(Snapshots::handler(snapshots, mainQueue_), message)) {
    return Failure{Failure::Kind::platform, message};
  }
  waitUntil([&snapshots] { return snapshots->isOver(); });
  auto taken = snapshots->take();
  return taken.empty() ? NDDictionaryList() : std::move(taken.front());
}

void CommandRunner::waitUntil(const std::function<bool()>& isDone) {
  if (drain_) {
    drain_();
  } else {
    mainQueue_->runUntil(isDone);
  }
}

}  // namespace nidus
