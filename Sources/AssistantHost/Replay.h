#pragma once

#include <functional>
#include <string_view>

#include "AssistantHost/Scenario.h"
#include "HomePlatform/Result.h"
#include "PlatformModel/Assistant/NDAssistantModule.h"

namespace nidus {

/// Runs `scenario` through `module` on a home platform in memory, which is registered meanwhile and
/// does all its work on the calling thread, and hands the transcript to `write`: one line of JSON
/// with its line end for each step, as soon as the step is over. Stops with the failure of `write`,
/// or with that of the platform.
///
/// A step that breaks an assertion of the plug-in stops the process.
[[nodiscard]] Status replay(const Scenario& scenario, const NDAssistantModule& module,
                            const std::function<Status(std::string_view line)>& write);

}  // namespace nidus
