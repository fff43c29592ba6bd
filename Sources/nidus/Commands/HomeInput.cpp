#include "nidus/Commands/HomeInput.h"

#include <cstddef>
#include <iostream>

#include "AssistantHost/InputFile.h"
#include "HomePlatform/Store/HomeDocument.h"

namespace nidus {
namespace {

std::string counted(std::size_t count, const std::string& one, const std::string& many) {
  return std::to_string(count) + ' ' + (count == 1 ? one : many);
}

}  // namespace

Result<std::vector<HomeData>> readHomes(const std::string& file) {
  if (file == "-") return readHomeDocument(std::cin, "standard input");
  auto in = openInput(file);
  if (!in) return in.failure();
  return readHomeDocument(*in, file);
}

std::string sizeOf(const std::vector<HomeData>& homes) {
  std::size_t rooms = 0;
  std::size_t accessories = 0;
  std::size_t services = 0;
  for (const HomeData& home : homes) {
    rooms += home.rooms.size();
    accessories += home.accessories.size();
    for (const AccessoryData& accessory : home.accessories) services += accessory.services.size();
  }
  return counted(homes.size(), "home", "homes") + ", " + counted(rooms, "room", "rooms") + ", " +
         counted(accessories, "accessory", "accessories") + ", " +
         counted(services, "service", "services");
}

}  // namespace nidus
