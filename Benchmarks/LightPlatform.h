#pragma once

#include <memory>
#include <utility>

#include "HomePlatform/HomePlatform.h"
#include "PlatformModel/Home/NDHome.h"

namespace nidus {

/// A platform that has its homes at hand and answers at once, on the calling thread. Each thread
/// has a main queue of its own, so that threads can perform commands of their own side by side.
/// Preferences, log, clock and the other services of a system are those of an embedded platform
/// in memory.
class LightPlatform final : public NDPlatform {
 public:
  LightPlatform(std::shared_ptr<HomePlatform> system, NDArray<NDHome> homes);

  [[nodiscard]] std::shared_ptr<NDHomeManager> createHomeManager() override;
  [[nodiscard]] NDString homeConfigurationPath() override {
    return system_->homeConfigurationPath();
  }
  [[nodiscard]] std::shared_ptr<NDNAPMetadata> metadata() override { return metadata_; }
  [[nodiscard]] std::shared_ptr<NDPreferences> preferences() override {
    return system_->preferences();
  }
  [[nodiscard]] std::shared_ptr<NDDeviceInformation> deviceInformation() override {
    return system_->deviceInformation();
  }
  [[nodiscard]] std::shared_ptr<NDLocale> locale() override { return system_->locale(); }
  [[nodiscard]] std::shared_ptr<NDSystemLog> systemLog() override { return system_->systemLog(); }
  [[nodiscard]] std::shared_ptr<NDNotificationCenter> notificationCenter() override {
    return system_->notificationCenter();
  }
  /// The queue of the calling thread.
  [[nodiscard]] std::shared_ptr<NDMainQueue> mainQueue() override;
  [[nodiscard]] std::shared_ptr<NDQueue> sharedQueue() override { return system_->sharedQueue(); }
  [[nodiscard]] std::shared_ptr<NDClock> clock() override { return system_->clock(); }

 private:
  const std::shared_ptr<HomePlatform> system_;
  const NDArray<NDHome> homes_;
  const std::shared_ptr<NDNAPMetadata> metadata_;
};

}  // namespace nidus
