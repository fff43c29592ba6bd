#include "nidus/Session.h"

#include <utility>

#include "AssistantHost/AssistantModule.h"
#include "nidus/StandardStreams.h"

namespace nidus {

Result<std::unique_ptr<Session>> Session::open(const Settings& settings) {
  auto options = platformOptionsOf(settings);
  if (!options) return options.failure();
  return open(std::move(*options));
}

Result<std::unique_ptr<Session>> Session::open(HomePlatformOptions options) {
  const auto module = openOwnModule();
  if (!module) return module.failure();
  const auto hasFailed = std::make_shared<std::atomic<bool>>(false);
  options.failureHandler = [hasFailed](const Failure& failure) {
    report(failure);
    hasFailed->store(true);
  };
  auto platform = RegisteredPlatform::open(std::move(options));
  if (!platform) return platform.failure();
  return std::unique_ptr<Session>(new Session(**module, std::move(*platform), hasFailed));
}

Session::Session(const NDAssistantModule& module, std::unique_ptr<RegisteredPlatform> platform,
                 FailureMark hasFailed)
    : hasFailed_(std::move(hasFailed)),
      module_(module),
      platform_(std::move(platform)),
      runner_(module_, platform_->platform()->mainQueue()) {}

ExitStatus Session::statusAfter(ExitStatus status) const {
  return hasFailed_->load() ? ExitStatus::platformFailed : status;
}

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
