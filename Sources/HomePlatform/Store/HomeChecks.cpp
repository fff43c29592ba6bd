#include "HomePlatform/Store/HomeChecks.h"

#include <algorithm>
#include <set>
#include <string_view>
#include <unordered_set>

#include "HomePlatform/Json/JsonValue.h"

namespace nidus {
namespace {

/// The place of an element of a list, made only when it is needed.
struct Element {
  const std::string& owner;
  std::string_view list;
  std::size_t index;

  [[nodiscard]] std::string place() const {
    return owner + '/' + std::string(list) + '/' + std::to_string(index);
  }
};

[[noreturn]] void fail(std::string place, std::string message) {
  throw JsonError{std::move(place), std::move(message)};
}

std::string text(const NDUUID& uuid) { return uuid.UUIDString().str(); }

/// One home's check: the indices that references are looked up in, and a step for each kind of
/// part.
class HomeCheck {
 public:
  HomeCheck(const HomeData& home, const std::string& place) : home_(home), place_(place) {}

  void run() {
    checkUUIDs();
    for (std::size_t i = 0; i < home_.accessories.size(); ++i) checkAccessory(i);
    for (std::size_t i = 0; i < home_.zones.size(); ++i) checkZone(i);
    if (home_.serviceGroups.empty() && home_.actionSets.empty()) return;
    indexServices();
    for (std::size_t i = 0; i < home_.serviceGroups.size(); ++i) checkServiceGroup(i);
    for (std::size_t i = 0; i < home_.actionSets.size(); ++i) checkActionSet(i);
  }

 private:
  void checkUUIDs() {
    std::unordered_set<NDUUID> uuids;
    addUUIDs("rooms", home_.rooms, uuids);
    rooms_ = uuids;
    addUUIDs("zones", home_.zones, uuids);
    addUUIDs("accessories", home_.accessories, uuids);
    addUUIDs("serviceGroups", home_.serviceGroups, uuids);
    addUUIDs("actionSets", home_.actionSets, uuids);
    addUUIDs("triggers", home_.triggers, uuids);
  }

  template <class Data>
  void addUUIDs(std::string_view list, const std::vector<Data>& parts,
                std::unordered_set<NDUUID>& uuids) const {
    for (std::size_t i = 0; i < parts.size(); ++i) {
      if (uuids.insert(parts[i].uuid).second) continue;
      fail(Element{place_, list, i}.place() + "/uuid",
           "another object of this home has the UUID " + text(parts[i].uuid));
    }
  }

  void checkRoom(const NDUUID& room, const std::string& place) const {
    if (rooms_.count(room) == 0) fail(place, "no room of this home has the UUID " + text(room));
  }

  void checkAccessory(std::size_t index) const {
    const AccessoryData& accessory = home_.accessories[index];
    const std::string place = Element{place_, "accessories", index}.place();
    if (accessory.room) checkRoom(*accessory.room, place + "/room");
    std::unordered_set<std::int64_t> services;
    std::unordered_set<std::int64_t> characteristics;
    for (std::size_t i = 0; i < accessory.services.size(); ++i) {
      const ServiceData& service = accessory.services[i];
      if (!services.insert(service.instanceID).second) {
        fail(Element{place, "services", i}.place() + "/instanceID",
             "another service of this accessory has the instance ID " +
                 std::to_string(service.instanceID));
      }
      checkCharacteristics(service, {place, "services", i}, characteristics);
    }
  }

  static void checkCharacteristics(const ServiceData& service, const Element& element,
                                   std::unordered_set<std::int64_t>& known) {
    for (std::size_t i = 0; i < service.characteristics.size(); ++i) {
      const CharacteristicData& characteristic = service.characteristics[i];
      if (!known.insert(characteristic.instanceID).second) {
        fail(Element{element.place(), "characteristics", i}.place() + "/instanceID",
             "another characteristic of this accessory has the instance ID " +
                 std::to_string(characteristic.instanceID));
      }
      checkProperties(characteristic.properties, element, i);
    }
  }

  static void checkProperties(const std::vector<NDString>& words, const Element& service,
                              std::size_t characteristic) {
    for (auto word = words.begin(); word != words.end(); ++word) {
      if (std::find(words.begin(), word, *word) == word) continue;
      const std::string owner = Element{service.place(), "characteristics", characteristic}.place();
      fail(Element{owner, "properties", static_cast<std::size_t>(word - words.begin())}.place(),
           '"' + word->str() + "\" is listed twice");
    }
  }

  void checkZone(std::size_t index) const {
    const std::vector<NDUUID>& rooms = home_.zones[index].rooms;
    for (std::size_t i = 0; i < rooms.size(); ++i) {
      if (rooms_.count(rooms[i]) != 0) continue;
      checkRoom(rooms[i], Element{Element{place_, "zones", index}.place(), "rooms", i}.place());
    }
  }

  void indexServices() {
    for (const AccessoryData& accessory : home_.accessories) {
      accessories_.insert(accessory.uuid);
      for (const ServiceData& service : accessory.services) {
        services_.push_back({accessory.uuid, service.instanceID});
        if (home_.actionSets.empty()) continue;
        for (const CharacteristicData& characteristic : service.characteristics) {
          characteristics_.push_back(
              {accessory.uuid, service.instanceID, characteristic.instanceID});
        }
      }
    }
    std::sort(services_.begin(), services_.end());
    std::sort(characteristics_.begin(), characteristics_.end());
  }

  void checkService(const ServiceAddress& address, const Element& element) const {
    if (std::binary_search(services_.begin(), services_.end(), address)) return;
    if (accessories_.count(address.accessory) == 0) {
      fail(element.place() + "/accessory",
           "no accessory of this home has the UUID " + text(address.accessory));
    }
    fail(element.place() + "/service", "the accessory " + text(address.accessory) +
                                           " has no service with the instance ID " +
                                           std::to_string(address.service));
  }

  void checkServiceGroup(std::size_t index) const {
    const std::string place = Element{place_, "serviceGroups", index}.place();
    const std::vector<ServiceAddress>& services = home_.serviceGroups[index].services;
    std::set<ServiceAddress> known;
    for (std::size_t i = 0; i < services.size(); ++i) {
      const Element element{place, "services", i};
      checkService(services[i], element);
      if (!known.insert(services[i]).second) fail(element.place(), "the service is listed twice");
    }
  }

  void checkActionSet(std::size_t index) const {
    const std::string place = Element{place_, "actionSets", index}.place();
    const std::vector<SceneActionData>& actions = home_.actionSets[index].actions;
    for (std::size_t i = 0; i < actions.size(); ++i) {
      const CharacteristicAddress& target = actions[i].target;
      if (std::binary_search(characteristics_.begin(), characteristics_.end(), target)) continue;
      const Element element{place, "actions", i};
      checkService({target.accessory, target.service}, element);
      fail(element.place() + "/characteristic", "the service " + std::to_string(target.service) +
                                                    " of the accessory " + text(target.accessory) +
                                                    " has no characteristic with the instance ID " +
                                                    std::to_string(target.characteristic));
    }
  }

  const HomeData& home_;
  const std::string& place_;
  std::unordered_set<NDUUID> rooms_;
  std::unordered_set<NDUUID> accessories_;
  std::vector<ServiceAddress> services_;                ///< Sorted.
  std::vector<CharacteristicAddress> characteristics_;  ///< Sorted.
};

}  // namespace

void checkHome(const HomeData& home, const std::string& place) { HomeCheck(home, place).run(); }

void checkHomesAreUnique(const std::vector<HomeData>& homes, const std::string& place) {
  std::unordered_set<NDUUID> uuids;
  for (std::size_t i = 0; i < homes.size(); ++i) {
    if (uuids.insert(homes[i].uuid).second) continue;
    fail(Element{place, "homes", i}.place() + "/uuid",
         "another home has the UUID " + text(homes[i].uuid));
  }
}

Status checkHomes(const std::vector<HomeData>& homes, const std::string& name) {
  try {
    for (std::size_t i = 0; i < homes.size(); ++i) {
      checkHome(homes[i], Element{"", "homes", i}.place());
    }
    checkHomesAreUnique(homes, "");
  } catch (const JsonError& error) {
    return failureOf(error, name);
  }
  return std::nullopt;
}

}  // namespace nidus
