#include "PlatformModel/Home/NDHomeManager.h"

#include "PlatformModel/NDPlatform.h"

namespace nidus {

NDHomeManagerDelegate::~NDHomeManagerDelegate() = default;

NDHomeManager::~NDHomeManager() = default;

std::shared_ptr<NDHomeManager> NDHomeManager::create() {
  const auto platform = NDPlatform::registered();
  return platform ? platform->createHomeManager() : nullptr;
}

NDString getHomeConfigurationPath() {
  const auto platform = NDPlatform::registered();
  return platform ? platform->homeConfigurationPath() : NDString();
}

}  // namespace nidus
