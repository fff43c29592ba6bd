#pragma once

#include <string>
#include <vector>

#include "HomePlatform/Metadata/MetadataMapper.h"
#include "HomePlatform/Store/HomeData.h"
#include "PlatformModel/System/NDDictionary.h"

namespace nidus {

/// Which objects are watched. An empty text is a field that was not given. Homes go by their very
/// name, rooms and services by theirs whatever its accents are, as in orders.
struct WatchFilter {
  std::string home;
  std::string room;
  std::string service;
};

/// One thing that differs between two states of the homes.
struct HomeChange {
  enum class Kind { changed, added, removed };
  Kind kind = Kind::changed;
  NDString home;
  NDString room;  ///< Null for none, like all that follow.
  NDString accessory;
  NDString service;
  /// Of what has changed: the assistant's name, or "name", "room" or "reachable"; empty for what
  /// was added or removed.
  std::string attribute;
  /// The value before and after in dictionary form, as in replies: {"integer": 40, "units":
  /// "PERCENTAGE"}. Empty for one that is not known.
  NDDictionary before;
  NDDictionary after;
};

/// What has changed from `before` to `after`: homes, accessories and services that came or went
/// (without a line for each of their parts), their names, rooms and reachability, and the values
/// that the platform knows, in the units of the device. Objects are the same by their UUIDs and
/// instance IDs. In the order of `after`, what was removed at the end of its list.
[[nodiscard]] std::vector<HomeChange> changesBetween(const std::vector<HomeData>& before,
                                                     const std::vector<HomeData>& after,
                                                     const MetadataMapper& metadata);

/// Whether a change concerns an object of the filter.
[[nodiscard]] bool isWatched(const HomeChange& change, const WatchFilter& filter);

/// How much there is to watch, such as "57 services of 2 homes".
[[nodiscard]] std::string extentOf(const std::vector<HomeData>& homes, const WatchFilter& filter);

}  // namespace nidus
