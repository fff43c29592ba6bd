#pragma once

#include <memory>
#include <string>

#include "PlatformModel/Home/NDHomeManager.h"
#include "PlatformModel/Home/NDNAPMetadata.h"
#include "PlatformModel/System/NDClock.h"
#include "PlatformModel/System/NDDeviceInformation.h"
#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDLocale.h"
#include "PlatformModel/System/NDMainQueue.h"
#include "PlatformModel/System/NDNotificationCenter.h"
#include "PlatformModel/System/NDPreferences.h"
#include "PlatformModel/System/NDQueue.h"
#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDSystemLog.h"

namespace nidus {

/// All that a home-automation platform supplies, in one place. One platform is registered per
/// process before the plug-in is used.
///
/// Every operation may be called from any thread. No result is null.
///
///     if (auto refusal = NDPlatform::registerPlatform(platform); !refusal.empty()) fail(refusal);
class ND_EXPORT NDPlatform {
 public:
  virtual ~NDPlatform();

  /// Creates a home manager and starts its load; see `NDHomeManager` and `NDDeliveryHold`.
  [[nodiscard]] virtual std::shared_ptr<NDHomeManager> createHomeManager() = 0;
  [[nodiscard]] virtual NDString homeConfigurationPath() = 0;
  [[nodiscard]] virtual std::shared_ptr<NDNAPMetadata> metadata() = 0;

  [[nodiscard]] virtual std::shared_ptr<NDPreferences> preferences() = 0;
  [[nodiscard]] virtual std::shared_ptr<NDDeviceInformation> deviceInformation() = 0;
  [[nodiscard]] virtual std::shared_ptr<NDLocale> locale() = 0;
  [[nodiscard]] virtual std::shared_ptr<NDSystemLog> systemLog() = 0;
  [[nodiscard]] virtual std::shared_ptr<NDNotificationCenter> notificationCenter() = 0;

  /// The main queue, which the host drains.
  [[nodiscard]] virtual std::shared_ptr<NDMainQueue> mainQueue() = 0;
  /// The shared concurrent queue of default priority.
  [[nodiscard]] virtual std::shared_ptr<NDQueue> sharedQueue() = 0;
  [[nodiscard]] virtual std::shared_ptr<NDClock> clock() = 0;

  /// Registers the one platform of the process, which is then kept alive. Gives an empty text, or,
  /// when another is registered or `platform` is null, the reason for people, and changes nothing.
  [[nodiscard]] static std::string registerPlatform(std::shared_ptr<NDPlatform> platform);
  /// Ends the registration of `platform`; nothing happens when it is not the registered one.
  static void unregisterPlatform(const std::shared_ptr<NDPlatform>& platform);
  /// The registered platform; null when there is none.
  [[nodiscard]] static std::shared_ptr<NDPlatform> registered();
};

}  // namespace nidus
