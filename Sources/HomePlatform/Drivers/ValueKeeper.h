#pragma once

#include <vector>

#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeStore.h"

namespace nidus {

/// Takes the values that drivers learn. May be called from any thread.
class ValueKeeper {
 public:
  virtual ~ValueKeeper() = default;
  /// Keeps `changes`, in order, all or none: they are on disk, and in the cached values of all
  /// loaded homes, when the call returns.
  [[nodiscard]] virtual Status keep(const std::vector<ValueChange>& changes) = 0;
};

}  // namespace nidus
