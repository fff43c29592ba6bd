#pragma once

#include <functional>
#include <memory>

#include "PlatformModel/System/NDExport.h"

namespace nidus {

/// A piece of work; never empty when it is queued. It must not throw.
using NDTask = std::function<void()>;

/// Something that runs pieces of work, each exactly once or, after a shutdown, never; work that
/// will not run is destroyed. May be called from any thread. Never runs work inside `async`.
class ND_EXPORT NDQueue {
 public:
  virtual ~NDQueue();
  /// Adds `task` and returns at once.
  virtual void async(NDTask task) = 0;
};

}  // namespace nidus
