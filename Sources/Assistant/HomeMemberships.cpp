#include "Assistant/HomeMemberships.h"

namespace nidus {

HomeMemberships::HomeMemberships(const NDHome* home) {
  if (!home) return;
  nameGroups(*home);
  for (const auto& zone : home->zones()) {
    for (const auto& room : zone->rooms()) zoneNames_[room.get()] = zone->name();
  }
}

void HomeMemberships::nameGroups(const NDHome& home) {
  for (const auto& group : home.serviceGroups()) {
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
}

TextList HomeMemberships::groupNames(const NDService& service) const {
  const auto found = groupNames_.find(&service);
  return found == groupNames_.end() ? TextList() : found->second;
}

NDString HomeMemberships::zoneName(const NDRoom& room) const {
  const auto found = zoneNames_.find(&room);
  return found == zoneNames_.end() ? NDString() : found->second;
}

}  // namespace nidus
