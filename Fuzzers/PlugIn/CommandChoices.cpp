#include "PlugIn/CommandChoices.h"

#include <array>
#include <utility>
#include <vector>

#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/System/NDURL.h"
#include "PlugIn/Words.h"

namespace nidus {
namespace {

constexpr std::array kActionTypes = {
    VAHAActionTypeGETValue,
    VAHAActionTypeGET_TARGET_VALUEValue,
    VAHAActionTypeGET_MINIMUMValue,
    VAHAActionTypeGET_MAXIMUMValue,
    VAHAActionTypeGET_STEP_VALUEValue,
    VAHAActionTypeSETValue,
    VAHAActionTypeSET_TO_MINIMUMValue,
    VAHAActionTypeSET_TO_MAXIMUMValue,
    VAHAActionTypeINCREASEValue,
    VAHAActionTypeDECREASEValue,
    VAHAActionTypeTOGGLEValue,
};
constexpr std::array kEntityTypes = {VAHAEntityTypeSERVICEValue, VAHAEntityTypeSCENEValue,
                                     VAHAEntityTypeHOMEValue,    VAHAEntityTypeGROUPValue,
                                     VAHAEntityTypeROOMValue,    VAHAEntityTypeZONEValue,
                                     VAHAEntityTypeTRIGGERValue, std::string_view("NOTHING")};
constexpr std::array kUnits = {"CELSIUS", "FAHRENHEIT", "PERCENTAGE", "FURLONG"};
constexpr const char* kUnknown = "UNKNOWN";

NDString chooseAttribute(Choices& choices) {
  if (choices.chance(5)) return kUnknown;
  const NDString name = choices.oneOf(kAttributes);
  return choices.chance(5) ? entryOf(name).write : name;
}

NDString maybeName(Choices& choices, int percent) {
  return choices.chance(percent) ? NDString(choices.oneOf(kNames)) : NDString();
}

/// Half of the searches name next to nothing, so that they find much.
std::shared_ptr<const VAHAFilter> chooseSearch(Choices& choices) {
  auto filter = std::make_shared<VAHASearchCriteriaFilter>();
  if (choices.chance(20)) filter->setServiceType(choices.oneOf(kServiceTypes));
  if (choices.chance(20)) filter->setEntityType(VAHAEntityTypeSERVICEValue);
  if (choices.chance(50)) return filter;
  filter->setHomeName(maybeName(choices, 40));
  if (choices.chance(30)) filter->setEntityType(choices.oneOf(kEntityTypes));
  if (choices.chance(15)) filter->setAttribute(chooseAttribute(choices));
  if (choices.chance(3)) filter->setServiceType(kUnknown);
  filter->setRoomName(maybeName(choices, 20));
  filter->setZoneName(maybeName(choices, 15));
  filter->setGroupName(maybeName(choices, 15));
  filter->setServiceName(maybeName(choices, 15));
  filter->setSceneName(maybeName(choices, 15));
  return filter;
}

std::shared_ptr<const VAHAFilter> chooseFilter(Choices& choices) {
  if (choices.chance(3)) return nullptr;
  if (!choices.chance(3)) return chooseSearch(choices);
  auto filter = std::make_shared<VAHAIdentifierFilter>();
  filter->setIdentifiers({NDURL::fromText("x-corvane-nidus://local/home?id=9E")});
  return filter;
}

VAHAValueRef chooseActionValue(Choices& choices) {
  const NDValueRef boxed = chooseValue(choices);
  std::shared_ptr<VAHAValue> value;
  if (boxed->isBoolean()) {
    auto boolean = VAHABooleanValue::booleanValue();
    boolean->setValue(boxed->boolValue());
    value = boolean;
  } else if (boxed->isInteger()) {
    auto integer = VAHAIntegerValue::integerValue();
    integer->setValue(boxed->integerValue());
    value = integer;
  } else if (boxed->isFloating()) {
    auto floating = VAHAFloatValue::floatValue();
    floating->setValue(boxed->floatValue());
    value = floating;
  } else {
    auto text = VAHAStringValue::stringValue();
    text->setValue(boxed->stringValue());
    value = text;
  }
  if (choices.chance(25)) value->setUnits(choices.oneOf(kUnits));
  return value;
}

VAHAActionRef chooseAction(Choices& choices) {
  auto action = std::make_shared<VAHAAction>();
  if (!choices.chance(5)) action->setActionType(choices.oneOf(kActionTypes));
  if (choices.chance(2)) action->setActionType(kUnknown);
  if (!choices.chance(8)) action->setAttribute(chooseAttribute(choices));
  if (!choices.chance(30)) action->setValue(chooseActionValue(choices));
  return action;
}

}  // namespace

CommandRef chooseCommand(Choices& choices) {
  auto command = std::make_shared<VAHACommand>();
  command->setFilter(chooseFilter(choices));
  std::vector<VAHAActionRef> actions;
  if (!choices.chance(4)) actions.push_back(chooseAction(choices));
  if (choices.chance(4)) actions.push_back(chooseAction(choices));
  command->setActions(std::move(actions));
  return command;
}

}  // namespace nidus
