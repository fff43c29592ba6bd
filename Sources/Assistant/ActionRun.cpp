#include "Assistant/ActionRun.h"

#include "PlatformModel/NDPlatform.h"
#include "PlatformModel/System/NDMutex.h"

namespace nidus {

/// Results in the order in which they were made.
class ActionRun::ResultList {
 public:
  explicit ResultList(std::size_t expected) { results_.reserve(expected); }

  void append(std::shared_ptr<const VAHAActionResult> result) {
    const NDLock lock(mutex_);
    results_.push_back(std::move(result));
  }

  [[nodiscard]] NDAssistantCommand::Results take() {
    const NDLock lock(mutex_);
    return std::move(results_);
  }

 private:
  NDMutex mutex_;
  NDAssistantCommand::Results results_ ND_GUARDED_BY(mutex_);
};

ActionRun::ActionRun(std::shared_ptr<const NDAssistantCommand> command, VAHAActionRef action,
                     NDString serviceType, VAHAReplyHandler handler, std::size_t expected)
    : command_(std::move(command)),
      action_(std::move(action)),
      serviceType_(std::move(serviceType)),
      handler_(std::move(handler)),
      results_(std::make_shared<ResultList>(expected)),
      // Nobody waits for this group, so any clock will do.
      group_(std::make_shared<NDWaitGroup>(std::make_shared<NDSystemClock>())) {}

ActionRun::~ActionRun() = default;

void ActionRun::ResultWriter::add(std::string_view outcome,
                                  const std::shared_ptr<NDService>& service) {
  results_->append(maker_.make(outcome, service));
}

void ActionRun::ResultWriter::addIfAnswer(std::string_view outcome,
                                          const std::shared_ptr<NDService>& service) {
  if (auto result = maker_.makeIfAnswer(outcome, service)) results_->append(std::move(result));
}

void ActionRun::reportWhenAnswered() const {
  const auto platform = NDPlatform::registered();
  if (!platform) return;  // It is being shut down, and nobody drains the main queue any more.
  group_->notify(platform->mainQueue(),
                 [command = command_, handler = handler_, results = results_] {
                   command->reportResults_handler(results->take(), handler);
                 });
}

}  // namespace nidus
