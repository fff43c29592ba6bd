#pragma once

#include <string>

#include "HomePlatform/HomePlatform.h"
#include "PlatformModel/Assistant/VAHACommand.h"
#include "nidus/Explain/Rehearsal.h"
#include "nidus/Terminal/Terminal.h"

namespace nidus {

/// Tells people what the filter of `command` kept after each of its steps, and, where nothing was
/// left, what the last step dropped and which names there are. `platform` is that of the rehearsal.
[[nodiscard]] std::string filterText(const VAHACommand& command, const Rehearsal& rehearsal,
                                     HomePlatform& platform, const TerminalStyle& style);

}  // namespace nidus
