#include "nidus/Session.h"

#include <utility>

#include "AssistantHost/AssistantModule.h"

namespace nidus {

Result<std::unique_ptr<Session>> Session::open(const Settings& settings) {
  auto options = platformOptionsOf(settings);
  if (!options) return options.failure();
  return open(std::move(*options));
}

Result<std::unique_ptr<Session>> Session::open(HomePlatformOptions options) {
  const auto module = openOwnModule();
  if (!module) return module.failure();
  auto platform = RegisteredPlatform::open(std::move(options));
  if (!platform) return platform.failure();
  return std::unique_ptr<Session>(new Session(**module, std::move(*platform)));
}

Session::Session(const NDAssistantModule& module, std::unique_ptr<RegisteredPlatform> platform)
    : module_(module),
      platform_(std::move(platform)),
      runner_(module_, platform_->platform()->mainQueue()) {}

Result<std::unique_ptr<RegisteredPlatform>> openPlatform(const Settings& settings) {
  auto options = platformOptionsOf(settings);
  if (!options) return options.failure();
  return RegisteredPlatform::open(std::move(*options));
}

Result<const NDAssistantModule*> openOwnModule() {
  const auto file = findAssistantModule();
  if (!file) return file.failure();
  return openAssistantModule(*file);
}

}  // namespace nidus
