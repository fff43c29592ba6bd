#pragma once

#include "Assistant/AddressTable.h"
#include "Assistant/TextList.h"
#include "PlatformModel/Home/NDHome.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

/// What belongs to what in one home, turned around once: the groups that hold a service and the
/// zone that contains a room. It spares a snapshot the walk through all groups for each service.
/// The home must outlive it; not synchronised.
class HomeMemberships {
 public:
  /// `home` may be null and then has nothing in it.
  explicit HomeMemberships(const NDHome* home);

  /// The names of the groups that hold `service`, in the order of the home's groups, once per time
  /// that a group lists it; may be empty.
  [[nodiscard]] const TextList& groupNames(const NDService& service) const;

  /// The name of the last of the home's zones that contains `room`; null when none does.
  [[nodiscard]] const NDString& zoneName(const NDRoom& room) const;

 private:
  AddressTable<TextList> groupNames_;
  AddressTable<NDString> zoneNames_;
};

}  // namespace nidus
