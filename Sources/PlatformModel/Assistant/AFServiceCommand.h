#pragma once

#include "PlatformModel/Assistant/VAHACommand.h"
#include "PlatformModel/System/NDExport.h"

namespace nidus {

/// A command that the assistant can perform.
class ND_EXPORT AFServiceCommand {
 public:
  virtual ~AFServiceCommand();
  /// Performs the command, once. Returns at once; the replies come through `handler`, which may be
  /// empty (see `VAHAReplyHandler` for threads). Whoever has let go of the command may still hear
  /// from it; when the handler has been destroyed no reply will come any more.
  virtual void performWithCompletion(VAHAReplyHandler handler) = 0;
};

}  // namespace nidus
