#pragma once

#include <functional>
#include <memory>

#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDQueue.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

/// The system's notification centre. Supplied by the platform; may be called from any thread.
class ND_EXPORT NDNotificationCenter {
 public:
  /// A registration; it ends when the last reference to its token is released.
  class ND_EXPORT Token {
   public:
    virtual ~Token();
  };

  virtual ~NDNotificationCenter();

  /// Queues `handler` on `queue` each time that the notification `name` is posted. The result is
  /// never null.
  [[nodiscard]] virtual std::shared_ptr<Token> registerForName_queue_handler(
      const NDString& name, std::shared_ptr<NDQueue> queue, std::function<void()> handler) = 0;
};

}  // namespace nidus
