#pragma once

#include <string>
#include <vector>

#include "HomePlatform/Result.h"

namespace nidus {

/// Runs a program, which is looked up in the absolute folders of PATH and gets no others, with the
/// standard streams of this process and waits for its end. Interrupts from the keyboard are for
/// that program meanwhile. Gives its exit status, or 128 and the number of the signal that ended
/// it; a failure, as the platform's, when it cannot be started. `command` is the program and its
/// arguments.
[[nodiscard]] Result<int> runInForeground(std::vector<std::string> command);

}  // namespace nidus
