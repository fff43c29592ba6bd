#pragma once

#include <string>

#include "PlatformModel/Assistant/VAHACommand.h"
#include "nidus/Explain/HomeIndex.h"
#include "nidus/Explain/Rehearsal.h"
#include "nidus/HomeWords.h"
#include "nidus/Terminal/Terminal.h"

namespace nidus {

/// Tells people what the action of a rehearsed command reaches, what it would read, write or run,
/// and which values would be others afterwards. `before` are the homes as they were copied.
[[nodiscard]] std::string actionText(const Rehearsal& rehearsal, const HomeIndex& before,
                                     const HomeWords& words, const TerminalStyle& style);

}  // namespace nidus
