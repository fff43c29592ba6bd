#include "AssistantHost/RegisteredPlatform.h"

#include <utility>

namespace nidus {

Result<std::unique_ptr<RegisteredPlatform>> RegisteredPlatform::open(HomePlatformOptions options) {
  const auto platform = HomePlatform::open(std::move(options));
  if (!platform) return platform.failure();
  if (auto refusal = NDPlatform::registerPlatform(*platform); !refusal.empty()) {
    (*platform)->shutDown();
    return Failure{Failure::Kind::platform, std::move(refusal)};
  }
  return std::unique_ptr<RegisteredPlatform>(new RegisteredPlatform(*platform));
}

RegisteredPlatform::RegisteredPlatform(std::shared_ptr<HomePlatform> platform)
    : platform_(std::move(platform)) {}

RegisteredPlatform::~RegisteredPlatform() {
  platform_->shutDown();
  NDPlatform::unregisterPlatform(platform_);
}

}  // namespace nidus
