#include "nidus/ObjectPath.h"

namespace nidus {

NDString roomNameOf(const HomeData& home, const AccessoryData& accessory) {
  for (const RoomData& room : home.rooms) {
    if (accessory.room == room.uuid) return room.name;
  }
  return nullptr;
}

std::string pathOf(const HomeData& home, const AccessoryData& accessory) {
  const NDString room = roomNameOf(home, accessory);
  return home.name.str() + " / " + (room ? room.str() + " / " : "") + accessory.name.str();
}

std::string pathOf(const HomeData& home, const AccessoryData& accessory,
                   const ServiceData& service) {
  return pathOf(home, accessory) + " / " + (service.name ? service.name.str() : "(no name)");
}

}  // namespace nidus
