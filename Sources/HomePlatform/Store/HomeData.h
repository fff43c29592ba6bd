#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDUUID.h"
#include "PlatformModel/System/NDValue.h"

namespace nidus {

/// The homes as plain data: what a home document says and what the database keeps. The order of
/// every list is the order that the platform keeps.

/// Error codes that are answered on purpose; 0 means none.
struct FaultData {
  std::int32_t read = 0;
  std::int32_t write = 0;
  friend bool operator==(const FaultData&, const FaultData&) = default;
};

struct MetadataData {
  NDString format;  ///< May be null, like all that follow.
  NDString units;
  NDValueRef minimumValue;  ///< Converted to `format`.
  NDValueRef maximumValue;
  NDValueRef stepValue;
};

struct CharacteristicData {
  std::int64_t instanceID = 0;
  NDString characteristicType;
  std::vector<NDString> properties;
  NDValueRef value;        ///< The cached value, converted to the format; may be null.
  NDValueRef deviceValue;  ///< What the accessory would answer now; may be null.
  std::optional<MetadataData> metadata;
  FaultData faults;
};

struct ServiceData {
  std::int64_t instanceID = 0;
  NDString name;  ///< May be null.
  NDString serviceType;
  NDString associatedServiceType;  ///< May be null.
  std::vector<CharacteristicData> characteristics;
};

struct AccessoryData {
  NDUUID uuid;
  NDString name;
  std::optional<NDUUID> room;  ///< None: the home's default room.
  bool reachable = true;
  bool requiresUnlock = false;
  std::vector<ServiceData> services;
  FaultData faults;
};

struct RoomData {
  NDUUID uuid;
  NDString name;
};

struct ZoneData {
  NDUUID uuid;
  NDString name;
  std::vector<NDUUID> rooms;
};

struct ServiceAddress {
  NDUUID accessory;
  std::int64_t service = 0;
  // NOLINTNEXTLINE(modernize-use-nullptr): a mistake of the check about defaulted comparisons
  friend auto operator<=>(const ServiceAddress&, const ServiceAddress&) = default;
};

struct ServiceGroupData {
  NDUUID uuid;
  NDString name;
  std::vector<ServiceAddress> services;
};

/// Where a characteristic is within its home.
struct CharacteristicAddress {
  NDUUID accessory;
  std::int64_t service = 0;
  std::int64_t characteristic = 0;
  // NOLINTNEXTLINE(modernize-use-nullptr): as above
  friend auto operator<=>(const CharacteristicAddress&, const CharacteristicAddress&) = default;
};

struct SceneActionData {
  CharacteristicAddress target;
  NDValueRef value;  ///< As given, never null.
};

struct ActionSetData {
  NDUUID uuid;
  NDString name;
  std::vector<SceneActionData> actions;
  std::int32_t executeFault = 0;
};

struct TriggerData {
  NDUUID uuid;
  NDString name;
};

struct HomeData {
  NDUUID uuid;
  NDString name;
  bool primary = false;
  std::vector<RoomData> rooms;
  std::vector<ZoneData> zones;
  std::vector<AccessoryData> accessories;
  std::vector<ServiceGroupData> serviceGroups;
  std::vector<ActionSetData> actionSets;
  std::vector<TriggerData> triggers;
  FaultData faults;
};

}  // namespace nidus
