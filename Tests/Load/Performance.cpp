#include "Load/Performance.h"

#include <utility>

#include "PlatformModel/System/NDMutex.h"

namespace nidus {
namespace {

/// Collects the replies of one command, which is over when this is destroyed.
class Collector {
 public:
  Collector(StressRecord& record, EndHandler onEnd) : record_(record), onEnd_(std::move(onEnd)) {}
  ~Collector() {
    onEnd_(replies_);
    if (replies_.empty()) ++record_.unanswered;
    ++record_.ended;
  }
  Collector(const Collector&) = delete;
  Collector& operator=(const Collector&) = delete;

  void add(const NDDictionary& reply) {
    ++record_.replies;
    if (record_.isDue(Plant::lostReply)) return;
    const NDLock lock(mutex_);
    replies_.push_back(reply);
  }

 private:
  StressRecord& record_;
  const EndHandler onEnd_;
  NDMutex mutex_;
  Replies replies_;
};

/// What a planted leak keeps, for good.
void leak(const std::shared_ptr<NDAssistantCommand>& command) {
  static auto& kept = *new std::vector<std::shared_ptr<NDAssistantCommand>>;
  kept.push_back(command);
}

}  // namespace

std::shared_ptr<NDAssistantCommand> perform(const LoadCommand& command, StressRecord& record,
                                            EndHandler onEnd) {
  ++record.commands;
  auto performed = std::make_shared<NDAssistantCommand>(*command.request());
  record.lives.add("commands", performed);
  if (record.isDue(Plant::leakedCommand)) leak(performed);
  performed->performWithCompletion(
      [collector = std::make_shared<Collector>(record, std::move(onEnd))](
          const NDDictionary& reply) { collector->add(reply); });
  return performed;
}

}  // namespace nidus
