#pragma once

#include <string_view>

#include "PlatformModel/Assistant/VAHACommand.h"

namespace nidus {

/// A command to the lights of that name, or to all of them with a null name: an action on their
/// brightness.
struct BrightnessRequest : VAHACommand {
  BrightnessRequest(std::string_view actionType, const NDString& serviceName);
};

/// Runs a scene.
struct SceneRequest : VAHACommand {
  explicit SceneRequest(const NDString& sceneName);
};

}  // namespace nidus
