#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "PlatformModel/NDPlatform.h"
#include "Support/TestHome.h"
#include "Support/TestHomeManager.h"
#include "Support/TestLog.h"
#include "Support/TestNotifications.h"
#include "Support/TestPreferences.h"

namespace nidus {

/// The platform of unit tests: homes in memory, queues that the test drains, waits that end without
/// time passing, and a log that is kept. One object serves all tests of a process, because the
/// plug-in opens the log once.
class TestPlatform final : public NDPlatform {
 public:
  /// The one object, never null.
  [[nodiscard]] static const std::shared_ptr<TestPlatform>& shared();

  TestPlatform();
  ~TestPlatform() override;

  [[nodiscard]] std::shared_ptr<NDHomeManager> createHomeManager() override;
  [[nodiscard]] NDString homeConfigurationPath() override { return "/homes"; }
  [[nodiscard]] std::shared_ptr<NDNAPMetadata> metadata() override { return metadata_; }
  [[nodiscard]] std::shared_ptr<NDPreferences> preferences() override { return preferences_; }
  [[nodiscard]] std::shared_ptr<NDDeviceInformation> deviceInformation() override;
  [[nodiscard]] std::shared_ptr<NDLocale> locale() override;
  [[nodiscard]] std::shared_ptr<NDSystemLog> systemLog() override { return log_; }
  [[nodiscard]] std::shared_ptr<NDNotificationCenter> notificationCenter() override {
    return notifications_;
  }
  [[nodiscard]] std::shared_ptr<NDMainQueue> mainQueue() override { return mainQueue_; }
  [[nodiscard]] std::shared_ptr<NDQueue> sharedQueue() override { return sharedQueue_; }
  [[nodiscard]] std::shared_ptr<NDClock> clock() override { return clock_; }

  [[nodiscard]] TestPreferences& testPreferences() { return *preferences_; }
  [[nodiscard]] TestLog& testLog() { return *log_; }
  [[nodiscard]] TestNotifications& testNotifications() { return *notifications_; }

  /// What managers that are created from now on report.
  void setHomes(const std::vector<std::shared_ptr<TestHome>>& homes);
  /// Whether they report by themselves.
  void setSilent(bool isSilent) { isSilent_ = isSilent; }
  /// How they do so: through the shared queue (unless said otherwise), on the creating thread as
  /// soon as they may, or before they may, as no platform should.
  enum class Reporting { queued, prompt, early };
  void setReporting(Reporting reporting) { reporting_ = reporting; }
  /// The manager created last; null when it is gone.
  [[nodiscard]] std::shared_ptr<TestHomeManager> lastManager() const { return lastManager_.lock(); }

  /// Whether homes are configured; none removes the key.
  void configureHomes(std::optional<bool> areConfigured);
  void setLocale(std::optional<bool> isMetric);
  /// What the device says to "InternalBuild".
  void setInternalBuild(NDValueRef answer);
  [[nodiscard]] std::size_t deviceQueries() const;
  /// Sets the preference and lets the plug-in know.
  void setLogLevel(int level);
  /// Runs all work on the calling thread.
  void runUntilIdle();
  /// The messages sent so far, each behind its level.
  [[nodiscard]] std::vector<std::string> log() const { return log_->lines(); }
  void clearLog() { log_->clearMessages(); }

 private:
  class DeviceInformation;
  class Locale;

  const std::shared_ptr<NDNAPMetadata> metadata_;
  const std::shared_ptr<NDMainQueue> mainQueue_;
  const std::shared_ptr<NDMainQueue> sharedQueue_;
  const std::shared_ptr<NDClock> clock_;
  const std::shared_ptr<TestLog> log_;
  const std::shared_ptr<TestNotifications> notifications_;
  const std::shared_ptr<TestPreferences> preferences_;
  const std::shared_ptr<DeviceInformation> deviceInformation_;
  const std::shared_ptr<Locale> locale_;
  NDArray<NDHome> homes_;
  std::weak_ptr<TestHomeManager> lastManager_;
  bool isSilent_ = false;
  Reporting reporting_ = Reporting::queued;
};

}  // namespace nidus
