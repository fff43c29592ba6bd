#include "PlatformModel/System/NDConcurrentQueue.h"

#include <cassert>
#include <condition_variable>
#include <deque>
#include <system_error>
#include <thread>
#include <utility>
#include <vector>

#include "PlatformModel/System/NDMutex.h"

namespace nidus {

struct NDConcurrentQueue::State {
  explicit State(std::size_t greatestWidth) : width(greatestWidth) { assert(width > 0); }

  static void work(const std::shared_ptr<State>& state);
  [[nodiscard]] bool isOnOwnThread() const noexcept;
  bool take(NDTask& task);
  void finish();
  void waitUntilIdle();
  std::deque<NDTask> close();
  std::vector<std::thread> takeThreads();
  static void startThread(const std::shared_ptr<State>& state) ND_REQUIRES(state->mutex);

  const std::size_t width;
  NDMutex mutex;
  std::condition_variable workAdded;   // or the queue was closed
  std::condition_variable becameIdle;  // no work waits or runs
  std::deque<NDTask> tasks ND_GUARDED_BY(mutex);
  std::vector<std::thread> threads ND_GUARDED_BY(mutex);
  std::size_t waitingThreads ND_GUARDED_BY(mutex) = 0;
  std::size_t runningTasks ND_GUARDED_BY(mutex) = 0;
  bool isShutDown ND_GUARDED_BY(mutex) = false;
};

namespace {

// The state of the queue that the calling thread belongs to, told apart by its address alone.
constinit thread_local const void* ownState = nullptr;

}  // namespace

void NDConcurrentQueue::State::work(const std::shared_ptr<State>& state) {
  ownState = state.get();
  NDTask task;
  while (state->take(task)) {
    task();
    task = nullptr;  // what it holds is released before the queue may count as idle
    state->finish();
  }
}

bool NDConcurrentQueue::State::isOnOwnThread() const noexcept { return ownState == this; }

bool NDConcurrentQueue::State::take(NDTask& task) {
  NDLock lock(mutex);
  ++waitingThreads;
  while (tasks.empty() && !isShutDown) workAdded.wait(lock.native());
  --waitingThreads;
  if (isShutDown) return false;
  task = std::move(tasks.front());
  tasks.pop_front();
  ++runningTasks;
  return true;
}

void NDConcurrentQueue::State::finish() {
  const NDLock lock(mutex);
  --runningTasks;
  if (runningTasks == 0 && tasks.empty()) becameIdle.notify_all();
}

void NDConcurrentQueue::State::waitUntilIdle() {
  NDLock lock(mutex);
  while (runningTasks > 0 || !tasks.empty()) becameIdle.wait(lock.native());
}

std::deque<NDTask> NDConcurrentQueue::State::close() {
  const NDLock lock(mutex);
  isShutDown = true;
  workAdded.notify_all();
  if (runningTasks == 0) becameIdle.notify_all();
  return std::exchange(tasks, {});
}

std::vector<std::thread> NDConcurrentQueue::State::takeThreads() {
  const NDLock lock(mutex);
  return std::exchange(threads, {});
}

/// A machine that has no thread left to give costs speed, not work, as long as there is one.
void NDConcurrentQueue::State::startThread(const std::shared_ptr<State>& state) {
  try {
    state->threads.emplace_back([state] { State::work(state); });
  } catch (const std::system_error&) {
    if (state->threads.empty()) throw;
  }
}

NDConcurrentQueue::NDConcurrentQueue(std::size_t width) : state_(std::make_shared<State>(width)) {}

NDConcurrentQueue::~NDConcurrentQueue() {
  shutDown();
  // Threads are left over only when one of them destroys the queue. It cannot wait for itself, and
  // must not wait for the others, which may be waiting for it; they share the state that they need.
  for (std::thread& thread : state_->takeThreads()) thread.detach();
}

void NDConcurrentQueue::async(NDTask task) {
  const NDLock lock(state_->mutex);
  if (state_->isShutDown) return;
  const bool isThreadMissing = state_->tasks.size() >= state_->waitingThreads;
  if (isThreadMissing && state_->threads.size() < state_->width) State::startThread(state_);
  state_->tasks.push_back(std::move(task));
  state_->workAdded.notify_one();
}

void NDConcurrentQueue::shutDown() {
  state_->close();  // what was waiting is destroyed here, without the lock
  if (state_->isOnOwnThread()) return;
  for (std::thread& thread : state_->takeThreads()) thread.join();
  // When two threads shut down, one joins and both wait.
  state_->waitUntilIdle();
}

void NDConcurrentQueue::waitUntilIdle() { state_->waitUntilIdle(); }

}  // namespace nidus
