#pragma once

#include <cstddef>
#include <cstdint>
#include <unordered_map>

#include "HomePlatform/Store/Database.h"
#include "HomePlatform/Store/HomeData.h"
#include "HomePlatform/Store/StoreProgress.h"

namespace nidus {

/// Puts homes into the tables, with each statement prepared once. To be used within one writing
/// transaction; what it refers to must be there, as `checkHome` makes sure. Not synchronised.
class HomeInserter {
 public:
  /// `progress` may be empty; it hears of the accessories of all homes.
  explicit HomeInserter(Database& database, StoreProgress progress = nullptr);

  /// Inserts `home` with all its parts. No other home has its position or its UUID.
  void insert(const HomeData& home, std::int64_t position);

 private:
  using Rows = std::unordered_map<NDUUID, std::int64_t>;

  void insertRooms(const HomeData& home);
  void insertZones(const HomeData& home);
  void insertAccessories(const HomeData& home);
  void insertServices(const AccessoryData& accessory, std::int64_t accessoryRow);
  void insertCharacteristics(const ServiceData& service, std::int64_t serviceRow);
  void insertServiceGroups(const HomeData& home);
  void insertActionSets(const HomeData& home);
  void insertTriggers(const HomeData& home);

  Database& database_;
  const StoreProgress progress_;
  std::size_t storedAccessories_ = 0;
  std::int64_t homeRow_ = 0;
  Rows rooms_;        ///< The rows of the present home's rooms and accessories.
  Rows accessories_;  ///< As above.

  Statement home_{database_,
                  "INSERT INTO home (position, uuid, name, is_primary, read_fault, write_fault) "
                  "VALUES (?, ?, ?, ?, ?, ?)"};
  Statement room_{database_, "INSERT INTO room (home, position, uuid, name) VALUES (?, ?, ?, ?)"};
  Statement zone_{database_, "INSERT INTO zone (home, position, uuid, name) VALUES (?, ?, ?, ?)"};
  Statement zoneRoom_{database_, "INSERT INTO zone_room (zone, position, room) VALUES (?, ?, ?)"};
  Statement accessory_{
      database_,
      "INSERT INTO accessory (home, position, uuid, name, room, reachable, requires_unlock, "
      "read_fault, write_fault) VALUES (?, ?, ?, ?, ?, ?, ?, ?, ?)"};
  Statement service_{database_,
                     "INSERT INTO service (accessory, position, instance_id, name, service_type, "
                     "associated_service_type) VALUES (?, ?, ?, ?, ?, ?)"};
  Statement characteristic_{
      database_,
      "INSERT INTO characteristic (service, position, instance_id, characteristic_type, "
      "properties, value, device_value, read_fault, write_fault, has_metadata, format, units, "
      "minimum_value, maximum_value, step_value) "
      "VALUES (?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?)"};
  Statement serviceGroup_{
      database_, "INSERT INTO service_group (home, position, uuid, name) VALUES (?, ?, ?, ?)"};
  Statement serviceGroupMember_{
      database_,
      "INSERT INTO service_group_member (service_group, position, service) VALUES (?, ?, "
      "(SELECT id FROM service WHERE accessory = ? AND instance_id = ?))"};
  Statement actionSet_{
      database_,
      "INSERT INTO action_set (home, position, uuid, name, execute_fault) VALUES (?, ?, ?, ?, ?)"};
  Statement sceneAction_{
      database_,
      "INSERT INTO scene_action (action_set, position, characteristic, value) VALUES (?1, ?2, "
      "(SELECT characteristic.id FROM service JOIN characteristic ON service = service.id "
      "WHERE accessory = ?3 AND service.instance_id = ?4 AND characteristic.instance_id = ?5), "
      "?6)"};
  Statement trigger_{database_,
                     "INSERT INTO event_trigger (home, position, uuid, name) VALUES (?, ?, ?, ?)"};
};

}  // namespace nidus
