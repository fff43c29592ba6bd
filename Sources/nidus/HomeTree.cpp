#include "nidus/HomeTree.h"

#include <algorithm>
#include <cstddef>
#include <utility>
#include <vector>

#include "HomePlatform/System/OneLine.h"

namespace nidus {
namespace {

struct Branch {
  std::string text;
  std::vector<Branch> below;
  Colour colour = Colour::none;
};

/// Draws branches on a terminal or in a pipe. What is longer than a line of the terminal goes on
/// under itself.
class TreeDrawing {
 public:
  explicit TreeDrawing(const TerminalStyle& style) : style_(style) {}

  void drawRoot(const std::string& text) { drawText(text, Colour::title, "", ""); }
  void draw(const std::vector<Branch>& branches, const std::string& margin = "") {
    for (const Branch& branch : branches) {
      const bool isLast = &branch == &branches.back();
      const std::string below = margin + (isLast ? "   " : "│  ");
      drawText(branch.text, branch.colour, margin + (isLast ? "└─ " : "├─ "), below + "  ");
      draw(branch.below, below);
    }
  }
  [[nodiscard]] const std::string& text() const { return text_; }

 private:
  void drawText(const std::string& text, Colour colour, std::string margin,
                const std::string& marginOfRest) {
    const std::size_t taken = cellsOf(marginOfRest);
    const std::size_t cells = style_.columns > taken ? style_.columns - taken : 0;
    for (const std::string& line : wrapped(onOneLine(text), cells)) {
      text_ += coloured(margin, Colour::faint, style_) + coloured(line, colour, style_) + '\n';
      margin = marginOfRest;
    }
  }

  const TerminalStyle& style_;
  std::string text_;
};

std::string joined(const std::vector<std::string>& parts) {
  std::string text;
  for (const std::string& part : parts) text += (text.empty() ? "" : ", ") + part;
  return text;
}

template <class Object>
std::string namesOf(const std::vector<Object>& objects) {
  std::vector<std::string> names;
  names.reserve(objects.size());
  for (const Object& object : objects) names.push_back(object.name.str());
  return joined(names);
}

Branch serviceBranch(const ServiceData& service, const HomeWords& words) {
  std::string text = (service.name ? service.name.str() : "(no name)") + " [" +
                     words.serviceTypeOf(service.serviceType);
  if (service.associatedServiceType) {
    text += " as " + words.serviceTypeOf(service.associatedServiceType);
  }
  std::vector<std::string> values;
  for (const CharacteristicData& characteristic : service.characteristics) {
    values.push_back(words.attributeOf(characteristic.characteristicType) + ' ' +
                     words.valueOf(characteristic, characteristic.value));
  }
  return {text + (values.empty() ? "]" : "] " + joined(values)), {}};
}

Branch accessoryBranch(const AccessoryData& accessory, const HomeWords& words) {
  std::vector<std::string> notes;
  if (!accessory.reachable) notes.emplace_back("unreachable");
  if (accessory.requiresUnlock) notes.emplace_back("requires an unlocked device");
  Branch branch{accessory.name.str() + (notes.empty() ? "" : " (" + joined(notes) + ')'), {}};
  if (accessory.requiresUnlock) branch.colour = Colour::warning;
  if (!accessory.reachable) branch.colour = Colour::bad;
  for (const ServiceData& service : accessory.services) {
    branch.below.push_back(serviceBranch(service, words));
  }
  return branch;
}

/// The accessories that stand in `room`, or in no room for none.
Branch roomBranch(const std::string& name, const std::optional<NDUUID>& room, const HomeData& home,
                  const HomeWords& words) {
  Branch branch{name, {}, Colour::title};
  for (const AccessoryData& accessory : home.accessories) {
    if (accessory.room == room) branch.below.push_back(accessoryBranch(accessory, words));
  }
  return branch;
}

std::string zoneText(const ZoneData& zone, const HomeData& home) {
  std::vector<std::string> rooms;
  for (const RoomData& room : home.rooms) {
    if (std::count(zone.rooms.begin(), zone.rooms.end(), room.uuid) > 0) {
      rooms.push_back(room.name.str());
    }
  }
  return zone.name.str() + ": " + (rooms.empty() ? "no rooms" : joined(rooms));
}

/// The name of the service at `address`, or that of its accessory when it has none.
std::string serviceName(const ServiceAddress& address, const HomeData& home) {
  for (const AccessoryData& accessory : home.accessories) {
    if (accessory.uuid != address.accessory) continue;
    for (const ServiceData& service : accessory.services) {
      if (service.instanceID == address.service && service.name) return service.name.str();
    }
    return accessory.name.str();
  }
  return {};
}

std::string groupText(const ServiceGroupData& group, const HomeData& home) {
  std::vector<std::string> services;
  for (const ServiceAddress& address : group.services) {
    services.push_back(serviceName(address, home));
  }
  return group.name.str() + ": " + (services.empty() ? "no services" : joined(services));
}

template <class Object>
void addList(std::vector<Branch>& branches, const std::string& title,
             const std::vector<Object>& objects,
             std::string (*describe)(const Object&, const HomeData&), const HomeData& home) {
  if (objects.empty()) return;
  Branch list{title, {}, Colour::title};
  for (const Object& object : objects) list.below.push_back({describe(object, home), {}});
  branches.push_back(std::move(list));
}

}  // namespace

std::string homeTree(const HomeData& home, const HomeWords& words, const TerminalStyle& style) {
  std::vector<Branch> branches;
  for (const RoomData& room : home.rooms) {
    branches.push_back(roomBranch(room.name.str(), room.uuid, home, words));
  }
  Branch roomless = roomBranch("in no room", std::nullopt, home, words);
  if (!roomless.below.empty()) branches.push_back(std::move(roomless));
  addList(branches, "zones", home.zones, zoneText, home);
  addList(branches, "groups", home.serviceGroups, groupText, home);
  if (!home.actionSets.empty()) branches.push_back({"scenes: " + namesOf(home.actionSets), {}});
  if (!home.triggers.empty()) branches.push_back({"triggers: " + namesOf(home.triggers), {}});
  TreeDrawing drawing(style);
  drawing.drawRoot(home.name.str() + (home.primary ? " (primary)" : ""));
  drawing.draw(branches);
  return drawing.text();
}

}  // namespace nidus
