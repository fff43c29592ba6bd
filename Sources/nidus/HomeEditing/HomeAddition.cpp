#include "nidus/HomeEditing/HomeAddition.h"

#include <algorithm>
#include <utility>

#include "nidus/HomeEditing/SceneAction.h"

namespace nidus {
namespace {

std::string sayAdded(const std::vector<HomeData>& homes, ObjectKind kind,
                     const ObjectPlace& place) {
  return "added " + describe(homes, kind, place) + " (" + identityAt(homes, kind, place) + ')';
}

/// Gives an object its name and a UUID and puts it at the end of a list of the home at `home`.
template <class Data>
std::string append(std::vector<HomeData>& homes, std::size_t home, ObjectKind kind,
                   std::vector<Data> HomeData::*list, const std::string& name, Data data) {
  data.uuid = NDUUID::random();
  data.name = name;
  auto& objects = homes[home].*list;
  objects.push_back(std::move(data));
  return sayAdded(homes, kind, {home, objects.size() - 1, 0});
}

/// The home of what is added with the objects of `kind` that `names` name.
Result<std::size_t> homeOf(const std::vector<HomeData>& homes, const NewObject& object,
                           ObjectKind kind, const std::vector<std::string>& names) {
  if (auto failure = checkName(object.name)) return *failure;
  if (!object.home.empty() || names.empty()) return findHome(homes, object.home);
  const auto first = findObject(homes, {kind, names.front(), ""});
  return first ? Result<std::size_t>(first->home) : Result<std::size_t>(first.failure());
}

template <class Data>
Result<std::string> addNamed(std::vector<HomeData>& homes, const NewObject& object, ObjectKind kind,
                             std::vector<Data> HomeData::*list) {
  const auto home = homeOf(homes, object, kind, {});
  if (!home) return home.failure();
  return append(homes, *home, kind, list, object.name, Data());
}

template <class Member>
void addOnce(std::vector<Member>& list, const Member& member) {
  if (std::find(list.begin(), list.end(), member) == list.end()) list.push_back(member);
}

ServiceAddress addressAt(const HomeData& home, const ObjectPlace& place) {
  const AccessoryData& accessory = home.accessories[place.index];
  return {accessory.uuid, accessory.services[place.service].instanceID};
}

}  // namespace

Result<std::string> addHome(std::vector<HomeData>& homes, const std::string& name, bool isPrimary) {
  if (auto failure = checkName(name)) return *failure;
  HomeData home;
  home.uuid = NDUUID::random();
  home.name = name;
  home.primary = isPrimary;
  homes.push_back(std::move(home));
  return sayAdded(homes, ObjectKind::home, {homes.size() - 1, 0, 0});
}

Result<std::string> addRoom(std::vector<HomeData>& homes, const NewObject& room) {
  return addNamed(homes, room, ObjectKind::room, &HomeData::rooms);
}

Result<std::string> addTrigger(std::vector<HomeData>& homes, const NewObject& trigger) {
  return addNamed(homes, trigger, ObjectKind::trigger, &HomeData::triggers);
}

Result<std::string> addZone(std::vector<HomeData>& homes, const NewObject& zone,
                            const std::vector<std::string>& rooms) {
  const auto home = homeOf(homes, zone, ObjectKind::room, rooms);
  if (!home) return home.failure();
  ZoneData data;
  for (const std::string& name : rooms) {
    const auto room = findObjectIn(homes, *home, {ObjectKind::room, name, ""});
    if (!room) return room.failure();
    addOnce(data.rooms, homes[*home].rooms[room->index].uuid);
  }
  return append(homes, *home, ObjectKind::zone, &HomeData::zones, zone.name, std::move(data));
}

Result<std::string> addAccessory(std::vector<HomeData>& homes, const NewObject& accessory,
                                 const AccessoryPlace& place) {
  const bool hasRoom = !place.room.empty();
  const auto home = homeOf(homes, accessory, ObjectKind::room,
                           hasRoom ? std::vector{place.room} : std::vector<std::string>());
  if (!home) return home.failure();
  AccessoryData data;
  data.requiresUnlock = place.requiresUnlock;
  if (hasRoom) {
    const auto room = findObjectIn(homes, *home, {ObjectKind::room, place.room, ""});
    if (!room) return room.failure();
    data.room = homes[*home].rooms[room->index].uuid;
  }
  return append(homes, *home, ObjectKind::accessory, &HomeData::accessories, accessory.name,
                std::move(data));
}

Result<std::string> addService(std::vector<HomeData>& homes, const ObjectWords& accessory,
                               const ServiceWords& service, const Vocabulary& vocabulary) {
  if (auto failure = checkName(service.name)) return *failure;
  auto place = findObject(homes, accessory);
  if (!place) return place.failure();
  AccessoryData& owner = homes[place->home].accessories[place->index];
  auto made = makeService(service, owner, vocabulary);
  if (!made) return made.failure();
  place->service = owner.services.size();
  owner.services.push_back(std::move(*made));
  return sayAdded(homes, ObjectKind::service, *place);
}

Result<std::string> addGroup(std::vector<HomeData>& homes, const NewObject& group,
                             const std::vector<std::string>& services) {
  const auto home = homeOf(homes, group, ObjectKind::service, services);
  if (!home) return home.failure();
  ServiceGroupData data;
  for (const std::string& name : services) {
    const auto service = findObjectIn(homes, *home, {ObjectKind::service, name, ""});
    if (!service) return service.failure();
    addOnce(data.services, addressAt(homes[*home], *service));
  }
  return append(homes, *home, ObjectKind::group, &HomeData::serviceGroups, group.name,
                std::move(data));
}

Result<std::string> addScene(std::vector<HomeData>& homes, const NewObject& scene,
                             const std::vector<std::string>& settings, const Vocabulary& vocabulary,
                             bool isMetric) {
  std::vector<SettingWords> words;
  std::vector<std::string> services;
  for (const std::string& setting : settings) {
    auto read = readSetting(setting, vocabulary);
    if (!read) return read.failure();
    services.push_back(read->service);
    words.push_back(std::move(*read));
  }
  const auto home = homeOf(homes, scene, ObjectKind::service, services);
  if (!home) return home.failure();
  ActionSetData data;
  for (const SettingWords& setting : words) {
    const auto service = findObjectIn(homes, *home, {ObjectKind::service, setting.service, ""});
    if (!service) return service.failure();
    auto action = sceneAction(homes, *service, setting, vocabulary, isMetric);
    if (!action) return action.failure();
    data.actions.push_back(std::move(*action));
  }
  return append(homes, *home, ObjectKind::scene, &HomeData::actionSets, scene.name,
                std::move(data));
}

}  // namespace nidus
