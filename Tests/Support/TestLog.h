#pragma once

#include <atomic>
#include <cstdint>
#include <map>
#include <memory>
#include <string>
#include <vector>

#include "PlatformModel/System/NDMutex.h"
#include "PlatformModel/System/NDSystemLog.h"

namespace nidus {

/// A system log that keeps what is sent to it and how it is used. May be used from any thread.
class TestLog final : public NDSystemLog {
 public:
  using Fields = std::map<std::string, std::string>;
  /// One call of `openClient`.
  struct Opening {
    NDString identity;
    NDString facility;
    std::uint32_t options = 0;
  };

  TestLog();
  ~TestLog() override;

  [[nodiscard]] std::shared_ptr<NDSystemLogClient> openClient(const NDString& identity,
                                                              const NDString& facility,
                                                              std::uint32_t options) override;
  [[nodiscard]] std::unique_ptr<NDSystemLogMessage> createMessage() override;

  /// From now on there is no memory for messages.
  void refuseMessages() { refusesMessages_ = true; }
  /// Whether opening a client and making a message throw for want of memory.
  void exhaustMemory(bool isExhausted) { isExhausted_ = isExhausted; }

  [[nodiscard]] std::vector<Opening> openings() const;
  /// The filter masks in the order in which they were set.
  [[nodiscard]] std::vector<std::uint32_t> filterMasks() const;
  /// The messages sent so far.
  [[nodiscard]] std::vector<Fields> messages() const;
  /// The same, each on one line: its level, a blank and its text.
  [[nodiscard]] std::vector<std::string> lines() const;
  void clearMessages();

 private:
  class Client;

  const std::shared_ptr<Client> client_;
  std::atomic<bool> refusesMessages_ = false;
  std::atomic<bool> isExhausted_ = false;
  mutable NDMutex mutex_;
  std::vector<Opening> openings_ ND_GUARDED_BY(mutex_);
};

}  // namespace nidus
