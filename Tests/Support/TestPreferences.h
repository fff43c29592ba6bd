#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <string>

#include "PlatformModel/System/NDMutex.h"
#include "PlatformModel/System/NDPreferences.h"

namespace nidus {

/// Preferences in memory that count how often they are used. May be used from any thread.
class TestPreferences final : public NDPreferences {
 public:
  [[nodiscard]] BooleanReading booleanForKey_domain_container(
      const NDString& key, const NDString& domain, const NDString& containerPath) override {
    const NDLock lock(mutex_);
    ++uses_;
    const bool isKnown =
        key == "kHomesConfigured" && domain == "com.corvane.nidusd" && containerPath == "/homes";
    if (!isKnown || !areHomesConfigured_) return {};
    return {*areHomesConfigured_, true};
  }
  void synchronize() override {
    const NDLock lock(mutex_);
    ++uses_;
    ++synchronizations_;
    integers_ = stored_;
  }
  [[nodiscard]] std::int64_t integerForKey(const NDString& key) override {
    const NDLock lock(mutex_);
    ++uses_;
    const auto found = integers_.find(key.str());
    return found == integers_.end() ? 0 : found->second;
  }

  /// Whether homes are configured; none removes the key.
  void configureHomes(std::optional<bool> areConfigured) {
    const NDLock lock(mutex_);
    areHomesConfigured_ = areConfigured;
  }
  /// Sets an integer of the standard preferences, as another process does: it is seen after the
  /// next `synchronize`.
  void setInteger(const std::string& key, std::int64_t value) {
    const NDLock lock(mutex_);
    stored_[key] = value;
  }
  /// How often anything was asked of the preferences.
  [[nodiscard]] std::size_t uses() const {
    const NDLock lock(mutex_);
    return uses_;
  }
  [[nodiscard]] std::size_t synchronizations() const {
    const NDLock lock(mutex_);
    return synchronizations_;
  }

 private:
  mutable NDMutex mutex_;
  std::optional<bool> areHomesConfigured_ ND_GUARDED_BY(mutex_) = true;
  std::map<std::string, std::int64_t> stored_ ND_GUARDED_BY(mutex_);
  std::map<std::string, std::int64_t> integers_ ND_GUARDED_BY(mutex_);
  std::size_t uses_ ND_GUARDED_BY(mutex_) = 0;
  std::size_t synchronizations_ ND_GUARDED_BY(mutex_) = 0;
};

}  // namespace nidus
