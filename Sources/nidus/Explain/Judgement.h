#pragma once

#include <string>

#include "PlatformModel/Assistant/VAHACommand.h"
#include "nidus/Explain/Rehearsal.h"

namespace nidus {

/// Tells people by what each reply to `command` and its results would be judged, a line each, with
/// what the plug-in logs as a warning or worse.
[[nodiscard]] std::string judgementText(const VAHACommand& command, const Rehearsal& rehearsal);

}  // namespace nidus
