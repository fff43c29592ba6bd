#pragma once

#include <string>

#include "PlatformModel/Assistant/VAHACommand.h"

namespace nidus {

/// A command as JSON, as a person would write it: what is null is left out.
[[nodiscard]] std::string commandText(const VAHACommand& command);

/// Checks that a command that was read is the same after it is written and read again, and that it
/// can be described. A finding ends the process.
void checkCommandSurvives(const VAHACommand& command);

}  // namespace nidus
