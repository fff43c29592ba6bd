#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "Assistant/TextList.h"
#include "PlatformModel/System/NDDictionary.h"
#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDURL.h"

namespace nidus {

/// The keys of a home object record.
inline constexpr std::string_view kObjectTypeKey = "objectType";
inline constexpr std::string_view kObjectNameKey = "objectName";
inline constexpr std::string_view kObjectIdentifierKey = "objectIdentifier";
inline constexpr std::string_view kObjectHomeKey = "objectHome";
inline constexpr std::string_view kObjectRoomKey = "objectRoom";
inline constexpr std::string_view kObjectZoneKey = "objectZone";
inline constexpr std::string_view kObjectGroupsKey = "objectGroups";
inline constexpr std::string_view kObjectServiceTypeKey = "objectServiceType";
inline constexpr std::string_view kObjectAssociatedServiceTypeKey = "objectAssociatedServiceType";
inline constexpr std::string_view kObjectCharacteristicsKey = "objectCharacteristics";

/// One object of the home, flattened: a map with a fixed set of keys. A field that is null, or an
/// empty list, is a key that is absent. A plain value; nobody changes a record of a snapshot.
struct HomeObjectRecord {
  NDString objectType;                   ///< Entity type; always there.
  NDString objectName;                   ///< Absent for a service without a name.
  NDURL objectIdentifier;                ///< Always there.
  NDString objectHome;                   ///< Absent for a home alone.
  NDString objectRoom;                   ///< Services alone.
  NDString objectZone;                   ///< Rooms alone.
  TextList objectGroups;                 ///< Services alone; absent when empty.
  NDString objectServiceType;            ///< Services alone.
  NDString objectAssociatedServiceType;  ///< Services alone.
  TextList objectCharacteristics;        ///< Services alone; never empty there.

  /// The record read by key, in the order above; absent keys are left out.
  [[nodiscard]] NDDictionary dictionary() const;
};

/// A home snapshot, and any part of one: ordered, duplicates kept.
using HomeObjectRecords = std::vector<HomeObjectRecord>;

/// A record, or a list of records, on one line for log messages.
[[nodiscard]] std::string description(const HomeObjectRecord& record);
[[nodiscard]] std::string description(const HomeObjectRecords& records);

}  // namespace nidus
