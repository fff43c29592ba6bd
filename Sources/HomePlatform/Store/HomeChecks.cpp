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

/// Addresses that are referred to, and which of them lead somewhere: it costs memory for each
/// reference, not for each of the many things that could be referred to.
template <class Address>
class References {
 public:
  void add(const Address& address) { wanted_.push_back(address); }
  /// Ends the adding.
  void sort() {
    std::sort(wanted_.begin(), wanted_.end());
    wanted_.erase(std::unique(wanted_.begin(), wanted_.end()), wanted_.end());
    found_.assign(wanted_.size(), false);
  }
  void find(const Address& address) {
    const std::size_t index = indexOf(address);
    if (index < wanted_.size()) found_[index] = true;
  }
  /// `address` has been added.
  [[nodiscard]] bool isFound(const Address& address) const { return found_[indexOf(address)]; }

 private:
  /// The number of all for an address that nobody refers to.
  [[nodiscard]] std::size_t indexOf(const Address& address) const {
    const auto place = std::lower_bound(wanted_.begin(), wanted_.end(), address);
    const bool isWanted = place != wanted_.end() && *place == address;
    return static_cast<std::size_t>((isWanted ? place : wanted_.end()) - wanted_.begin());
  }

  std::vector<Address> wanted_;
  std::vector<bool> found_;
};

/// Sorts `numbers` and says whether one stands twice: quick for the few of most accessories, and
/// for many that somebody chose to be slow to look up.
bool hasRepetition(std::vector<std::int64_t>& numbers) {
  std::sort(numbers.begin(), numbers.end());
  return std::adjacent_find(numbers.begin(), numbers.end()) != numbers.end();
}

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
    findReferences();
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

  void checkAccessory(std::size_t index) {
    const AccessoryData& accessory = home_.accessories[index];
    const std::string place = Element{place_, "accessories", index}.place();
    if (accessory.room) checkRoom(*accessory.room, place + "/room");
    services_.clear();
    characteristics_.clear();
    for (const ServiceData& service : accessory.services) {
      services_.push_back(service.instanceID);
      for (const CharacteristicData& characteristic : service.characteristics) {
        characteristics_.push_back(characteristic.instanceID);
      }
    }
    const bool isRepeated = hasRepetition(services_) || hasRepetition(characteristics_);
    if (isRepeated) failAtRepetition(accessory, place);
    checkProperties(accessory, place);
  }

  /// Fails at the first instance ID that another service or characteristic has.
  static void failAtRepetition(const AccessoryData& accessory, const std::string& place) {
    std::set<std::int64_t> services;
    std::set<std::int64_t> characteristics;
    for (std::size_t i = 0; i < accessory.services.size(); ++i) {
      const ServiceData& service = accessory.services[i];
      const Element element{place, "services", i};
      addInstanceID(service.instanceID, "service", element, services);
      const std::string servicePlace = element.place();
      for (std::size_t k = 0; k < service.characteristics.size(); ++k) {
        addInstanceID(service.characteristics[k].instanceID, "characteristic",
                      {servicePlace, "characteristics", k}, characteristics);
      }
    }
  }

  static void addInstanceID(std::int64_t id, const std::string& kind, const Element& element,
                            std::set<std::int64_t>& known) {
    if (known.insert(id).second) return;
    fail(element.place() + "/instanceID",
         "another " + kind + " of this accessory has the instance ID " + std::to_string(id));
  }

  static void checkProperties(const AccessoryData& accessory, const std::string& place) {
    for (std::size_t i = 0; i < accessory.services.size(); ++i) {
      const auto& characteristics = accessory.services[i].characteristics;
      for (std::size_t k = 0; k < characteristics.size(); ++k) {
        checkProperties(characteristics[k].properties, {place, "services", i}, k);
      }
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

  /// Collects what groups and scenes refer to, and finds what of it is there.
  void findReferences() {
    for (const ServiceGroupData& group : home_.serviceGroups) {
      for (const ServiceAddress& service : group.services) groupedServices_.add(service);
    }
    for (const ActionSetData& actionSet : home_.actionSets) {
      for (const SceneActionData& action : actionSet.actions) targets_.add(action.target);
    }
    groupedServices_.sort();
    targets_.sort();
    for (const AccessoryData& accessory : home_.accessories) findReferences(accessory);
  }

  void findReferences(const AccessoryData& accessory) {
    for (const ServiceData& service : accessory.services) {
      groupedServices_.find({accessory.uuid, service.instanceID});
      for (const CharacteristicData& characteristic : service.characteristics) {
        targets_.find({accessory.uuid, service.instanceID, characteristic.instanceID});
      }
    }
  }

  /// Fails for a service that is not there.
  [[noreturn]] void failAtService(const ServiceAddress& address, const Element& element) const {
    if (!accessoryOf(address.accessory)) {
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
      if (!groupedServices_.isFound(services[i])) failAtService(services[i], element);
      if (!known.insert(services[i]).second) fail(element.place(), "the service is listed twice");
    }
  }

  void checkActionSet(std::size_t index) const {
    const std::string place = Element{place_, "actionSets", index}.place();
    const std::vector<SceneActionData>& actions = home_.actionSets[index].actions;
    for (std::size_t i = 0; i < actions.size(); ++i) {
      const CharacteristicAddress& target = actions[i].target;
      if (!targets_.isFound(target)) failAtTarget(target, {place, "actions", i});
    }
  }

  [[noreturn]] void failAtTarget(const CharacteristicAddress& target,
                                 const Element& element) const {
    const AccessoryData* accessory = accessoryOf(target.accessory);
    const auto isService = [&target](const auto& one) { return one.instanceID == target.service; };
    if (!accessory ||
        std::none_of(accessory->services.begin(), accessory->services.end(), isService)) {
      failAtService({target.accessory, target.service}, element);
    }
    fail(element.place() + "/characteristic", "the service " + std::to_string(target.service) +
                                                  " of the accessory " + text(target.accessory) +
                                                  " has no characteristic with the instance ID " +
                                                  std::to_string(target.characteristic));
  }

  [[nodiscard]] const AccessoryData* accessoryOf(const NDUUID& uuid) const {
    const auto& accessories = home_.accessories;
    const auto found =
        std::find_if(accessories.begin(), accessories.end(),
                     [&uuid](const AccessoryData& accessory) { return accessory.uuid == uuid; });
    return found == accessories.end() ? nullptr : &*found;
  }

  const HomeData& home_;
  const std::string& place_;
  std::unordered_set<NDUUID> rooms_;
  References<ServiceAddress> groupedServices_;
  References<CharacteristicAddress> targets_;
  std::vector<std::int64_t> services_;         ///< The instance IDs of one accessory.
  std::vector<std::int64_t> characteristics_;  ///< As above.
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
