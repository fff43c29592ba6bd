#include "nidus/Watch/WatchFilter.h"

#include <algorithm>
#include <cstddef>
#include <set>
#include <string_view>

#include "PlatformModel/System/NDTextMatching.h"
#include "nidus/HomeEditing/HomeObjects.h"
#include "nidus/ObjectPath.h"

namespace nidus {
namespace {

bool fits(const std::string& wanted, const NDString& name) {
  return wanted.empty() || (name && isEqualIgnoringDiacritics(wanted, name.view()));
}

bool isHomeOf(const WatchFilter& filter, const NDString& home) {
  return filter.home.empty() || home == std::string_view(filter.home);
}

bool isIn(const ChangePlace& place, const WatchFilter& filter) {
  return isHomeOf(filter, place.home) && fits(filter.room, place.room) &&
         fits(filter.service, place.service);
}

/// Calls `visit` with each service of the filter and its home.
template <class Visit>
void forEachWatched(const std::vector<HomeData>& homes, const WatchFilter& filter,
                    const Visit& visit) {
  forEachService(
      homes, [&](const HomeData& home, const AccessoryData& accessory, const ServiceData& service) {
        const NDString room = roomNameOf(home, accessory);
        if (isIn({home.name, room, accessory.name, service.name}, filter)) visit(home, service);
      });
}

std::vector<std::string> namesOf(const std::vector<HomeData>& homes) {
  std::vector<std::string> names;
  names.reserve(homes.size());
  for (const HomeData& home : homes) names.push_back(home.name.str());
  return names;
}

std::vector<std::string> roomNamesOf(const std::vector<HomeData>& homes,
                                     const WatchFilter& filter) {
  std::vector<std::string> names;
  for (const HomeData& home : homes) {
    if (!isHomeOf(filter, home.name)) continue;
    for (const RoomData& room : home.rooms) names.push_back(room.name.str());
  }
  return names;
}

std::vector<std::string> serviceNamesOf(const std::vector<HomeData>& homes,
                                        const WatchFilter& filter) {
  std::vector<std::string> names;
  forEachWatched(homes, {filter.home, filter.room, ""},
                 [&names](const HomeData& /*home*/, const ServiceData& service) {
                   if (service.name) names.push_back(service.name.str());
                 });
  return names;
}

}  // namespace

bool isWatched(const HomeChange& change, const WatchFilter& filter) {
  return isIn(change.place, filter) || isIn(change.earlier, filter);
}

Status checkFilter(const std::vector<HomeData>& homes, const WatchFilter& filter) {
  const auto homeNames = namesOf(homes);
  const auto isHome = [&filter](const std::string& name) { return isHomeOf(filter, name); };
  if (!filter.home.empty() && std::none_of(homeNames.begin(), homeNames.end(), isHome)) {
    return absenceOf(ObjectKind::home, filter.home, homeNames);
  }
  const auto isMissing = [](const std::string& wanted, const std::vector<std::string>& names) {
    return !wanted.empty() &&
           std::none_of(names.begin(), names.end(),
                        [&wanted](const std::string& name) { return fits(wanted, name); });
  };
  const auto rooms = roomNamesOf(homes, filter);
  if (isMissing(filter.room, rooms)) return absenceOf(ObjectKind::room, filter.room, rooms);
  const auto services = serviceNamesOf(homes, filter);
  if (!isMissing(filter.service, services)) return std::nullopt;
  return absenceOf(ObjectKind::service, filter.service, services);
}

std::string extentOf(const std::vector<HomeData>& homes, const WatchFilter& filter) {
  if (homes.empty()) {
    return "for the first home, which nidus home add home NAME or nidus home import FILE adds";
  }
  std::size_t services = 0;
  std::set<NDUUID> homesOfServices;
  forEachWatched(homes, filter, [&](const HomeData& home, const ServiceData& /*service*/) {
    ++services;
    homesOfServices.insert(home.uuid);
  });
  return counted(services, ObjectKind::service) + " of " +
         counted(homesOfServices.size(), ObjectKind::home);
}

}  // namespace nidus
