#include "Load/LoadCommand.h"

#include <array>
#include <utility>

#include "Load/LoadHome.h"
#include "PlatformModel/Assistant/VAHAConstants.h"

namespace nidus {
namespace {

using Aim = LoadCommand::Aim;

struct Request final : VAHACommand {};

struct Deed {
  Aim aim;
  std::string_view actionType;
  std::string_view attribute;
};

/// What is done with lamps, whichever are named.
constexpr std::array kDeeds = {Deed{Aim::tell, VAHAActionTypeGETValue, ""},
                               Deed{Aim::tell, VAHAActionTypeGET_MAXIMUMValue, "BRIGHTNESS"},
                               Deed{Aim::read, VAHAActionTypeGETValue, "BRIGHTNESS"},
                               Deed{Aim::read, VAHAActionTypeGETValue, "POWER"},
                               Deed{Aim::read, VAHAActionTypeGET_TARGET_VALUEValue, "POWER"},
                               Deed{Aim::write, VAHAActionTypeSETValue, "BRIGHTNESS"},
                               Deed{Aim::write, VAHAActionTypeSET_TO_MAXIMUMValue, "BRIGHTNESS"},
                               Deed{Aim::update, VAHAActionTypeINCREASEValue, "BRIGHTNESS"},
                               Deed{Aim::update, VAHAActionTypeDECREASEValue, "BRIGHTNESS"},
                               Deed{Aim::update, VAHAActionTypeTOGGLEValue, "POWER"},
                               Deed{Aim::refuse, VAHAActionTypeTOGGLEValue, "BRIGHTNESS"},
                               Deed{Aim::refuse, "FLY", "POWER"}};

NDString maybeRenamed(const NDString& name, Random& random) {
  return random.oneIn(8) ? renamed(name) : name;
}

void addPiece(std::string& text, const char* name, const NDString& value) {
  if (value) text += std::string(" ") + name + "='" + value.str() + "'";
}

}  // namespace

std::unique_ptr<VAHACommand> LoadCommand::request() const {
  auto filter = std::make_shared<VAHASearchCriteriaFilter>();
  filter->setHomeName(home);
  filter->setRoomName(room);
  filter->setGroupName(group);
  filter->setServiceName(service);
  filter->setSceneName(scene);
  auto action = std::make_shared<VAHAAction>();
  action->setActionType(actionType);
  action->setAttribute(attribute);
  action->setValue(value);
  auto request = std::make_unique<Request>();
  request->setFilter(std::move(filter));
  request->setActions({std::move(action)});
  return request;
}

std::string LoadCommand::description() const {
  std::string text = actionType.str() + " " + attribute.str();
  addPiece(text, "home", home);
  addPiece(text, "room", room);
  addPiece(text, "group", group);
  addPiece(text, "service", service);
  addPiece(text, "scene", scene);
  return text;
}

LoadCommand CommandMix::draw(Random& random) const {
  const std::size_t home = homes.at(random.below(homes.size()));
  const std::size_t room = random.below(rooms);
  LoadCommand command;
  if (isHomeNamed || random.oneIn(2)) command.home = maybeRenamed(homeName(home), random);
  if (random.oneIn(8)) {
    command.aim = random.oneIn(4) ? Aim::refuse : Aim::scene;
    command.scene = maybeRenamed(sceneName(home, room), random);
    command.actionType = VAHAActionTypeSETValue;
    command.attribute = VAHAAttributeENABLEDValue;
    command.value = booleanOf(command.aim == Aim::scene);
    return command;
  }
  const Deed& deed = kDeeds.at(random.below(kDeeds.size()));
  command.aim = deed.aim;
  command.actionType = deed.actionType;
  if (!deed.attribute.empty()) command.attribute = deed.attribute;
  if (command.actionType == VAHAActionTypeSETValue) {
    command.value = integerOf(static_cast<std::int64_t>(random.below(60)));
  }
  switch (random.below(4)) {
    case 0:
      command.room = maybeRenamed(roomName(home, room), random);
      break;
    case 1:
      command.group = groupName(home);
      break;
    default:
      command.service = maybeRenamed(lampName(home, room, random.below(kLampsPerRoom + 2)), random);
  }
  return command;
}

VAHAValueRef booleanOf(bool value) {
  auto made = VAHABooleanValue::booleanValue();
  made->setValue(value);
  return made;
}

VAHAValueRef integerOf(std::int64_t value) {
  auto made = VAHAIntegerValue::integerValue();
  made->setValue(value);
  return made;
}

}  // namespace nidus
