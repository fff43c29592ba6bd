#pragma once

#include "PlatformModel/System/NDQueue.h"

namespace nidus {

/// Runs each task at once, on the thread that brings it.
class InlineQueue final : public NDQueue {
 public:
  void async(NDTask task) override { task(); }
};

}  // namespace nidus
