#pragma once

#include <memory>

#include "Load/LifeWatch.h"
#include "Load/UnrulyQueue.h"
#include "PlatformModel/NDPlatform.h"
#include "PlatformModel/System/NDConcurrentQueue.h"
#include "Support/TestLog.h"
#include "Support/TestNotifications.h"
#include "Support/TestPreferences.h"

namespace nidus {

/// A platform that keeps the contract and no more: homes and answers come late, in no order, on
/// several threads or never, and homes change while a command looks at them. What has not come by
/// the shutdown is destroyed then. May be used from any thread.
class UnrulyPlatform final : public NDPlatform {
 public:
  /// What outlives one platform, because the plug-in opens log and notifications once.
  struct Services {
    std::shared_ptr<TestLog> log = std::make_shared<TestLog>();
    std::shared_ptr<TestNotifications> notifications = std::make_shared<TestNotifications>();
    std::shared_ptr<TestPreferences> preferences = std::make_shared<TestPreferences>();
  };
  struct Habits {
    std::uint64_t seed = 0;
    /// Whether waits for homes that do come may last; otherwise each is over at once, as if its
    /// time had passed.
    bool isPatient = true;
  };
  /// `lives` watches the managers; it outlives the platform.
  UnrulyPlatform(Services services, const Habits& habits, LifeWatch& lives);
  ~UnrulyPlatform() override;

  [[nodiscard]] std::shared_ptr<NDHomeManager> createHomeManager() override;
  [[nodiscard]] NDString homeConfigurationPath() override { return "/homes"; }
  [[nodiscard]] std::shared_ptr<NDNAPMetadata> metadata() override { return metadata_; }
  [[nodiscard]] std::shared_ptr<NDPreferences> preferences() override {
    return services_.preferences;
  }
  [[nodiscard]] std::shared_ptr<NDDeviceInformation> deviceInformation() override;
  [[nodiscard]] std::shared_ptr<NDLocale> locale() override;
  [[nodiscard]] std::shared_ptr<NDSystemLog> systemLog() override { return services_.log; }
  [[nodiscard]] std::shared_ptr<NDNotificationCenter> notificationCenter() override {
    return services_.notifications;
  }
  [[nodiscard]] std::shared_ptr<NDMainQueue> mainQueue() override { return mainQueue_; }
  [[nodiscard]] std::shared_ptr<NDQueue> sharedQueue() override { return sharedQueue_; }
  [[nodiscard]] std::shared_ptr<NDClock> clock() override;

  /// On which homes and accessories answer.
  [[nodiscard]] const std::shared_ptr<UnrulyQueue>& answers() const { return answers_; }
  /// What managers report that are made from now on, and what earlier ones may show all at once.
  void setHomes(NDArray<NDHome> homes);

  /// Runs the main queue until nothing moves any more but what will never come.
  void settle();
  /// Ends all work but that of the main queue, and tells managers that wait that they wait in vain.
  void shutDown();

 private:
  class Clock;
  struct Delivery;
  struct CurrentHomes;

  const Services services_;
  LifeWatch& lives_;
  const std::shared_ptr<NDNAPMetadata> metadata_;
  const std::shared_ptr<NDMainQueue> mainQueue_;
  const std::shared_ptr<NDConcurrentQueue> sharedQueue_;
  const std::shared_ptr<UnrulyQueue> answers_;
  const std::shared_ptr<Clock> clock_;
  const std::shared_ptr<CurrentHomes> current_;
};

}  // namespace nidus
