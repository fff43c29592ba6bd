#pragma once

#include <atomic>
#include <filesystem>
#include <memory>
#include <optional>

#include "HomePlatform/HomePlatform.h"
#include "HomePlatform/Metadata/MetadataMapper.h"
#include "HomePlatform/Objects/HomeCalls.h"
#include "HomePlatform/Objects/HomeLibrary.h"
#include "HomePlatform/Objects/PendingManagers.h"
#include "HomePlatform/System/DeviceInformation.h"
#include "HomePlatform/System/DeviceLock.h"
#include "HomePlatform/System/FolderWatch.h"
#include "HomePlatform/System/Locale.h"
#include "HomePlatform/System/LogService.h"
#include "HomePlatform/System/NotificationCenter.h"
#include "HomePlatform/System/PlatformQueues.h"
#include "HomePlatform/System/Preferences.h"

namespace nidus {

/// The platform that `HomePlatform::open` opens: puts the parts together and answers for them.
class LocalHomePlatform final : public HomePlatform {
 public:
  /// What has to be opened before there is a platform. `preferences`, `mapper` and `store` are
  /// never null.
  struct Parts {
    std::shared_ptr<Preferences> preferences;
    std::shared_ptr<MetadataMapper> mapper;
    std::shared_ptr<HomeStore> store;
  };

  /// `options.failureHandler` and `options.logSink` are not empty.
  LocalHomePlatform(HomePlatformOptions options, Parts parts);
  ~LocalHomePlatform() override;

  [[nodiscard]] std::shared_ptr<NDHomeManager> createHomeManager() override;
  [[nodiscard]] NDString homeConfigurationPath() override;
  [[nodiscard]] std::shared_ptr<NDNAPMetadata> metadata() override;
  [[nodiscard]] std::shared_ptr<NDPreferences> preferences() override { return preferences_; }
  [[nodiscard]] std::shared_ptr<NDDeviceInformation> deviceInformation() override;
  [[nodiscard]] std::shared_ptr<NDLocale> locale() override { return locale_; }
  [[nodiscard]] std::shared_ptr<NDSystemLog> systemLog() override { return log_; }
  [[nodiscard]] std::shared_ptr<NDNotificationCenter> notificationCenter() override;
  [[nodiscard]] std::shared_ptr<NDMainQueue> mainQueue() override { return queues_->main(); }
  [[nodiscard]] std::shared_ptr<NDQueue> sharedQueue() override { return queues_->shared(); }
  [[nodiscard]] std::shared_ptr<NDClock> clock() override { return queues_->clock(); }

  [[nodiscard]] Status importHomes(const std::vector<HomeData>& homes, bool merge,
                                   const StoreProgress& progress) override;
  [[nodiscard]] Status editHomes(const HomeEdit& edit) override;
  [[nodiscard]] Result<std::vector<HomeData>> exportHomes() override;
  [[nodiscard]] Result<std::unique_ptr<HomeWatch>> watchHomes(HomeWatch::Handler handler) override;
  [[nodiscard]] const Vocabulary& vocabulary() const noexcept override {
    return mapper_->vocabulary();
  }
  void setLocked(bool locked) override { deviceLock_->setLocked(locked); }
  void setSilent(bool silent) override { isSilent_.store(silent); }
  [[nodiscard]] std::map<std::string, JsonValue> preferenceValues() override {
    return preferences_->values();
  }
  [[nodiscard]] Status changePreferences(const std::map<std::string, JsonValue>& changes) override;
  void drain() override { queues_->drain(); }
  void shutDown() override;

 private:
  /// Makes a change of the stored homes and sets the preference that goes with it.
  [[nodiscard]] Status changeHomes(const std::function<Status()>& change);
  [[nodiscard]] Status changeHomesUnlocked(const std::function<Status()>& change);
  void watchPreferences();

  const HomePlatformOptions options_;
  const std::shared_ptr<Preferences> preferences_;
  const std::shared_ptr<MetadataMapper> mapper_;
  const std::shared_ptr<HomeStore> store_;
  const std::shared_ptr<DeviceLock> deviceLock_;
  const std::shared_ptr<DeviceInformation> deviceInformation_;
  const std::shared_ptr<Locale> locale_;
  const std::shared_ptr<LogService> log_;
  const std::unique_ptr<PlatformQueues> queues_;
  const std::shared_ptr<PendingManagers> pendingManagers_ = std::make_shared<PendingManagers>();
  const std::shared_ptr<HomeLibrary> library_;
  const std::shared_ptr<HomeCalls> calls_;
  std::atomic<bool> isSilent_{false};
  NDMutex mutex_;
  bool isShutDown_ ND_GUARDED_BY(mutex_) = false;
  std::unique_ptr<FolderWatch> watch_ ND_GUARDED_BY(mutex_);
  /// Last, because it calls back while others register.
  const std::shared_ptr<NotificationCenter> notifications_;
};

}  // namespace nidus
