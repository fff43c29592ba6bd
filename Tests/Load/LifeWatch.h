#pragma once

#include <cstddef>
#include <map>
#include <memory>
#include <string>
#include <vector>

#include "PlatformModel/System/NDMutex.h"

namespace nidus {

/// Knows which of many objects are still alive, without keeping any of them so. May be used from
/// any thread.
class LifeWatch {
 public:
  /// `kind` names the objects for people, such as "commands".
  void add(const std::string& kind, const std::weak_ptr<const void>& object);
  /// How many of each kind are alive; kinds of which none is are left out.
  [[nodiscard]] std::map<std::string, std::size_t> survivors();

 private:
  struct Watched {
    std::vector<std::weak_ptr<const void>> objects;
    std::size_t greatestCount = 0;  ///< From there on, those that are gone are forgotten.
  };

  NDMutex mutex_;
  std::map<std::string, Watched> watched_ ND_GUARDED_BY(mutex_);
};

}  // namespace nidus
