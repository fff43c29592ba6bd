#pragma once

#include <memory>

#include "HomePlatform/HomePlatform.h"
#include "HomePlatform/Result.h"

namespace nidus {

/// Keeps a home platform open and registered; shuts it down when it is destroyed.
///
///     const auto registered = RegisteredPlatform::open({.dataFolder = folder});
///     if (!registered) return report(registered.failure());
///     (*registered)->platform()->exportHomes();
class RegisteredPlatform {
 public:
  /// Opens a platform and registers it. Fails when it can not be opened or when another platform is
  /// registered.
  [[nodiscard]] static Result<std::unique_ptr<RegisteredPlatform>> open(
      HomePlatformOptions options);
  ~RegisteredPlatform();
  RegisteredPlatform(const RegisteredPlatform&) = delete;
  RegisteredPlatform& operator=(const RegisteredPlatform&) = delete;

  /// Never null.
  [[nodiscard]] const std::shared_ptr<HomePlatform>& platform() const noexcept { return platform_; }

 private:
  explicit RegisteredPlatform(std::shared_ptr<HomePlatform> platform);

  const std::shared_ptr<HomePlatform> platform_;
};

}  // namespace nidus
