#pragma once

#include <cstddef>
#include <map>
#include <string>
#include <vector>

#include "HomePlatform/Store/HomeData.h"
#include "nidus/Explain/Rehearsal.h"

namespace nidus {

/// A characteristic with all that it is part of. It points into the homes; only the room may be
/// null.
struct PlacedCharacteristic {
  const HomeData* home;
  const RoomData* room;
  const AccessoryData* accessory;
  const ServiceData* service;
  const CharacteristicData* characteristic;

  [[nodiscard]] HomeCharacteristic place() const;
  /// The name of the service, or of the accessory when it has none; on one line.
  [[nodiscard]] std::string objectName() const;
  /// The name of the room; empty when it stands in none.
  [[nodiscard]] std::string roomName() const;
  /// Whether the value that was known last is the same in both.
  [[nodiscard]] bool hasValueOf(const PlacedCharacteristic& other) const;
};

/// All characteristics of homes, to be found by their places.
class HomeIndex {
 public:
  /// `homes` must outlive this and stay as they are.
  explicit HomeIndex(const std::vector<HomeData>& homes);

  /// Null when there is none.
  [[nodiscard]] const PlacedCharacteristic* find(const HomeCharacteristic& place) const;
  [[nodiscard]] const HomeData* findHome(const NDUUID& home) const;
  /// In the order of the homes.
  [[nodiscard]] const std::vector<PlacedCharacteristic>& all() const noexcept { return all_; }

 private:
  void add(const HomeData& home, const RoomData* room, const AccessoryData& accessory);

  const std::vector<HomeData>& homes_;
  std::vector<PlacedCharacteristic> all_;
  std::map<HomeCharacteristic, std::size_t> places_;
};

}  // namespace nidus
