#include "HomePlatform/System/LogService.h"

#include <atomic>
#include <new>
#include <optional>
#include <utility>

#include "PlatformModel/System/NDRunOnce.h"

namespace nidus {
namespace {

constexpr std::uint32_t kEverything = ~std::uint32_t{0};

/// The bit of a message's severity; none when its level is not a severity, which no filter knows.
std::optional<std::uint32_t> severityBit(const NDSystemLogMessage& message) {
  const std::string& level = logField(message, "Level");
  if (level.size() != 1 || level[0] < '0' || level[0] > '7') return std::nullopt;
  return std::uint32_t{1} << static_cast<unsigned>(level[0] - '0');
}

class LogClient final : public NDSystemLogClient {
 public:
  explicit LogClient(std::shared_ptr<const LogService::Sink> sink) : sink_(std::move(sink)) {}

  void send(const NDSystemLogMessage& message) override {
    const auto bit = severityBit(message);
    if (bit && (mask_.load() & *bit) == 0) return;
    (*sink_)(message);
  }

  void setFilterMask(std::uint32_t mask) override { mask_.store(mask); }

 private:
  const std::shared_ptr<const LogService::Sink> sink_;
  std::atomic<std::uint32_t> mask_{kEverything};
};

/// The outputs of the machine, opened when the first message comes.
class MachineLog {
 public:
  void write(const NDSystemLogMessage& message) {
    opened_.run([this] { systemLog_ = makeSystemLog(kJournalSocket); });
    standardError_->write(message);
    if (systemLog_) systemLog_->write(message);
  }

 private:
  NDRunOnce opened_;
  const std::unique_ptr<LogOutput> standardError_ = makeStandardErrorLog();
  std::unique_ptr<LogOutput> systemLog_;
};

}  // namespace

std::shared_ptr<NDSystemLogClient> LogService::openClient(const NDString& /*identity*/,
                                                          const NDString& /*facility*/,
                                                          std::uint32_t /*options*/) {
  return std::make_shared<LogClient>(sink_);
}

std::unique_ptr<NDSystemLogMessage> LogService::createMessage() {
  return std::unique_ptr<NDSystemLogMessage>(new (std::nothrow) NDSystemLogMessage());
}

LogService::Sink makeMachineLogSink() {
  return [log = std::make_shared<MachineLog>()](const NDSystemLogMessage& message) {
    log->write(message);
  };
}

}  // namespace nidus
