#pragma once

#include <cstddef>
#include <memory>
#include <utility>
#include <vector>

#include "PlatformModel/Home/NDAccessory.h"
#include "PlatformModel/Home/NDHome.h"
#include "PlatformModel/System/NDNull.h"

namespace nidus {

/// Groups what one action does by home, so that each home is asked once: homes in the order in
/// which they were met, the items of each in the order in which they were added. Homes are not kept
/// alive. Not synchronised.
///
///     HomeTable<std::shared_ptr<NDCharacteristic>> table(characteristics.size());
///     table.add(*characteristic, characteristic);
///     table.forEachHome([](const std::shared_ptr<NDHome>& home, auto items) { ... });
template <class Item>
class HomeTable {
 public:
  /// Makes room for `expected` items of the home that is met first: mostly there is no other.
  explicit HomeTable(std::size_t expected) : expected_(expected) {}

  /// Adds `item` to the home that holds `characteristic`; nothing happens when that home is gone.
  void add(const NDCharacteristic& characteristic, Item item) {
    const auto accessory = property(characteristic.service(), &NDService::accessory);
    const auto home = property(accessory, &NDAccessory::home);
    if (home) itemsOf(home).push_back(std::move(item));
  }

  /// Hands each home that is still there, never null, with its items, never empty, to `visit`.
  /// Called once.
  template <class Visit>
  void forEachHome(const Visit& visit) {
    for (Entry& entry : entries_) {
      if (const auto home = entry.home.lock()) visit(home, std::move(entry.items));
    }
  }

 private:
  struct Entry {
    std::weak_ptr<NDHome> home;
    std::vector<Item> items;
  };

  std::vector<Item>& itemsOf(const std::shared_ptr<NDHome>& home) {
    for (Entry& entry : entries_) {
      const bool isSame = !entry.home.owner_before(home) && !home.owner_before(entry.home);
      if (isSame) return entry.items;
    }
    auto& items = entries_.emplace_back(Entry{home, {}}).items;
    items.reserve(std::exchange(expected_, 0));
    return items;
  }

  std::size_t expected_;  ///< 0 once a home was met.
  std::vector<Entry> entries_;
};

}  // namespace nidus
