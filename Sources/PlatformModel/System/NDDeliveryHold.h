#pragma once

#include <vector>

#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDQueue.h"

namespace nidus {

/// Keeps what is created on the calling thread from delivering before the code that created it has
/// had its chance to ask for the delivery.
///
/// A home manager must not report its homes between its creation and the request for them. Code
/// that creates one takes a hold on the stack; a platform hands the start of the delivery to
/// `whenReleased`. The start runs when the innermost hold of the thread ends, or when the thread
/// enters a wait of `NDWaitGroup`, whichever is first; without a hold it runs at once. Holds nest
/// and belong to the thread that made them.
///
///     NDDeliveryHold hold;
///     auto gather = NDAssistantGather::init();
///     gather->startWithCompletionHandler(handler);
class ND_EXPORT NDDeliveryHold {
 public:
  NDDeliveryHold() noexcept;
  /// Runs what was held back, in order, on the calling thread.
  ~NDDeliveryHold();
  NDDeliveryHold(const NDDeliveryHold&) = delete;
  NDDeliveryHold& operator=(const NDDeliveryHold&) = delete;

  /// Runs `start` on the calling thread: now, or when the innermost hold is released.
  static void whenReleased(NDTask start);

  /// Runs all that the holds of the calling thread keep back, the outermost hold's first. The holds
  /// stay in force for what is created later.
  static void releaseForWait();

 private:
  void release();
  void releaseWithOuter();

  NDDeliveryHold* outer_;
  std::vector<NDTask> held_;
};

}  // namespace nidus
