#include <algorithm>
#include <string>
#include <vector>

#include "nidus/Doctor/Checks.h"
#include "nidus/Doctor/Remedy.h"

namespace nidus {
namespace {

bool contains(const ZoneData& zone, const RoomData& room) {
  return std::find(zone.rooms.begin(), zone.rooms.end(), room.uuid) != zone.rooms.end();
}

/// Looks at the zones and rooms of one home.
class RoomLook {
 public:
  RoomLook(const HomeData& home, Findings& findings) : home_(home), findings_(findings) {}

  void take() {
    for (const ZoneData& zone : home_.zones) {
      if (zone.rooms.empty()) {
        addEmpty(zone);
      } else {
        checkOverlap(zone);
      }
    }
    for (const RoomData& room : home_.rooms) checkUse(room);
  }

 private:
  void addEmpty(const ZoneData& zone) {
    const std::string words = wordsOf(zone);
    add(Severity::attention, zone.name, "the zone has no rooms: an order for it finds nothing",
        "nidus home move room ROOM --to-zone " + words + ", or nidus home remove zone " + words);
  }

  /// The zone for which a room counts in orders: the last that contains it. Null for none.
  [[nodiscard]] const ZoneData* zoneOf(const RoomData& room) const {
    const auto zone =
        std::find_if(home_.zones.rbegin(), home_.zones.rend(),
                     [&room](const ZoneData& candidate) { return contains(candidate, room); });
    return zone == home_.zones.rend() ? nullptr : &*zone;
  }

  void checkOverlap(const ZoneData& zone) {
    std::string lost;
    std::string remedy;
    for (const RoomData& room : home_.rooms) {
      const ZoneData* counts = contains(zone, room) ? zoneOf(room) : &zone;
      if (counts == &zone) continue;
      lost += (lost.empty() ? "" : ", ") + room.name.str();
      remedy += (remedy.empty() ? "" : " && ") + ("nidus home move room " + wordsOf(room)) +
                " --from-zone " + wordsOf(*counts);
    }
    if (lost.empty()) return;
    add(Severity::attention, zone.name,
        "an order for this zone does not reach " + lost +
            ": a room counts for the last of its zones alone",
        "take each out of the later zone with " + remedy);
  }

  void checkUse(const RoomData& room) {
    const bool isUsed = std::any_of(
        home_.accessories.begin(), home_.accessories.end(),
        [&room](const AccessoryData& accessory) { return accessory.room == room.uuid; });
    if (isUsed) return;
    add(Severity::note, room.name, "no accessory stands in the room",
        "nidus home move accessory ACCESSORY --to " + wordsOf(room));
  }

  void add(Severity severity, const NDString& name, std::string message, std::string remedy) {
    findings_.push_back(
        {severity, home_.name.str() + " / " + name.str(), std::move(message), std::move(remedy)});
  }

  const HomeData& home_;
  Findings& findings_;
};

}  // namespace

void checkRooms(const Examination& examination, Findings& findings) {
  for (const HomeData& home : *examination.homes) RoomLook(home, findings).take();
}

}  // namespace nidus
