#pragma once

#include <memory>
#include <string>

#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDQueue.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

/// A queue that runs its work strictly in order, one piece at a time, on the threads of another
/// queue. It owns no thread. Destroying it does not cancel work that was added.
class ND_EXPORT NDSerialQueue final : public NDQueue {
 public:
  /// `label` names the queue for people; `target` is the queue whose threads are used, never null.
  NDSerialQueue(NDString label, std::shared_ptr<NDQueue> target);
  ~NDSerialQueue() override;

  [[nodiscard]] const NDString& label() const noexcept { return label_; }
  void async(NDTask task) override;

 private:
  struct State;
  NDString label_;
  std::shared_ptr<State> state_;
};

}  // namespace nidus
