#pragma once

#include <string>
#include <vector>

#include "nidus/HomeEditing/HomeObjects.h"

namespace nidus {

/// Each gives what was done in one sentence without its end; a failure is bad input, and nothing
/// has been changed. `home` names the home of all that is named, or is empty.

/// Puts an accessory into a room of its home, or with an empty `room` into none.
[[nodiscard]] Result<std::string> moveAccessory(std::vector<HomeData>& homes,
                                                const ObjectWords& accessory,
                                                const std::string& room);

/// Which list an object leaves and which it joins; at least one is given.
struct ListChange {
  std::string from;  ///< A name or UUID; empty for none.
  std::string to;    ///< As above.
};

/// Takes a room out of a zone of its home, puts it into one, or both.
[[nodiscard]] Result<std::string> moveRoom(std::vector<HomeData>& homes, const ObjectWords& room,
                                           const ListChange& zones);

/// Takes a service out of a group of its home, puts it into one, or both.
[[nodiscard]] Result<std::string> moveService(std::vector<HomeData>& homes,
                                              const ObjectWords& service, const ListChange& groups);

}  // namespace nidus
