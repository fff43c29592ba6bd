#pragma once

#include <atomic>
#include <memory>
#include <optional>

#include "AssistantHost/CommandRunner.h"
#include "AssistantHost/RegisteredPlatform.h"
#include "HomePlatform/Result.h"
#include "PlatformModel/Assistant/NDAssistantModule.h"
#include "nidus/ExitStatus.h"

namespace nidus {

/// A registered platform and, for commands that go through the plug-in, its module with a runner
/// between the two. Ends with the platform's shutdown. Failures of the platform while it works are
/// reported on standard error.
class Session {
 public:
  /// Opens the platform; the module is left alone. Never null.
  [[nodiscard]] static Result<std::unique_ptr<Session>> open(HomePlatformOptions options);

  [[nodiscard]] HomePlatform& platform() const noexcept { return *platform_->platform(); }
  /// Opens the module that belongs to this program; does nothing when it is open.
  [[nodiscard]] Status openModule();
  /// Once the module is open.
  [[nodiscard]] const NDAssistantModule& module() const noexcept { return *module_; }
  [[nodiscard]] CommandRunner& runner() noexcept { return *runner_; }
  /// `status`, or that of a failed platform once the platform has reported a failure: what it
  /// answers then may not be so.
  [[nodiscard]] ExitStatus statusAfter(ExitStatus status) const;

 private:
  using FailureMark = std::shared_ptr<std::atomic<bool>>;
  Session(std::unique_ptr<RegisteredPlatform> platform, FailureMark hasFailed, bool drainsOnCaller);

  const FailureMark hasFailed_;
  const std::unique_ptr<RegisteredPlatform> platform_;
  const bool drainsOnCaller_;
  const NDAssistantModule* module_ = nullptr;
  std::optional<CommandRunner> runner_;
};

/// Opens the module that belongs to this program; never null.
[[nodiscard]] Result<const NDAssistantModule*> openOwnModule();

}  // namespace nidus
