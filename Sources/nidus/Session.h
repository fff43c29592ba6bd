#pragma once

#include <atomic>
#include <memory>

#include "AssistantHost/CommandRunner.h"
#include "AssistantHost/RegisteredPlatform.h"
#include "HomePlatform/Result.h"
#include "PlatformModel/Assistant/NDAssistantModule.h"
#include "nidus/ExitStatus.h"
#include "nidus/Settings.h"

namespace nidus {

/// What a command that goes through the plug-in works with: the module, a registered platform, and
/// a runner between them. Ends with the platform's shutdown. Failures of the platform while it
/// works are reported on standard error.
class Session {
 public:
  [[nodiscard]] static Result<std::unique_ptr<Session>> open(const Settings& settings);
  [[nodiscard]] static Result<std::unique_ptr<Session>> open(HomePlatformOptions options);

  [[nodiscard]] const NDAssistantModule& module() const noexcept { return module_; }
  [[nodiscard]] HomePlatform& platform() const noexcept { return *platform_->platform(); }
  [[nodiscard]] CommandRunner& runner() noexcept { return runner_; }
  /// `status`, or that of a failed platform once the platform has reported a failure: what it
  /// answers then may not be so.
  [[nodiscard]] ExitStatus statusAfter(ExitStatus status) const;

 private:
  using FailureMark = std::shared_ptr<std::atomic<bool>>;
  Session(const NDAssistantModule& module, std::unique_ptr<RegisteredPlatform> platform,
          FailureMark hasFailed);

  const FailureMark hasFailed_;
  const NDAssistantModule& module_;
  const std::unique_ptr<RegisteredPlatform> platform_;
  CommandRunner runner_;
};

/// Opens the platform that `settings` ask for, without the module; never null.
[[nodiscard]] Result<std::unique_ptr<RegisteredPlatform>> openPlatform(const Settings& settings);

/// Opens the module that belongs to this program; never null.
[[nodiscard]] Result<const NDAssistantModule*> openOwnModule();

}  // namespace nidus
