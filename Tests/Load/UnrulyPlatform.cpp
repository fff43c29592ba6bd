#include "Load/UnrulyPlatform.h"

#include <optional>
#include <utility>

#include "Load/Ledger.h"
#include "Load/UnrulyManager.h"
#include "PlatformModel/System/NDDeliveryHold.h"
#include "Support/TestMetadata.h"

namespace nidus {
namespace {

constexpr std::size_t kSharedThreads = 3;
constexpr std::size_t kGreatestLooks = 9;

class MetricLocale final : public NDLocale {
 public:
  [[nodiscard]] std::optional<bool> usesMetricSystem() override { return true; }
};

class CustomerDevice final : public NDDeviceInformation {
 public:
  [[nodiscard]] NDValueRef answerForQuery(const NDString& /*query*/) override { return nullptr; }
};

}  // namespace

/// A clock whose time passes when nobody looks: now and then a wait is over at once, and so is one
/// for what will never come.
class UnrulyPlatform::Clock final : public NDClock {
 public:
  Clock(std::uint64_t seed, bool isPatient) : isPatient_(isPatient), random_(seed) {}

  [[nodiscard]] TimePoint now() override { return TimePoint(); }

  bool waitUntil(std::unique_lock<std::mutex>& lock, std::condition_variable& changed,
                 TimePoint /*deadline*/, const std::function<bool()>& isDone) override {
    const auto& ledger = Ledger::current();
    const bool isInVain = ledger && ledger->facts().isParked;
    if (isPatient_ && !isInVain && !passesAtOnce()) changed.wait(lock, isDone);
    if (isDone()) return true;
    if (ledger) ledger->timedOut();
    return false;
  }

 private:
  [[nodiscard]] bool passesAtOnce() {
    const NDLock lock(mutex_);
    return random_.oneIn(3);
  }

  const bool isPatient_;
  NDMutex mutex_;
  Random random_ ND_GUARDED_BY(mutex_);
};

/// The report of one manager. When it is destroyed without having been run, the platform has been
/// shut down.
struct UnrulyPlatform::Delivery {
  explicit Delivery(std::weak_ptr<UnrulyManager> waiting) : manager(std::move(waiting)) {}
  ~Delivery() {
    if (const auto waiting = manager.lock()) waiting->reportNever();
  }
  Delivery(const Delivery&) = delete;
  Delivery& operator=(const Delivery&) = delete;

  void run() {
    if (const auto waiting = std::exchange(manager, {}).lock()) waiting->report();
  }

  std::weak_ptr<UnrulyManager> manager;
};

struct UnrulyPlatform::CurrentHomes {
  explicit CurrentHomes(std::uint64_t seed) : random(seed) {}

  [[nodiscard]] NDArray<NDHome> get() {
    const NDLock lock(mutex);
    return homes;
  }

  NDMutex mutex;
  NDArray<NDHome> homes ND_GUARDED_BY(mutex);
  Random random ND_GUARDED_BY(mutex);
};

UnrulyPlatform::UnrulyPlatform(Services services, const Habits& habits, LifeWatch& lives)
    : services_(std::move(services)),
      lives_(lives),
      metadata_(std::make_shared<TestMetadata>()),
      mainQueue_(std::make_shared<NDMainQueue>()),
      sharedQueue_(std::make_shared<NDConcurrentQueue>(kSharedThreads)),
      answers_(std::make_shared<UnrulyQueue>(UnrulyQueue::Habits{.seed = habits.seed})),
      clock_(std::make_shared<Clock>(habits.seed, habits.isPatient)),
      current_(std::make_shared<CurrentHomes>(habits.seed)) {}

UnrulyPlatform::~UnrulyPlatform() { shutDown(); }

std::shared_ptr<NDHomeManager> UnrulyPlatform::createHomeManager() {
  const auto& ledger = Ledger::current();
  if (ledger) ledger->homesAsked();
  UnrulyManager::Show show{.homes = current_->get()};
  {
    const NDLock lock(current_->mutex);
    const bool areDeleted = current_->random.oneIn(8);
    const bool areReplaced = current_->random.oneIn(4);
    show.looks = current_->random.below(kGreatestLooks);
    if (areDeleted) {
      show.later = [] { return NDArray<NDHome>(); };
    } else if (areReplaced) {
      show.later = [current = current_] { return current->get(); };
    }
  }
  auto manager = std::make_shared<UnrulyManager>(ledger, std::move(show));
  lives_.add("home managers", manager);
  NDDeliveryHold::whenReleased(
      [queue = answers_, delivery = std::make_shared<Delivery>(manager)]() mutable {
        queue->async([started = std::move(delivery)] { started->run(); });
      });
  return manager;
}

std::shared_ptr<NDDeviceInformation> UnrulyPlatform::deviceInformation() {
  return std::make_shared<CustomerDevice>();
}

std::shared_ptr<NDLocale> UnrulyPlatform::locale() { return std::make_shared<MetricLocale>(); }

std::shared_ptr<NDClock> UnrulyPlatform::clock() { return clock_; }

void UnrulyPlatform::setHomes(NDArray<NDHome> homes) {
  const NDLock lock(current_->mutex);
  std::swap(current_->homes, homes);
}

void UnrulyPlatform::settle() {
  do {
    answers_->waitUntilIdle();
    sharedQueue_->waitUntilIdle();
  } while (mainQueue_->drain() > 0);
}

void UnrulyPlatform::shutDown() {
  answers_->shutDown();
  sharedQueue_->shutDown();
}

}  // namespace nidus
