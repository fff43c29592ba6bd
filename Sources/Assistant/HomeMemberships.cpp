#include "Assistant/HomeMemberships.h"

namespace nidus {

HomeMemberships::HomeMemberships(const NDHome* home) {
  if (!home) return;
  for (const auto& group : home->serviceGroups()) {
    for (const auto& service : group->services()) {
      groupNames_[service.get()].push_back(group->name());
    }
  }
  for (const auto& zone : home->zones()) {
    for (const auto& room : zone->rooms()) zoneNames_[room.get()] = zone->name();
  }
}

std::vector<NDString> HomeMemberships::groupNames(const NDService& service) const {
  const auto found = groupNames_.find(&service);
  return found == groupNames_.end() ? std::vector<NDString>() : found->second;
}

NDString HomeMemberships::zoneName(const NDRoom& room) const {
  const auto found = zoneNames_.find(&room);
  return found == zoneNames_.end() ? NDString() : found->second;
}

}  // namespace nidus
