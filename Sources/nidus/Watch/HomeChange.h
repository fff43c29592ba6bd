#pragma once

#include <string>
#include <vector>

#include "HomePlatform/Metadata/MetadataMapper.h"
#include "HomePlatform/Result.h"
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

/// The names on the way to an object.
struct ChangePlace {
  NDString home;
  NDString room;  ///< Null for none, like all that follow.
  NDString accessory;
  NDString service;
};

/// One thing that differs between two states of the homes.
struct HomeChange {
  enum class Kind { changed, added, removed };
  Kind kind = Kind::changed;
  ChangePlace place;    ///< Where the object is; where it was, when it has been removed.
  ChangePlace earlier;  ///< Where it was; where it is, when it has been added.
  /// Of what has changed: the assistant's name, or "name", "room" or "reachable"; empty for what
  /// was added or removed.
  std::string attribute;
  /// The value before and after in dictionary form, as in replies: {"integer": 40, "units":
  /// "PERCENTAGE"}. Empty for one that is not known.
  NDDictionary before;
  NDDictionary after;
};

/// What has changed from `before` to `after`: homes, rooms, accessories and services that came or
/// went (without a line for each of their parts), their names, where accessories stand and whether
/// they can be reached, and the values that the platform knows, in the units of the device. Objects
/// are the same by their UUIDs and instance IDs. In the order of `after`, what was removed at the
/// end of its list.
[[nodiscard]] std::vector<HomeChange> changesBetween(const std::vector<HomeData>& before,
                                                     const std::vector<HomeData>& after,
                                                     const MetadataMapper& metadata);

/// Whether a change concerns an object of the filter: one that fits it now or did before.
[[nodiscard]] bool isWatched(const HomeChange& change, const WatchFilter& filter);

/// Refuses a filter with a name that nothing has among `homes`; says what was perhaps meant.
[[nodiscard]] Status checkFilter(const std::vector<HomeData>& homes, const WatchFilter& filter);

/// What there is to watch, such as "57 services of 2 homes"; without homes how one comes about.
[[nodiscard]] std::string extentOf(const std::vector<HomeData>& homes, const WatchFilter& filter);

}  // namespace nidus
