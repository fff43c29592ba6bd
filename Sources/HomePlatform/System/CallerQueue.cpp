#include "HomePlatform/System/CallerQueue.h"

#include <utility>

namespace nidus {

void CallerQueue::async(NDTask task) {
  const NDLock lock(mutex_);
  if (!isShutDown_) tasks_.push_back(std::move(task));
}

bool CallerQueue::runOne() {
  const NDTask task = take();
  if (!task) return false;
  task();
  return true;
}

void CallerQueue::shutDown() {
  std::deque<NDTask> dropped;
  const NDLock lock(mutex_);
  isShutDown_ = true;
  dropped.swap(tasks_);
  // The lock ends before the dropped work is destroyed.
}

NDTask CallerQueue::take() {
  const NDLock lock(mutex_);
  if (tasks_.empty()) return {};
  NDTask task = std::move(tasks_.front());
  tasks_.pop_front();
  return task;
}

}  // namespace nidus
