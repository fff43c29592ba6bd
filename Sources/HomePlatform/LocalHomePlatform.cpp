#include "HomePlatform/LocalHomePlatform.h"

#include <utility>

#include "HomePlatform/Drivers/SimulatedDriver.h"
#include "HomePlatform/Objects/HomeManagerObject.h"
#include "HomePlatform/System/DataFolder.h"
#include "PlatformModel/System/NDDeliveryHold.h"

namespace nidus {
namespace {

constexpr const char* kPreferencesChanged = "com.corvane.managedconfiguration.defaultsdidchange";

std::unique_ptr<PlatformQueues> makeQueues(const HomePlatformOptions& options) {
  return options.drainsOnCaller ? PlatformQueues::makeOnCaller(options.clock)
                                : PlatformQueues::makeThreaded(options.clock);
}

std::shared_ptr<DeviceInformation> makeDeviceInformation(
    const HomePlatformOptions& options, const std::shared_ptr<Preferences>& preferences) {
  if (options.dataFolder) {
    return std::make_shared<DeviceInformation>(
        [preferences] { return preferences->valueForKey(DeviceInformation::kInternalBuild); });
  }
  return std::make_shared<DeviceInformation>(
      [isInternal = options.internalBuild] { return NDValue::boolean(isInternal); });
}

/// Delivers the homes of one manager once its delivery is let go.
struct Delivery {
  WorkToken token;  ///< Keeps a drain waiting for a delivery that another thread holds back.
  std::weak_ptr<HomeManagerObject> weakManager;
  std::shared_ptr<PendingManagers> pending;
  std::shared_ptr<NDQueue> queue;  ///< Null when the platform is silent.
  std::shared_ptr<HomeLibrary> library;
  std::function<void(const Failure&)> reportFailure;

  void operator()() const {
    const auto manager = weakManager.lock();
    if (!manager) return;
    if (!pending->add(manager)) return manager->reportNever();
    if (queue) queue->async([self = *this] { self.deliver(); });
  }

  void deliver() const {
    const auto manager = weakManager.lock();
    if (!manager) return;
    const Result<std::shared_ptr<const HomeEdition>> edition = library->current();
    if (!edition) reportFailure(edition.failure());
    manager->report(edition ? (*edition)->homes : NDArray<NDHome>());
  }
};

}  // namespace

LocalHomePlatform::LocalHomePlatform(HomePlatformOptions options, Parts parts)
    : options_(std::move(options)),
      preferences_(std::move(parts.preferences)),
      mapper_(std::move(parts.mapper)),
      store_(std::move(parts.store)),
      deviceLock_(std::make_shared<DeviceLock>(options_.locked)),
      deviceInformation_(makeDeviceInformation(options_, preferences_)),
      locale_(std::make_shared<Locale>(options_.metric ? *options_.metric : isMetricEnvironment())),
      log_(std::make_shared<LogService>(options_.logSink)),
      queues_(makeQueues(options_)),
      library_(std::make_shared<HomeLibrary>(store_)),
      calls_(std::make_shared<HomeCalls>(HomeCalls::Parts{
          library_,
          std::make_shared<SimulatedDriver>(library_, mapper_, deviceLock_, queues_->shared(),
                                            options_.failureHandler),
          queues_->shared(), options_.callObserver, options_.failureHandler})),
      notifications_(std::make_shared<NotificationCenter>([this](const NDString& name) {
        if (name == kPreferencesChanged) watchPreferences();
      })) {
  library_->setCalls(calls_);
}

LocalHomePlatform::~LocalHomePlatform() { shutDown(); }

std::shared_ptr<NDHomeManager> LocalHomePlatform::createHomeManager() {
  auto manager = std::make_shared<HomeManagerObject>(pendingManagers_);
  NDDeliveryHold::whenReleased(Delivery{queues_->token(), manager, pendingManagers_,
                                        isSilent_.load() ? nullptr : queues_->deliveries(),
                                        library_, options_.failureHandler});
  return manager;
}

NDString LocalHomePlatform::homeConfigurationPath() { return preferences_->containerPath(); }

std::shared_ptr<NDNAPMetadata> LocalHomePlatform::metadata() { return mapper_; }

std::shared_ptr<NDDeviceInformation> LocalHomePlatform::deviceInformation() {
  return deviceInformation_;
}

std::shared_ptr<NDNotificationCenter> LocalHomePlatform::notificationCenter() {
  return notifications_;
}

Status LocalHomePlatform::importHomes(const std::vector<HomeData>& homes, bool merge,
                                      const StoreProgress& progress) {
  return changeHomes([&] {
    return merge ? store_->mergeHomes(homes, progress) : store_->replaceHomes(homes, progress);
  });
}

Status LocalHomePlatform::editHomes(const HomeEdit& edit) {
  return changeHomes([&] { return store_->editHomes(edit); });
}

Status LocalHomePlatform::changeHomes(const std::function<Status()>& change) {
  if (!options_.dataFolder) return changeHomesUnlocked(change);
  // Two changes at the same time would otherwise leave a preference that suits neither.
  const Result<FolderLock> lock = FolderLock::take(*options_.dataFolder);
  return lock ? changeHomesUnlocked(change) : Status(lock.failure());
}

Status LocalHomePlatform::changeHomesUnlocked(const std::function<Status()>& change) {
  if (Status failure = preferences_->check()) return failure;
  if (Status failure = change()) return failure;
  const Result<std::int64_t> count = store_->countHomes();
  if (!count) return count.failure();
  return preferences_->change({{Preferences::kHomesConfigured, JsonValue{*count > 0}}});
}

Result<std::vector<HomeData>> LocalHomePlatform::exportHomes() { return store_->loadHomes(); }

Result<std::unique_ptr<HomeWatch>> LocalHomePlatform::watchHomes(HomeWatch::Handler handler) {
  if (!options_.dataFolder) {
    return Failure{Failure::Kind::badInput,
                   "homes in memory cannot be watched; open those of a data folder"};
  }
  return HomeWatch::start(*options_.dataFolder / kDatabaseFile, std::move(handler));
}

Status LocalHomePlatform::changePreferences(const std::map<std::string, JsonValue>& changes) {
  if (options_.dataFolder) {
    const Result<FolderLock> lock = FolderLock::take(*options_.dataFolder);
    if (!lock) return lock.failure();
    if (Status failure = preferences_->change(changes)) return failure;
  } else {
    if (Status failure = preferences_->change(changes)) return failure;
  }
  static_cast<void>(preferences_->takeChange());  // this one is posted here
  notifications_->post(kPreferencesChanged);
  return std::nullopt;
}

void LocalHomePlatform::shutDown() {
  std::unique_ptr<FolderWatch> watch;
  {
    const NDLock lock(mutex_);
    if (std::exchange(isShutDown_, true)) return;
    watch = std::move(watch_);
  }
  watch.reset();
  queues_->shutDown();
  pendingManagers_->close();
}

/// Watches the preferences on disk from the first registration on; without threads there is nobody
/// to watch.
void LocalHomePlatform::watchPreferences() {
  if (!options_.dataFolder || options_.drainsOnCaller) return;
  const NDLock lock(mutex_);
  if (isShutDown_ || watch_) return;
  auto started = FolderWatch::start(*options_.dataFolder, {{Preferences::kFileName}}, [this] {
    preferences_->synchronize();
    if (preferences_->takeChange()) notifications_->post(kPreferencesChanged);
  });
  if (started) {
    watch_ = std::move(*started);
  } else {
    options_.failureHandler(started.failure());
  }
}

}  // namespace nidus
