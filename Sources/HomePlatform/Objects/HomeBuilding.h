#pragma once

#include <memory>
#include <unordered_map>
#include <vector>

#include "HomePlatform/Objects/HomeObject.h"

namespace nidus {

/// Puts the objects of one home together, in one go, by `HomeObject::make`.
class HomeBuilding {
 public:
  HomeBuilding(std::shared_ptr<HomeObject> home, std::shared_ptr<const HomeData> data)
      : home_(std::move(home)), data_(std::move(data)) {}

  void build();

 private:
  void buildRooms();
  void buildZones();
  void buildAccessories();
  void buildGroups();
  void buildScenesAndTriggers();
  [[nodiscard]] std::shared_ptr<NDRoom> roomOf(const AccessoryData& accessory) const;

  /// Makes one object for each element of `list`, which is part of the home's data.
  template <class Object, class Interface, class Data>
  [[nodiscard]] NDArray<Interface> makeAll(const std::vector<Data>& list) const;

  const std::shared_ptr<HomeObject> home_;
  const std::shared_ptr<const HomeData> data_;
  std::unordered_map<NDUUID, std::shared_ptr<NDRoom>> roomsByID_;
};

}  // namespace nidus
