#pragma once

#include <functional>
#include <memory>

#include "HomePlatform/Result.h"
#include "PlatformModel/System/NDMainQueue.h"

namespace nidus {

/// Runs the work of `queue` on this thread, which sleeps in between, until `isDone` is true after a
/// piece of work, the process is told to end (SIGINT or SIGTERM), or nobody reads standard output
/// any more. A failure says why that cannot be waited for.
[[nodiscard]] Status runUntilInterrupted(NDMainQueue& queue, const std::function<bool()>& isDone);

/// Whether somebody may still read standard output: false for a pipe whose other end is closed.
[[nodiscard]] bool hasReader();

}  // namespace nidus
