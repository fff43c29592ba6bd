#pragma once

#include <cstdint>
#include <memory>
#include <vector>

#include "HomePlatform/Objects/HomeObject.h"

namespace nidus {

/// All homes as one state of the database has them. Immutable but for the values; shared by all
/// managers that are created while that state lasts.
struct HomeEdition {
  std::uint64_t version = 0;  ///< Of the database.
  NDArray<NDHome> homes;      ///< In order.

  /// The home of that UUID; null when there is none.
  [[nodiscard]] std::shared_ptr<const HomeObject> find(const NDUUID& id) const {
    for (const auto& home : homes) {
      if (home->uuid() == id) return std::static_pointer_cast<const HomeObject>(home);
    }
    return nullptr;
  }
};

}  // namespace nidus
