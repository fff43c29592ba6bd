#include "nidus/HomeEditing/HomeRemoval.h"

#include <cstddef>

namespace nidus {
namespace {

/// What else a removal touches, clause by clause.
class Consequences {
 public:
  /// Adds a clause, unless nothing is touched by it.
  void add(std::size_t count, const std::string& before, const std::string& what,
           const std::string& after = "") {
    if (count > 0) clauses_.push_back(before + what + after);
  }

  [[nodiscard]] std::string text() const {
    std::string text;
    for (const std::string& clause : clauses_) {
      const bool isLast = &clause == &clauses_.back();
      text += (isLast && clauses_.size() > 1 ? " and " : ", ") + clause;
    }
    return text;
  }

 private:
  std::vector<std::string> clauses_;
};

template <class Object>
void eraseAt(std::vector<Object>& list, std::size_t index) {
  list.erase(list.begin() + static_cast<std::ptrdiff_t>(index));
}

Consequences removeHome(std::vector<HomeData>& homes, const ObjectPlace& place) {
  const HomeData& home = homes[place.home];
  Consequences consequences;
  consequences.add(home.rooms.size(), "with its ", counted(home.rooms.size(), ObjectKind::room));
  consequences.add(home.accessories.size(), "with its ",
                   counted(home.accessories.size(), ObjectKind::accessory));
  eraseAt(homes, place.home);
  return consequences;
}

Consequences removeRoom(HomeData& home, std::size_t index) {
  const NDUUID uuid = home.rooms[index].uuid;
  std::size_t accessories = 0;
  std::size_t zones = 0;
  for (AccessoryData& accessory : home.accessories) {
    if (accessory.room != uuid) continue;
    accessory.room.reset();
    ++accessories;
  }
  for (ZoneData& zone : home.zones) zones += std::erase(zone.rooms, uuid) > 0 ? 1 : 0;
  eraseAt(home.rooms, index);
  Consequences consequences;
  consequences.add(accessories, "putting its ", counted(accessories, ObjectKind::accessory),
                   " into no room");
  consequences.add(zones, "taking it out of ", counted(zones, ObjectKind::zone));
  return consequences;
}

/// Takes all services for which `isGone` holds out of groups and scenes.
template <class IsGone>
void forgetServices(HomeData& home, const IsGone& isGone, Consequences& consequences) {
  std::size_t groups = 0;
  std::size_t actions = 0;
  for (ServiceGroupData& group : home.serviceGroups) {
    groups += std::erase_if(group.services, isGone) > 0 ? 1 : 0;
  }
  for (ActionSetData& scene : home.actionSets) {
    actions += std::erase_if(scene.actions, [&isGone](const SceneActionData& action) {
      return isGone(ServiceAddress{action.target.accessory, action.target.service});
    });
  }
  consequences.add(groups, "taking it out of ", counted(groups, ObjectKind::group));
  consequences.add(actions, "dropping ",
                   std::to_string(actions) + (actions == 1 ? " action" : " actions"), " of scenes");
}

Consequences removeAccessory(HomeData& home, std::size_t index) {
  const NDUUID uuid = home.accessories[index].uuid;
  const std::size_t services = home.accessories[index].services.size();
  Consequences consequences;
  consequences.add(services, "with its ", counted(services, ObjectKind::service));
  forgetServices(
      home, [&uuid](const ServiceAddress& service) { return service.accessory == uuid; },
      consequences);
  eraseAt(home.accessories, index);
  return consequences;
}

Consequences removeService(HomeData& home, const ObjectPlace& place) {
  AccessoryData& accessory = home.accessories[place.index];
  const ServiceAddress gone{accessory.uuid, accessory.services[place.service].instanceID};
  Consequences consequences;
  forgetServices(
      home, [&gone](const ServiceAddress& service) { return service == gone; }, consequences);
  eraseAt(accessory.services, place.service);
  return consequences;
}

Consequences removeAt(std::vector<HomeData>& homes, ObjectKind kind, const ObjectPlace& place) {
  HomeData& home = homes[place.home];
  switch (kind) {
    case ObjectKind::home:
      return removeHome(homes, place);
    case ObjectKind::room:
      return removeRoom(home, place.index);
    case ObjectKind::accessory:
      return removeAccessory(home, place.index);
    case ObjectKind::service:
      return removeService(home, place);
    case ObjectKind::zone:
      eraseAt(home.zones, place.index);
      break;
    case ObjectKind::group:
      eraseAt(home.serviceGroups, place.index);
      break;
    case ObjectKind::scene:
      eraseAt(home.actionSets, place.index);
      break;
    case ObjectKind::trigger:
      eraseAt(home.triggers, place.index);
      break;
  }
  return {};
}

}  // namespace

Result<std::string> removeObject(std::vector<HomeData>& homes, const ObjectWords& words) {
  const auto place = findObject(homes, words);
  if (!place) return place.failure();
  const std::string description = describe(homes, words.kind, *place);
  return description + removeAt(homes, words.kind, *place).text();
}

}  // namespace nidus
