#pragma once

namespace nidus {

/// How the program ends. The greater one wins when several apply.
enum class ExitStatus {
  success = 0,
  otherOutcome = 1,  ///< The command was answered, but not with success.
  badInput = 2,      ///< What was given is wrong; nothing was changed.
  noReply = 3,       ///< The plug-in gave no reply.
  platformFailed = 4,
};

}  // namespace nidus
