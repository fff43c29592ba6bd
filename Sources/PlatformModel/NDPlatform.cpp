#include "PlatformModel/NDPlatform.h"

#include <utility>

#include "PlatformModel/System/NDMutex.h"

namespace nidus {
namespace {

/// The one registration of the process.
struct Registration {
  NDMutex mutex;
  std::shared_ptr<NDPlatform> platform ND_GUARDED_BY(mutex);
};

// Made when it is first asked for and never destroyed: threads of the platform may still ask while
// the process ends.
Registration& registration() {
  static auto& theRegistration = *new Registration;
  return theRegistration;
}

}  // namespace

NDPlatform::~NDPlatform() = default;

std::string NDPlatform::registerPlatform(std::shared_ptr<NDPlatform> platform) {
  if (!platform) return "there is no home-automation platform to register";
  Registration& current = registration();
  const NDLock lock(current.mutex);
  if (current.platform) return "a home-automation platform is registered already";
  current.platform = std::move(platform);
  return {};
}

void NDPlatform::unregisterPlatform(const std::shared_ptr<NDPlatform>& platform) {
  std::shared_ptr<NDPlatform> released;  // outlives the lock: its end may ask for the platform
  Registration& current = registration();
  const NDLock lock(current.mutex);
  if (current.platform == platform) released = std::exchange(current.platform, nullptr);
}

std::shared_ptr<NDPlatform> NDPlatform::registered() {
  Registration& current = registration();
  const NDLock lock(current.mutex);
  return current.platform;
}

}  // namespace nidus
