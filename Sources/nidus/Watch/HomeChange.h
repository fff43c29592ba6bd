#pragma once

#include <string>
#include <vector>

#include "HomePlatform/Metadata/MetadataMapper.h"
#include "HomePlatform/Store/HomeData.h"
#include "PlatformModel/System/NDDictionary.h"

namespace nidus {

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

}  // namespace nidus
