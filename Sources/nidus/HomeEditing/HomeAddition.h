#pragma once

#include <string>
#include <vector>

#include "HomePlatform/Metadata/Vocabulary.h"
#include "nidus/HomeEditing/HomeObjects.h"
#include "nidus/HomeEditing/NewService.h"

namespace nidus {

/// Each adds an object with a new random UUID at the end of its list, and gives what was done:
/// "added the room Kitchen of Beach House (UUID)". A failure is bad input, and nothing has been
/// changed.

/// The name of what is added, and the name or UUID of its home. Without a home it is that of the
/// first object that is named with it, else the only one.
struct NewObject {
  std::string name;
  std::string home;
};

[[nodiscard]] Result<std::string> addHome(std::vector<HomeData>& homes, const std::string& name,
                                          bool isPrimary);
[[nodiscard]] Result<std::string> addRoom(std::vector<HomeData>& homes, const NewObject& room);
[[nodiscard]] Result<std::string> addTrigger(std::vector<HomeData>& homes,
                                             const NewObject& trigger);
/// A zone of the named rooms.
[[nodiscard]] Result<std::string> addZone(std::vector<HomeData>& homes, const NewObject& zone,
                                          const std::vector<std::string>& rooms);

/// An accessory in the named room, or in none when that is empty.
struct AccessoryPlace {
  std::string room;
  bool requiresUnlock = false;
};
[[nodiscard]] Result<std::string> addAccessory(std::vector<HomeData>& homes,
                                               const NewObject& accessory,
                                               const AccessoryPlace& place);

/// A service of the named accessory; it has no UUID, what it has is the accessory's with its
/// instance ID.
[[nodiscard]] Result<std::string> addService(std::vector<HomeData>& homes,
                                             const ObjectWords& accessory,
                                             const ServiceWords& service,
                                             const Vocabulary& vocabulary);
/// A group of the named services.
[[nodiscard]] Result<std::string> addGroup(std::vector<HomeData>& homes, const NewObject& group,
                                           const std::vector<std::string>& services);
/// A scene of settings as `readSetting` takes them.
[[nodiscard]] Result<std::string> addScene(std::vector<HomeData>& homes, const NewObject& scene,
                                           const std::vector<std::string>& settings,
                                           const Vocabulary& vocabulary, bool isMetric);

}  // namespace nidus
