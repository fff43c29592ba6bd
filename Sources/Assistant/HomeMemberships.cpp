#include "Assistant/HomeMemberships.h"

namespace nidus {
namespace {

std::size_t placesInGroups(const NDHome* home) {
  std::size_t count = 0;
  if (!home) return count;
  for (const auto& group : home->serviceGroups()) count += group->services().size();
  return count;
}

std::size_t placesInZones(const NDHome* home) {
  std::size_t count = 0;
  if (!home) return count;
  for (const auto& zone : home->zones()) count += zone->rooms().size();
  return count;
}

}  // namespace

HomeMemberships::HomeMemberships(const NDHome* home)
    : groupNames_(placesInGroups(home)), zoneNames_(placesInZones(home)) {
  if (!home) return;
  for (const auto& group : home->serviceGroups()) {
    const TextList alone = {group->name()};  // of all services that are in no other group
    for (const auto& service : group->services()) {
      TextList& names = groupNames_[service.get()];
      if (names.empty()) {
        names = alone;
      } else {
        names.append(group->name());
      }
    }
  }
  for (const auto& zone : home->zones()) {
    for (const auto& room : zone->rooms()) zoneNames_[room.get()] = zone->name();
  }
}

const TextList& HomeMemberships::groupNames(const NDService& service) const {
  return groupNames_.find(&service);
}

const NDString& HomeMemberships::zoneName(const NDRoom& room) const {
  return zoneNames_.find(&room);
}

}  // namespace nidus
