#pragma once

#include <vector>

#include "PlatformModel/System/NDDictionary.h"
#include "nidus/ExitStatus.h"

namespace nidus {

/// The exit status of a command with these replies: that of the least successful of them, or
/// `noReply` when there is none.
[[nodiscard]] ExitStatus statusOf(const std::vector<NDDictionary>& replies);

}  // namespace nidus
