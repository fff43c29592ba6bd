#include "nidus/HomeEditing/HomeMoving.h"

#include <algorithm>

namespace nidus {
namespace {

/// Moves `member` between the lists that objects of `kind` have of such members. `listOf` gives the
/// list of the object at a place.
template <class Member, class ListOf>
Result<std::string> moveBetween(std::vector<HomeData>& homes, const std::string& description,
                                std::size_t home, ObjectKind kind, const ListChange& change,
                                const Member& member, const ListOf& listOf) {
  std::string done;
  if (!change.from.empty()) {
    const auto from = findObjectIn(homes, home, {kind, change.from, ""});
    if (!from) return from.failure();
    const std::string name = wordOf(kind) + ' ' + nameAt(homes, kind, *from).str();
    if (std::erase(listOf(*from), member) == 0) {
      return badInput(description + " is not in the " + name + "; nidus home show tells where");
    }
    done = " out of the " + name;
  }
  if (!change.to.empty()) {
    const auto to = findObjectIn(homes, home, {kind, change.to, ""});
    if (!to) return to.failure();
    auto& list = listOf(*to);
    const std::string name = wordOf(kind) + ' ' + nameAt(homes, kind, *to).str();
    if (std::count(list.begin(), list.end(), member) > 0) {
      return badInput(description + " is in the " + name + " already; there is nothing to move");
    }
    list.push_back(member);
    done += " into the " + name;
  }
  return "moved " + description + done;
}

Status checkGiven(const ListChange& change, ObjectKind kind) {
  if (!change.from.empty() || !change.to.empty()) return std::nullopt;
  const std::string word = wordOf(kind);
  return badInput("it is not said where to; give --to-" + word + ", --from-" + word + " or both");
}

}  // namespace

Result<std::string> moveAccessory(std::vector<HomeData>& homes, const ObjectWords& accessory,
                                  const std::string& room) {
  const auto place = findObject(homes, accessory);
  if (!place) return place.failure();
  HomeData& home = homes[place->home];
  const std::string description = describe(homes, ObjectKind::accessory, *place);
  if (room.empty()) {
    home.accessories[place->index].room.reset();
    return "moved " + description + " into no room";
  }
  const auto target = findObjectIn(homes, place->home, {ObjectKind::room, room, ""});
  if (!target) return target.failure();
  home.accessories[place->index].room = home.rooms[target->index].uuid;
  return "moved " + description + " into the room " + home.rooms[target->index].name.str();
}

Result<std::string> moveRoom(std::vector<HomeData>& homes, const ObjectWords& room,
                             const ListChange& zones) {
  if (auto failure = checkGiven(zones, ObjectKind::zone)) return *failure;
  const auto place = findObject(homes, room);
  if (!place) return place.failure();
  HomeData& home = homes[place->home];
  return moveBetween(
      homes, describe(homes, ObjectKind::room, *place), place->home, ObjectKind::zone, zones,
      home.rooms[place->index].uuid, [&home](const ObjectPlace& zone) -> auto& {
        return home.zones[zone.index].rooms;
      });
}

Result<std::string> moveService(std::vector<HomeData>& homes, const ObjectWords& service,
                                const ListChange& groups) {
  if (auto failure = checkGiven(groups, ObjectKind::group)) return *failure;
  const auto place = findObject(homes, service);
  if (!place) return place.failure();
  HomeData& home = homes[place->home];
  const AccessoryData& accessory = home.accessories[place->index];
  const ServiceAddress address{accessory.uuid, accessory.services[place->service].instanceID};
  return moveBetween(
      homes, describe(homes, ObjectKind::service, *place), place->home, ObjectKind::group, groups,
      address, [&home](const ObjectPlace& group) -> auto& {
        return home.serviceGroups[group.index].services;
      });
}

}  // namespace nidus
