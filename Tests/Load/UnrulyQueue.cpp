#include "Load/UnrulyQueue.h"

#include <utility>

#include "Load/Ledger.h"

namespace nidus {

UnrulyQueue::UnrulyQueue(const Habits& habits)
    : parksOneIn_(habits.parksOneIn), random_(habits.seed) {
  threads_.reserve(habits.threads);
  for (std::size_t i = 0; i < habits.threads; ++i) threads_.emplace_back([this] { work(); });
}

UnrulyQueue::~UnrulyQueue() { shutDown(); }

void UnrulyQueue::async(NDTask task) {
  const auto& ledger = Ledger::current();
  const NDLock lock(mutex_);
  if (isShutDown_) return;
  if (random_.oneIn(parksOneIn_)) {
    if (ledger) ledger->parked();
    parked_.push_back(std::move(task));
    return;
  }
  waiting_.push_back(std::move(task));
  workAdded_.notify_one();
}

void UnrulyQueue::waitUntilFewer(std::size_t count) {
  NDLock lock(mutex_);
  while (waiting_.size() > count) workDone_.wait(lock.native());
}

void UnrulyQueue::waitUntilIdle() {
  NDLock lock(mutex_);
  while (running_ > 0 || !waiting_.empty()) workDone_.wait(lock.native());
}

void UnrulyQueue::shutDown() {
  std::vector<NDTask> waiting;
  std::vector<NDTask> parked;
  {
    const NDLock lock(mutex_);
    isShutDown_ = true;
    waiting.swap(waiting_);
    parked.swap(parked_);
    workAdded_.notify_all();
    workDone_.notify_all();
  }
  for (std::thread& thread : std::exchange(threads_, {})) thread.join();
}

void UnrulyQueue::work() {
  NDTask task;
  while (takeAny(task)) {
    task();
    task = nullptr;  // what it holds is released before the queue may count as idle
    finish();
  }
}

/// Takes any piece of work, as soon as there is one; false after the shutdown.
bool UnrulyQueue::takeAny(NDTask& task) {
  NDLock lock(mutex_);
  while (waiting_.empty() && !isShutDown_) workAdded_.wait(lock.native());
  if (isShutDown_) return false;
  std::swap(waiting_[random_.below(waiting_.size())], waiting_.back());
  task = std::move(waiting_.back());
  waiting_.pop_back();
  ++running_;
  return true;
}

void UnrulyQueue::finish() {
  const NDLock lock(mutex_);
  --running_;
  workDone_.notify_all();
}

}  // namespace nidus
