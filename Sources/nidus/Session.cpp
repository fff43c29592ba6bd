#include "nidus/Session.h"

#include <functional>
#include <utility>

#include "AssistantHost/AssistantModule.h"
#include "nidus/StandardStreams.h"

namespace nidus {

Result<std::unique_ptr<Session>> Session::open(HomePlatformOptions options) {
  const auto hasFailed = std::make_shared<std::atomic<bool>>(false);
  options.failureHandler = [hasFailed](const Failure& failure) {
    report(failure);
    hasFailed->store(true);
  };
  const bool drainsOnCaller = options.drainsOnCaller;
  auto platform = RegisteredPlatform::open(std::move(options));
  if (!platform) return platform.failure();
  return std::unique_ptr<Session>(new Session(std::move(*platform), hasFailed, drainsOnCaller));
}

Session::Session(std::unique_ptr<RegisteredPlatform> platform, FailureMark hasFailed,
                 bool drainsOnCaller)
    : hasFailed_(std::move(hasFailed)),
      platform_(std::move(platform)),
      drainsOnCaller_(drainsOnCaller) {}

Status Session::openModule() {
  if (module_) return std::nullopt;
  const auto module = openOwnModule();
  if (!module) return module.failure();
  module_ = *module;
  std::function<void()> drain;
  if (drainsOnCaller_) drain = [this] { platform().drain(); };
  runner_.emplace(*module_, platform().mainQueue(), std::move(drain));
  return std::nullopt;
}

ExitStatus Session::statusAfter(ExitStatus status) const {
  return hasFailed_->load() ? ExitStatus::platformFailed : status;
}

Result<const NDAssistantModule*> openOwnModule() {
  const auto file = findAssistantModule();
  if (!file) return file.failure();
  return openAssistantModule(*file);
}

}  // namespace nidus
