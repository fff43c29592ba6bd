#include "PlatformModel/System/NDMainQueue.h"

#include <utility>

#include "PlatformModel/System/NDDeliveryHold.h"

namespace nidus {

NDMainQueue::~NDMainQueue() {
  NDTask dropped;
  while (take(dropped)) dropped = nullptr;
}

void NDMainQueue::async(NDTask task) {
  std::function<void()> wakeHandler;
  {
    const NDLock lock(mutex_);
    if (tasks_.empty()) wakeHandler = wakeHandler_;
    tasks_.push_back(std::move(task));
    changed_.notify_all();
  }
  if (wakeHandler) wakeHandler();
}

bool NDMainQueue::runOne() {
  NDTask task;
  if (!take(task)) return false;
  task();
  return true;
}

std::size_t NDMainQueue::drain() {
  std::size_t ran = 0;
  while (runOne()) ++ran;
  return ran;
}

void NDMainQueue::runUntil(const std::function<bool()>& isDone) {
  for (;;) {
    const std::size_t wakesSeen = wakes();
    if (isDone()) return;
    if (runOne()) continue;
    NDDeliveryHold::releaseForWait();
    waitForWorkOrWake(wakesSeen);
  }
}

void NDMainQueue::wake() {
  const NDLock lock(mutex_);
  ++wakes_;
  changed_.notify_all();
}

void NDMainQueue::setWakeHandler(std::function<void()> handler) {
  std::function<void()> wakeNow;
  {
    const NDLock lock(mutex_);
    if (!tasks_.empty()) wakeNow = handler;
    wakeHandler_.swap(handler);
  }
  // The earlier handler is destroyed by the caller's return, without the lock.
  if (wakeNow) wakeNow();
}

bool NDMainQueue::take(NDTask& task) {
  const NDLock lock(mutex_);
  if (tasks_.empty()) return false;
  task = std::move(tasks_.front());
  tasks_.pop_front();
  return true;
}

std::size_t NDMainQueue::wakes() {
  const NDLock lock(mutex_);
  return wakes_;
}

void NDMainQueue::waitForWorkOrWake(std::size_t wakesSeen) {
  NDLock lock(mutex_);
  while (tasks_.empty() && wakes_ == wakesSeen) changed_.wait(lock.native());
}

}  // namespace nidus
