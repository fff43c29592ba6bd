#include <algorithm>
#include <map>
#include <string>
#include <vector>

#include "PlatformModel/System/NDTextMatching.h"
#include "nidus/Doctor/Checks.h"
#include "nidus/Doctor/Remedy.h"
#include "nidus/ObjectPath.h"

namespace nidus {
namespace {

/// Something with a name that orders use.
template <class Object>
struct Named {
  const Object* object;
  std::string place;  ///< As people see it.
  std::string words;  ///< How the command line names it without doubt.
};

template <class Object>
using NameSakes = std::vector<Named<Object>>;

/// The lists of objects that share a name, the key; each has two or more, in their order.
template <class Object, class Key>
std::vector<NameSakes<Object>> sharing(const NameSakes<Object>& all, const Key& keyOf) {
  std::map<decltype(keyOf(*all.front().object)), NameSakes<Object>> byKey;
  for (const Named<Object>& named : all) byKey[keyOf(*named.object)].push_back(named);
  std::vector<NameSakes<Object>> shared;
  for (auto& [key, list] : byKey) {
    if (list.size() > 1) shared.push_back(std::move(list));
  }
  return shared;
}

template <class Object>
NameSakes<Object> namedOf(const HomeData& home, const std::vector<Object>& objects) {
  NameSakes<Object> all;
  for (const Object& object : objects) {
    all.push_back({&object, home.name.str() + " / " + object.name.str(), wordsOf(object)});
  }
  return all;
}

/// Orders find homes and groups by the very name.
const auto kExactName = [](const auto& object) { return object.name.str(); };
/// Orders find all else whatever its accents are.
const auto kPlainName = [](const auto& object) { return withoutDiacritics(object.name.view()); };

/// "the rooms Cottage / Café and Cottage / Cafe".
template <class Object>
std::string listOf(const NameSakes<Object>& list, const std::string& kind) {
  std::string text = "the " + kind + 's';
  for (const Named<Object>& named : list) {
    text += (&named == &list.front() ? " " : " and ") + named.place;
  }
  return text;
}

template <class Object>
void add(Findings& findings, const NameSakes<Object>& list, const std::string& kind,
         const std::string& effect, Severity severity = Severity::attention) {
  findings.push_back({severity, list.front().object->name.str(),
                      listOf(list, kind) + " share their name: " + effect,
                      "nidus home rename " + kind + ' ' + list.back().words + " NEWNAME"});
}

std::vector<HomeData>::const_iterator primaryOf(const std::vector<HomeData>& homes) {
  return std::find_if(homes.begin(), homes.end(),
                      [](const HomeData& home) { return home.primary; });
}

void checkHomeNames(const std::vector<HomeData>& homes, Findings& findings) {
  NameSakes<HomeData> all;
  for (const HomeData& home : homes) {
    all.push_back({&home, home.name.str(), wordsOf(home)});
  }
  const auto primary =
      std::find_if(homes.begin(), homes.end(), [](const HomeData& home) { return home.primary; });
  for (const auto& list : sharing(all, kExactName)) {
    const bool hasPrimary = primary != homes.end() && primary->name == list.front().object->name;
    add(findings, list, "home",
        hasPrimary ? "an order that names it is for the primary one alone"
                   : "an order that names it fails, as none of them is the primary home");
  }
}

/// The rooms that an order names are looked for in all homes, and what stands in a room of the name
/// is found once for each of them.
void checkRoomNames(const std::vector<HomeData>& homes, Findings& findings) {
  NameSakes<RoomData> all;
  for (const HomeData& home : homes) {
    for (const auto& room : namedOf(home, home.rooms)) all.push_back(room);
  }
  const bool hasPrimary = primaryOf(homes) != homes.end();
  for (const auto& list : sharing(all, kPlainName)) {
    const std::string times = std::to_string(list.size()) + " times";
    add(findings, list, "room",
        "an order for it names each of its objects " + times +
            (hasPrimary ? "" : ", and without a home it is for all of these rooms"));
  }
}

void checkRoomsNamedLikeHome(const HomeData& home, Findings& findings) {
  for (const AccessoryData& accessory : home.accessories) {
    const auto room = std::find_if(
        home.rooms.begin(), home.rooms.end(), [&home, &accessory](const RoomData& candidate) {
          return accessory.room == candidate.uuid && candidate.name == home.name;
        });
    if (room == home.rooms.end()) continue;
    findings.push_back({Severity::attention, home.name.str() + " / " + room->name.str(),
                        "the room is named like its home: for orders, what is in it is in no room",
                        "nidus home rename room " + wordsOf(*room) + " NEWNAME"});
    return;
  }
}

struct ServicePlace {
  NDString name;
  NDString room;
  const ServiceData* service;
};

bool shareAttribute(const ServiceData& a, const ServiceData& b) {
  for (const CharacteristicData& one : a.characteristics) {
    for (const CharacteristicData& other : b.characteristics) {
      if (one.characteristicType == other.characteristicType) return true;
    }
  }
  return false;
}

NameSakes<ServicePlace> servicesOf(const HomeData& home, std::vector<ServicePlace>& places) {
  std::vector<std::pair<std::string, std::string>> texts;
  for (const AccessoryData& accessory : home.accessories) {
    for (const ServiceData& service : accessory.services) {
      if (!service.name) continue;
      places.push_back({service.name, roomNameOf(home, accessory), &service});
      texts.emplace_back(pathOf(home, accessory, service), accessory.uuid.UUIDString().str() + '/' +
                                                               std::to_string(service.instanceID));
    }
  }
  NameSakes<ServicePlace> all;
  for (std::size_t i = 0; i < places.size(); ++i) {
    all.push_back({&places[i], texts[i].first, texts[i].second});
  }
  return all;
}

/// Services of one name get in each other's way where one order can mean several of them.
void checkServiceNames(const HomeData& home, Findings& findings) {
  std::vector<ServicePlace> places;
  for (const auto& list : sharing(servicesOf(home, places), kPlainName)) {
    const ServicePlace& first = *list.front().object;
    const bool areAlike = std::all_of(list.begin() + 1, list.end(), [&first](const auto& named) {
      return shareAttribute(*first.service, *named.object->service);
    });
    if (!areAlike) continue;
    const bool isOneRoom = std::all_of(list.begin(), list.end(), [&first](const auto& named) {
      return named.object->room == first.room;
    });
    add(findings, list, "service",
        isOneRoom ? "an order for one is for all of them"
                  : "an order that names no room is for all of them",
        isOneRoom ? Severity::attention : Severity::note);
  }
}

}  // namespace

void checkNames(const Examination& examination, Findings& findings) {
  const std::vector<HomeData>& homes = *examination.homes;
  checkHomeNames(homes, findings);
  checkRoomNames(homes, findings);
  for (const HomeData& home : homes) {
    checkRoomsNamedLikeHome(home, findings);
    for (const auto& list : sharing(namedOf(home, home.zones), kPlainName)) {
      add(findings, list, "zone", "an order for one is for the rooms of all of them");
    }
    for (const auto& list : sharing(namedOf(home, home.serviceGroups), kExactName)) {
      add(findings, list, "group", "an order for one is for the services of all of them");
    }
    checkServiceNames(home, findings);
    for (const auto& list : sharing(namedOf(home, home.actionSets), kPlainName)) {
      add(findings, list, "scene", "only the first of them can be run by its name");
    }
  }
}

}  // namespace nidus
