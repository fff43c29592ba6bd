#pragma once

#include <condition_variable>
#include <mutex>

#if defined(__clang__)
#define ND_THREAD_ANNOTATION(x) __attribute__((x))
#else
#define ND_THREAD_ANNOTATION(x)
#endif
#define ND_CAPABILITY(x) ND_THREAD_ANNOTATION(capability(x))
#define ND_SCOPED_CAPABILITY ND_THREAD_ANNOTATION(scoped_lockable)
#define ND_GUARDED_BY(x) ND_THREAD_ANNOTATION(guarded_by(x))
#define ND_REQUIRES(...) ND_THREAD_ANNOTATION(requires_capability(__VA_ARGS__))
#define ND_ACQUIRE(...) ND_THREAD_ANNOTATION(acquire_capability(__VA_ARGS__))
#define ND_RELEASE(...) ND_THREAD_ANNOTATION(release_capability(__VA_ARGS__))
#define ND_NO_THREAD_SAFETY_ANALYSIS ND_THREAD_ANNOTATION(no_thread_safety_analysis)

namespace nidus {

/// A mutex that clang's thread-safety analysis knows. Members it guards carry `ND_GUARDED_BY`.
class ND_CAPABILITY("mutex") NDMutex {
 public:
  void lock() ND_ACQUIRE() { mutex_.lock(); }
  void unlock() ND_RELEASE() { mutex_.unlock(); }
  /// For waiting on a condition variable; the caller holds the lock.
  [[nodiscard]] std::mutex& native() { return mutex_; }

 private:
  std::mutex mutex_;
};

/// Holds an `NDMutex` for a scope. A lock covers a few lines of plain data work: copy out, leave
/// the scope, then call handlers, the model or the logger.
class ND_SCOPED_CAPABILITY NDLock {
 public:
  explicit NDLock(NDMutex& mutex) ND_ACQUIRE(mutex) : lock_(mutex.native()) {}
  ~NDLock() ND_RELEASE() = default;
  NDLock(const NDLock&) = delete;
  NDLock& operator=(const NDLock&) = delete;
  /// For waiting on a condition variable.
  [[nodiscard]] std::unique_lock<std::mutex>& native() { return lock_; }

 private:
  std::unique_lock<std::mutex> lock_;
};

}  // namespace nidus
