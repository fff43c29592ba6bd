#pragma once

#include <functional>

#include "PlatformModel/System/NDDeviceInformation.h"

namespace nidus {

/// What is known of this machine: whether it runs an internal build.
class DeviceInformation final : public NDDeviceInformation {
 public:
  /// `internalBuild` gives the answer to "InternalBuild", which may be null; never empty.
  explicit DeviceInformation(std::function<NDValueRef()> internalBuild)
      : internalBuild_(std::move(internalBuild)) {}

  [[nodiscard]] NDValueRef answerForQuery(const NDString& query) override {
    return query == kInternalBuild ? internalBuild_() : nullptr;
  }

  static constexpr const char* kInternalBuild = "InternalBuild";

 private:
  const std::function<NDValueRef()> internalBuild_;
};

}  // namespace nidus
