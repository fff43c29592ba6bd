#include "HomePlatform/System/PlatformQueues.h"

#include <algorithm>
#include <thread>
#include <utility>

#include "HomePlatform/System/CallerClock.h"
#include "HomePlatform/System/CallerQueue.h"
#include "HomePlatform/System/TrackedQueue.h"
#include "PlatformModel/System/NDDeliveryHold.h"

namespace nidus {
namespace {

constexpr std::size_t kLeastSharedThreads = 2;
constexpr std::size_t kGreatestSharedThreads = 4;

std::size_t sharedWidth() {
  return std::clamp<std::size_t>(std::thread::hardware_concurrency(), kLeastSharedThreads,
                                 kGreatestSharedThreads);
}

class ThreadedQueues final : public PlatformQueues {
 public:
  explicit ThreadedQueues(std::shared_ptr<NDClock> clock) : clock_(std::move(clock)) {
    if (!clock_) clock_ = std::make_shared<NDSystemClock>();
  }

  [[nodiscard]] std::shared_ptr<NDMainQueue> main() const override { return main_; }
  [[nodiscard]] std::shared_ptr<NDQueue> shared() const override { return shared_; }
  [[nodiscard]] std::shared_ptr<NDQueue> deliveries() const override { return deliveries_; }
  [[nodiscard]] std::shared_ptr<NDClock> clock() const override { return clock_; }
  [[nodiscard]] WorkToken token() const override { return WorkToken(tracker_); }

  void drain() override {
    NDDeliveryHold::releaseForWait();
    // Only work adds work: once nothing is counted, what the main queue still holds is all.
    do {
      main_->runUntil([this] { return tracker_->isIdle(); });
    } while (main_->drain() > 0);
  }

  void shutDown() override {
    deliveries_->shutDown();
    shared_->shutDown();
  }

 private:
  const std::shared_ptr<NDMainQueue> main_ = std::make_shared<NDMainQueue>();
  const std::shared_ptr<WorkTracker> tracker_ = std::make_shared<WorkTracker>(main_);
  const std::shared_ptr<TrackedQueue> shared_ =
      std::make_shared<TrackedQueue>(sharedWidth(), tracker_);
  const std::shared_ptr<TrackedQueue> deliveries_ = std::make_shared<TrackedQueue>(1, tracker_);
  std::shared_ptr<NDClock> clock_;
};

class OnCallerQueues final : public PlatformQueues {
 public:
  explicit OnCallerQueues(std::shared_ptr<NDClock> clock) : clock_(std::move(clock)) {
    if (!clock_) clock_ = std::make_shared<CallerClock>(work_);
  }

  [[nodiscard]] std::shared_ptr<NDMainQueue> main() const override { return main_; }
  [[nodiscard]] std::shared_ptr<NDQueue> shared() const override { return work_; }
  [[nodiscard]] std::shared_ptr<NDQueue> deliveries() const override { return work_; }
  [[nodiscard]] std::shared_ptr<NDClock> clock() const override { return clock_; }
  [[nodiscard]] WorkToken token() const override { return WorkToken(nullptr); }

  void drain() override {
    NDDeliveryHold::releaseForWait();
    while (work_->runOne() || main_->runOne()) {
    }
  }

  void shutDown() override { work_->shutDown(); }

 private:
  const std::shared_ptr<NDMainQueue> main_ = std::make_shared<NDMainQueue>();
  const std::shared_ptr<CallerQueue> work_ = std::make_shared<CallerQueue>();
  std::shared_ptr<NDClock> clock_;
};

}  // namespace

std::unique_ptr<PlatformQueues> PlatformQueues::makeThreaded(std::shared_ptr<NDClock> clock) {
  return std::make_unique<ThreadedQueues>(std::move(clock));
}

std::unique_ptr<PlatformQueues> PlatformQueues::makeOnCaller(std::shared_ptr<NDClock> clock) {
  return std::make_unique<OnCallerQueues>(std::move(clock));
}

}  // namespace nidus
