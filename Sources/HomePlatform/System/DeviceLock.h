#pragma once

#include <atomic>

namespace nidus {

/// Whether the device is locked. May be used from any thread.
class DeviceLock {
 public:
  explicit DeviceLock(bool isLocked) : isLocked_(isLocked) {}
  [[nodiscard]] bool isLocked() const noexcept { return isLocked_.load(); }
  void setLocked(bool isLocked) noexcept { isLocked_.store(isLocked); }

 private:
  std::atomic<bool> isLocked_;
};

}  // namespace nidus
