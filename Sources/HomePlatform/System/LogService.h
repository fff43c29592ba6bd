#pragma once

#include <functional>
#include <memory>

#include "HomePlatform/System/LogOutput.h"
#include "PlatformModel/System/NDSystemLog.h"

namespace nidus {

/// The log service of one platform: its clients pass on what their filters let through. May be used
/// from any thread; so may its clients, which outlive it.
class LogService final : public NDSystemLog {
 public:
  using Sink = std::function<void(const NDSystemLogMessage&)>;

  /// `sink` takes each message that passes, on the thread that sends it; never empty.
  explicit LogService(Sink sink) : sink_(std::make_shared<const Sink>(std::move(sink))) {}

  [[nodiscard]] std::shared_ptr<NDSystemLogClient> openClient(const NDString& identity,
                                                              const NDString& facility,
                                                              std::uint32_t options) override;
  [[nodiscard]] std::unique_ptr<NDSystemLogMessage> createMessage() override;

 private:
  const std::shared_ptr<const Sink> sink_;
};

/// The sink that writes to standard error and, where the machine has one, to its system log.
[[nodiscard]] LogService::Sink makeMachineLogSink();

}  // namespace nidus
