#pragma once

namespace nidus {

/// How the help of a command ends that does what it is told or fails; others tell more.
inline constexpr const char kExitStatuses[] =
    "\n\nExit status: 0 success, 2 bad input, 4 the platform failed.";

/// The same where a question may be answered with no.
inline constexpr const char kQuestionExitStatuses[] =
    "\n\nExit status: 0 success, 1 the answer was no, 2 bad input, 4 the platform failed.";

}  // namespace nidus
