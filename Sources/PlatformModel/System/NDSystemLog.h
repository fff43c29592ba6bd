#pragma once

#include <cstdint>
#include <map>
#include <memory>
#include <string>
#include <string_view>

#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

/// A message on its way to the system log: text fields by key. Not synchronised.
class ND_EXPORT NDSystemLogMessage {
 public:
  void set(std::string_view key, std::string_view value) {
    fields_.insert_or_assign(std::string(key), std::string(value));
  }
  [[nodiscard]] const std::map<std::string, std::string>& fields() const noexcept {
    return fields_;
  }

 private:
  std::map<std::string, std::string> fields_;
};

/// A connection to the system log. May be used from any thread.
class ND_EXPORT NDSystemLogClient {
 public:
  virtual ~NDSystemLogClient();
  /// Passes `message` on, unless the filter holds back the severity in its "Level" field.
  virtual void send(const NDSystemLogMessage& message) = 0;
  /// Sets which severities pass: bit n lets severity n pass. Every severity passes before the first
  /// call.
  virtual void setFilterMask(std::uint32_t mask) = 0;
};

/// The system log service. Supplied by the platform; may be called from any thread.
class ND_EXPORT NDSystemLog {
 public:
  virtual ~NDSystemLog();
  /// Opens a connection; `identity` may be null. The result is never null and may outlive the
  /// service.
  [[nodiscard]] virtual std::shared_ptr<NDSystemLogClient> openClient(const NDString& identity,
                                                                      const NDString& facility,
                                                                      std::uint32_t options) = 0;
  /// Makes an empty message of the ordinary type; null when there is no memory for one.
  [[nodiscard]] virtual std::unique_ptr<NDSystemLogMessage> createMessage() = 0;
};

}  // namespace nidus
