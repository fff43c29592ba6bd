#pragma once

#include <memory>
#include <unordered_map>

#include "PlatformModel/System/NDMutex.h"

namespace nidus {

class HomeManagerObject;

/// The managers that wait for their homes, so that a platform that is shut down can tell them that
/// they wait in vain. Keeps none of them alive. May be used from any thread.
class PendingManagers {
 public:
  /// Adds a manager; false, with no effect, after `close`.
  [[nodiscard]] bool add(const std::shared_ptr<HomeManagerObject>& manager);
  /// Removes a manager, by its address alone.
  void remove(const HomeManagerObject* manager);
  /// Tells each manager that its homes never come, on the calling thread.
  void close();

 private:
  NDMutex mutex_;
  std::unordered_map<const HomeManagerObject*, std::weak_ptr<HomeManagerObject>> managers_
      ND_GUARDED_BY(mutex_);
  bool isClosed_ ND_GUARDED_BY(mutex_) = false;
};

}  // namespace nidus
