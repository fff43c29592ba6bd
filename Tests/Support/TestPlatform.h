#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "PlatformModel/NDPlatform.h"
#include "Support/TestHome.h"

namespace nidus {

/// The platform of unit tests: homes in memory, queues that the test drains, and a log
/// that is kept. One object serves all tests of a process, because the plug-in opens the log once.
class TestPlatform final : public NDPlatform {
 public:
  /// The one object, never null.
  [[nodiscard]] static const std::shared_ptr<TestPlatform>& shared();

  TestPlatform();
  ~TestPlatform() override;

  [[nodiscard]] std::shared_ptr<NDHomeManager> createHomeManager() override;
  [[nodiscard]] NDString homeConfigurationPath() override { return "/homes"; }
  [[nodiscard]] std::shared_ptr<NDNAPMetadata> metadata() override { return metadata_; }
  [[nodiscard]] std::shared_ptr<NDPreferences> preferences() override;
  [[nodiscard]] std::shared_ptr<NDDeviceInformation> deviceInformation() override;
  [[nodiscard]] std::shared_ptr<NDLocale> locale() override;
  [[nodiscard]] std::shared_ptr<NDSystemLog> systemLog() override;
  [[nodiscard]] std::shared_ptr<NDNotificationCenter> notificationCenter() override;
  [[nodiscard]] std::shared_ptr<NDMainQueue> mainQueue() override { return mainQueue_; }
  [[nodiscard]] std::shared_ptr<NDQueue> sharedQueue() override { return sharedQueue_; }
  [[nodiscard]] std::shared_ptr<NDClock> clock() override { return clock_; }

  /// What managers that are created from now on report.
  void setHomes(std::vector<std::shared_ptr<TestHome>> homes);
  /// Whether they report at all.
  void setSilent(bool isSilent) { isSilent_ = isSilent; }
  void configureHomes(bool areConfigured);
  void setLocale(std::optional<bool> isMetric);
  /// Sets the preference and lets the plug-in know.
  void setLogLevel(int level);
  /// Runs all work on the calling thread.
  void runUntilIdle();
  /// The messages sent so far, each behind its level.
  [[nodiscard]] std::vector<std::string> log() const;
  void clearLog();

 private:
  class Log;
  class LogClient;
  class Manager;
  class Notifications;
  class Preferences;
  class Locale;

  const std::shared_ptr<NDNAPMetadata> metadata_;
  const std::shared_ptr<NDClock> clock_;
  const std::shared_ptr<NDMainQueue> mainQueue_;
  const std::shared_ptr<NDMainQueue> sharedQueue_;
  const std::shared_ptr<LogClient> logClient_;
  const std::shared_ptr<Notifications> notifications_;
  const std::shared_ptr<Preferences> preferences_;
  const std::shared_ptr<Locale> locale_;
  NDArray<NDHome> homes_;
  bool isSilent_ = false;
};

}  // namespace nidus
