#include "nidus/HomeTree.h"

#include <algorithm>
#include <cstddef>
#include <utility>
#include <vector>

#include "nidus/StandardStreams.h"

namespace nidus {
namespace {

struct Branch {
  std::string text;
  std::vector<Branch> below;
};

void draw(const std::vector<Branch>& branches, const std::string& margin, std::string& out) {
  for (const Branch& branch : branches) {
    const bool isLast = &branch == &branches.back();
    out += margin + (isLast ? "└─ " : "├─ ") + onOneLine(branch.text) + '\n';
    draw(branch.below, margin + (isLast ? "   " : "│  "), out);
  }
}

std::string joined(const std::vector<std::string>& parts) {
  std::string text;
  for (const std::string& part : parts) text += (text.empty() ? "" : ", ") + part;
  return text;
}

template <class Object>
std::string namesOf(const std::vector<Object>& objects) {
  std::vector<std::string> names;
  names.reserve(objects.size());
  for (const Object& object : objects) names.push_back(object.name.str());
  return joined(names);
}

Branch serviceBranch(const ServiceData& service, const HomeWords& words) {
  std::string text = (service.name ? service.name.str() : "(no name)") + " [" +
                     words.serviceTypeOf(service.serviceType);
  if (service.associatedServiceType) {
    text += " as " + words.serviceTypeOf(service.associatedServiceType);
  }
  std::vector<std::string> values;
  for (const CharacteristicData& characteristic : service.characteristics) {
    values.push_back(words.attributeOf(characteristic.characteristicType) + ' ' +
                     words.valueOf(characteristic, characteristic.value));
  }
  return {text + (values.empty() ? "]" : "] " + joined(values)), {}};
}

Branch accessoryBranch(const AccessoryData& accessory, const HomeWords& words) {
  std::vector<std::string> notes;
  if (!accessory.reachable) notes.emplace_back("unreachable");
  if (accessory.requiresUnlock) notes.emplace_back("requires an unlocked device");
  Branch branch{accessory.name.str() + (notes.empty() ? "" : " (" + joined(notes) + ')'), {}};
  for (const ServiceData& service : accessory.services) {
    branch.below.push_back(serviceBranch(service, words));
  }
  return branch;
}

/// The accessories that stand in `room`, or in no room for none.
Branch roomBranch(const std::string& name, const std::optional<NDUUID>& room, const HomeData& home,
                  const HomeWords& words) {
  Branch branch{name, {}};
  for (const AccessoryData& accessory : home.accessories) {
    if (accessory.room == room) branch.below.push_back(accessoryBranch(accessory, words));
  }
  return branch;
}

std::string zoneText(const ZoneData& zone, const HomeData& home) {
  std::vector<std::string> rooms;
  for (const RoomData& room : home.rooms) {
    if (std::count(zone.rooms.begin(), zone.rooms.end(), room.uuid) > 0) {
      rooms.push_back(room.name.str());
    }
  }
  return zone.name.str() + ": " + (rooms.empty() ? "no rooms" : joined(rooms));
}

/// The name of the service at `address`, or that of its accessory when it has none.
std::string serviceName(const ServiceAddress& address, const HomeData& home) {
  for (const AccessoryData& accessory : home.accessories) {
    if (accessory.uuid != address.accessory) continue;
    for (const ServiceData& service : accessory.services) {
      if (service.instanceID == address.service && service.name) return service.name.str();
    }
    return accessory.name.str();
  }
  return {};
}

std::string groupText(const ServiceGroupData& group, const HomeData& home) {
  std::vector<std::string> services;
  for (const ServiceAddress& address : group.services) {
    services.push_back(serviceName(address, home));
  }
  return group.name.str() + ": " + (services.empty() ? "no services" : joined(services));
}

template <class Object>
void addList(std::vector<Branch>& branches, const std::string& title,
             const std::vector<Object>& objects,
             std::string (*describe)(const Object&, const HomeData&), const HomeData& home) {
  if (objects.empty()) return;
  Branch list{title, {}};
  for (const Object& object : objects) list.below.push_back({describe(object, home), {}});
  branches.push_back(std::move(list));
}

}  // namespace

std::string homeTree(const HomeData& home, const HomeWords& words) {
  std::vector<Branch> branches;
  for (const RoomData& room : home.rooms) {
    branches.push_back(roomBranch(room.name.str(), room.uuid, home, words));
  }
  Branch roomless = roomBranch("in no room", std::nullopt, home, words);
  if (!roomless.below.empty()) branches.push_back(std::move(roomless));
  addList(branches, "zones", home.zones, zoneText, home);
  addList(branches, "groups", home.serviceGroups, groupText, home);
  if (!home.actionSets.empty()) branches.push_back({"scenes: " + namesOf(home.actionSets), {}});
  if (!home.triggers.empty()) branches.push_back({"triggers: " + namesOf(home.triggers), {}});
  std::string text = onOneLine(home.name.view()) + (home.primary ? " (primary)" : "") + '\n';
  draw(branches, "", text);
  return text;
}

}  // namespace nidus
