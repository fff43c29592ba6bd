#include "HomePlatform/Store/HomeLoader.h"

#include <algorithm>
#include <unordered_map>
#include <utility>

#include "HomePlatform/Store/Schema.h"
#include "HomePlatform/Store/SharedTexts.h"

namespace nidus {
namespace {

/// Finds the object that a row belongs to. Rows come sorted by their owners, so that one look-up
/// serves a whole list.
template <class Data>
class Owners {
 public:
  void add(std::int64_t row, Data& data) { byRow_[row] = &data; }

  Data& of(std::int64_t row) {
    if (!last_ || row != lastRow_) {
      const auto found = byRow_.find(row);
      if (found == byRow_.end()) {
        throw DatabaseError{DatabaseError::Kind::damaged, "a row belongs to nothing"};
      }
      lastRow_ = row;
      last_ = found->second;
    }
    return *last_;
  }

 private:
  std::unordered_map<std::int64_t, Data*> byRow_;
  std::int64_t lastRow_ = 0;
  Data* last_ = nullptr;
};

NDString textOrNull(const Statement& row, int column) {
  return row.isNull(column) ? NDString() : NDString(row.text(column));
}

class HomeLoader {
 public:
  explicit HomeLoader(Database& database) : database_(database) {}

  std::vector<HomeData> load() {
    loadHomes();
    loadRooms();
    loadZones();
    loadAccessories();
    loadServices();
    loadCharacteristics();
    loadServiceGroups();
    loadActionSets();
    loadTriggers();
    return std::move(homes_);
  }

 private:
  /// Appends the rows of a table to the lists of their owners, and afterwards, when the lists no
  /// longer move, lets `owners` find each of them by its row. The first two columns are the
  /// owner's row and the row.
  template <class Owner, class Data, class Read>
  void loadList(const char* query, Owners<Owner>& ownersOfList, std::vector<Data> Owner::*list,
                Owners<Data>* owners, const Read& read) {
    std::vector<std::pair<std::int64_t, std::vector<Data>*>> rows;
    Statement row(database_, query);
    while (row.step()) {
      std::vector<Data>& elements = ownersOfList.of(row.integer(0)).*list;
      elements.push_back(read(row));
      if (owners) rows.emplace_back(row.integer(1), &elements);
    }
    if (!owners) return;
    std::size_t index = 0;
    const std::vector<Data>* present = nullptr;
    for (const auto& [id, elements] : rows) {
      index = elements == present ? index + 1 : 0;
      present = elements;
      owners->add(id, (*elements)[index]);
    }
  }

  template <class Data>
  static Data named(const Statement& row) {
    Data data;
    data.uuid = row.uuid(2);
    data.name = row.text(3);
    return data;
  }

  void loadHomes() {
    Statement row(database_,
                  "SELECT id, uuid, name, is_primary, read_fault, write_fault FROM home "
                  "ORDER BY position");
    std::vector<std::int64_t> rows;
    while (row.step()) {
      HomeData& home = homes_.emplace_back();
      home.uuid = row.uuid(1);
      home.name = row.text(2);
      home.primary = row.flag(3);
      home.faults = {row.smallInteger(4), row.smallInteger(5)};
      rows.push_back(row.integer(0));
    }
    for (std::size_t i = 0; i < rows.size(); ++i) homeOwners_.add(rows[i], homes_[i]);
  }

  void loadRooms() {
    loadList<HomeData, RoomData>("SELECT home, id, uuid, name FROM room ORDER BY home, position",
                                 homeOwners_, &HomeData::rooms, nullptr,
                                 [](const Statement& row) { return named<RoomData>(row); });
  }

  void loadZones() {
    Owners<ZoneData> zones;
    loadList<HomeData, ZoneData>("SELECT home, id, uuid, name FROM zone ORDER BY home, position",
                                 homeOwners_, &HomeData::zones, &zones,
                                 [](const Statement& row) { return named<ZoneData>(row); });
    loadList<ZoneData, NDUUID>(
        "SELECT zone, 0, room.uuid FROM zone_room JOIN room ON room.id = room "
        "ORDER BY zone, zone_room.position",
        zones, &ZoneData::rooms, nullptr, [](const Statement& row) { return row.uuid(2); });
  }

  void loadAccessories() {
    loadList<HomeData, AccessoryData>(
        "SELECT accessory.home, accessory.id, accessory.uuid, accessory.name, room.uuid, reachable,"
        " requires_unlock, read_fault, write_fault "
        "FROM accessory LEFT JOIN room ON room.id = room "
        "ORDER BY accessory.home, accessory.position",
        homeOwners_, &HomeData::accessories, &accessories_, [](const Statement& row) {
          auto accessory = named<AccessoryData>(row);
          if (!row.isNull(4)) accessory.room = row.uuid(4);
          accessory.reachable = row.flag(5);
          accessory.requiresUnlock = row.flag(6);
          accessory.faults = {row.smallInteger(7), row.smallInteger(8)};
          return accessory;
        });
  }

  void loadServices() {
    loadList<AccessoryData, ServiceData>(
        "SELECT accessory, id, instance_id, name, service_type, associated_service_type "
        "FROM service ORDER BY accessory, position",
        accessories_, &AccessoryData::services, &services_, [this](const Statement& row) {
          ServiceData service;
          service.instanceID = row.integer(2);
          service.name = textOrNull(row, 3);
          service.serviceType = texts_.text(row.text(4));
          if (!row.isNull(5)) service.associatedServiceType = texts_.text(row.text(5));
          return service;
        });
  }

  void loadCharacteristics() {
    loadList<ServiceData, CharacteristicData>(
        "SELECT service, id, instance_id, characteristic_type, properties, value, device_value, "
        "read_fault, write_fault, has_metadata, format, units, minimum_value, maximum_value, "
        "step_value FROM characteristic ORDER BY service, position",
        services_, &ServiceData::characteristics, nullptr,
        [this](const Statement& row) { return characteristic(row); });
  }

  CharacteristicData characteristic(const Statement& row) {
    CharacteristicData data;
    data.instanceID = row.integer(2);
    data.characteristicType = texts_.text(row.text(3));
    data.properties = words(row.text(4));
    data.value = row.value(5);
    data.deviceValue = row.value(6);
    data.faults = {row.smallInteger(7), row.smallInteger(8)};
    if (!row.flag(9)) return data;
    MetadataData& metadata = data.metadata.emplace();
    if (!row.isNull(10)) metadata.format = texts_.text(row.text(10));
    if (!row.isNull(11)) metadata.units = texts_.text(row.text(11));
    metadata.minimumValue = row.value(12);
    metadata.maximumValue = row.value(13);
    metadata.stepValue = row.value(14);
    return data;
  }

  std::vector<NDString> words(std::string_view text) {
    std::vector<NDString> words;
    while (!text.empty()) {
      const std::size_t length = std::min(text.find(' '), text.size());
      words.push_back(texts_.text(text.substr(0, length)));
      text.remove_prefix(std::min(length + 1, text.size()));
    }
    return words;
  }

  void loadServiceGroups() {
    Owners<ServiceGroupData> groups;
    loadList<HomeData, ServiceGroupData>(
        "SELECT home, id, uuid, name FROM service_group ORDER BY home, position", homeOwners_,
        &HomeData::serviceGroups, &groups,
        [](const Statement& row) { return named<ServiceGroupData>(row); });
    loadList<ServiceGroupData, ServiceAddress>(
        "SELECT service_group, 0, accessory.uuid, instance_id FROM service_group_member AS member "
        "JOIN service ON service.id = member.service JOIN accessory ON accessory.id = accessory "
        "ORDER BY service_group, member.position",
        groups, &ServiceGroupData::services, nullptr, [](const Statement& row) {
          return ServiceAddress{row.uuid(2), row.integer(3)};
        });
  }

  void loadActionSets() {
    Owners<ActionSetData> actionSets;
    loadList<HomeData, ActionSetData>(
        "SELECT home, id, uuid, name, execute_fault FROM action_set ORDER BY home, position",
        homeOwners_, &HomeData::actionSets, &actionSets, [](const Statement& row) {
          auto actionSet = named<ActionSetData>(row);
          actionSet.executeFault = row.smallInteger(4);
          return actionSet;
        });
    loadList<ActionSetData, SceneActionData>(
        "SELECT action_set, 0, accessory.uuid, service.instance_id, characteristic.instance_id, "
        "scene_action.value FROM scene_action "
        "JOIN characteristic ON characteristic.id = characteristic "
        "JOIN service ON service.id = service JOIN accessory ON accessory.id = accessory "
        "ORDER BY action_set, scene_action.position",
        actionSets, &ActionSetData::actions, nullptr, [](const Statement& row) {
          return SceneActionData{{row.uuid(2), row.integer(3), row.integer(4)}, row.value(5)};
        });
  }

  void loadTriggers() {
    loadList<HomeData, TriggerData>(
        "SELECT home, id, uuid, name FROM event_trigger ORDER BY home, position", homeOwners_,
        &HomeData::triggers, nullptr, [](const Statement& row) { return named<TriggerData>(row); });
  }

  Database& database_;
  SharedTexts texts_;
  std::vector<HomeData> homes_;
  Owners<HomeData> homeOwners_;
  Owners<AccessoryData> accessories_;
  Owners<ServiceData> services_;
};

}  // namespace

std::vector<HomeData> loadHomesFrom(Database& database) {
  const WorkLimit limit(database);
  return HomeLoader(database).load();
}

std::vector<HomeData> loadMigratedHomes(Database& database) {
  const bool isCurrent = isSchemaCurrent(database, schemaSteps());
  const Transaction undone(database,
                           isCurrent ? Transaction::Kind::reading : Transaction::Kind::writing);
  if (!isCurrent) runSchemaSteps(database, schemaSteps());
  return loadHomesFrom(database);
}

}  // namespace nidus
