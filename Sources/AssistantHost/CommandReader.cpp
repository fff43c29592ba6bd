#include "AssistantHost/CommandReader.h"

#include <cstdint>
#include <limits>
#include <utility>
#include <variant>
#include <vector>

#include "AssistantHost/JsonChoice.h"
#include "PlatformModel/Assistant/VAHAAction.h"
#include "PlatformModel/Assistant/VAHAFilter.h"
#include "PlatformModel/Assistant/VAHAValue.h"
#include "PlatformModel/System/NDURL.h"

namespace nidus {
namespace {

struct SearchField {
  std::string_view key;
  void (VAHASearchCriteriaFilter::*set)(NDString);
};

constexpr SearchField kSearchFields[] = {
    {"homeName", &VAHASearchCriteriaFilter::setHomeName},
    {"entityType", &VAHASearchCriteriaFilter::setEntityType},
    {"attribute", &VAHASearchCriteriaFilter::setAttribute},
    {"serviceType", &VAHASearchCriteriaFilter::setServiceType},
    {"roomName", &VAHASearchCriteriaFilter::setRoomName},
    {"zoneName", &VAHASearchCriteriaFilter::setZoneName},
    {"groupName", &VAHASearchCriteriaFilter::setGroupName},
    {"serviceName", &VAHASearchCriteriaFilter::setServiceName},
    {"sceneName", &VAHASearchCriteriaFilter::setSceneName},
};

std::shared_ptr<const VAHAFilter> searchFromJson(const JsonPlaced& placed) {
  auto filter = std::make_shared<VAHASearchCriteriaFilter>();
  JsonObject object(placed);
  for (const SearchField& field : kSearchFields) {
    if (const auto text = object.optional(field.key)) ((*filter).*field.set)(text->text());
  }
  object.refuseUnknownKeys();
  return filter;
}

std::shared_ptr<const VAHAFilter> identifiersFromJson(const JsonPlaced& placed) {
  std::vector<NDURL> identifiers;
  for (const JsonPlaced& identifier : placed.array()) {
    identifiers.push_back(NDURL::fromText(identifier.text()));
  }
  auto filter = std::make_shared<VAHAIdentifierFilter>();
  filter->setIdentifiers(std::move(identifiers));
  return filter;
}

std::shared_ptr<const VAHAFilter> filterFromJson(const JsonPlaced& placed) {
  const std::string_view kind = chosenKey(placed, {"search", "identifiers"});
  JsonObject object(placed);
  const JsonPlaced content = object.required(kind);
  object.refuseUnknownKeys();
  return kind == "search" ? searchFromJson(content) : identifiersFromJson(content);
}

float floatFromJson(const JsonPlaced& placed) {
  const auto& content = placed.value().content;
  if (const auto* integer = std::get_if<std::int64_t>(&content)) {
    return static_cast<float>(*integer);
  }
  const auto* number = std::get_if<float>(&content);
  if (!number) placed.fail("expected a number");
  return *number;
}

std::shared_ptr<VAHAValue> valueOfKind(std::string_view kind, const JsonPlaced& placed) {
  if (kind == "boolean") {
    auto value = VAHABooleanValue::booleanValue();
    value->setValue(placed.boolean());
    return value;
  }
  if (kind == "integer") {
    using Limits = std::numeric_limits<std::int64_t>;
    auto value = VAHAIntegerValue::integerValue();
    value->setValue(placed.integer(Limits::min(), Limits::max()));
    return value;
  }
  if (kind == "float") {
    auto value = VAHAFloatValue::floatValue();
    value->setValue(floatFromJson(placed));
    return value;
  }
  auto value = VAHAStringValue::stringValue();
  value->setValue(placed.text());
  return value;
}

VAHAValueRef valueFromJson(const JsonPlaced& placed) {
  const std::string_view kind = chosenKey(placed, {"boolean", "integer", "float", "string"});
  JsonObject object(placed);
  auto value = valueOfKind(kind, object.required(kind));
  if (const auto units = object.optional("units")) value->setUnits(units->text());
  object.refuseUnknownKeys();
  return value;
}

VAHAActionRef actionFromJson(const JsonPlaced& placed) {
  auto action = std::make_shared<VAHAAction>();
  JsonObject object(placed);
  if (const auto type = object.optional("actionType")) action->setActionType(type->text());
  if (const auto attribute = object.optional("attribute")) action->setAttribute(attribute->text());
  if (const auto value = object.optional("value")) action->setValue(valueFromJson(*value));
  object.refuseUnknownKeys();
  return action;
}

std::vector<VAHAActionRef> actionsFromJson(const JsonPlaced& placed) {
  std::vector<VAHAActionRef> actions;
  for (const JsonPlaced& action : placed.array()) actions.push_back(actionFromJson(action));
  return actions;
}

}  // namespace

CommandRef commandFromJson(const JsonPlaced& command) {
  auto request = std::make_shared<VAHACommand>();
  JsonObject object(command);
  if (const auto filter = object.optional("filter")) request->setFilter(filterFromJson(*filter));
  if (const auto actions = object.optional("actions")) {
    request->setActions(actionsFromJson(*actions));
  }
  object.refuseUnknownKeys();
  return request;
}

Result<CommandRef> readCommand(std::string_view text, const std::string& name) {
  try {
    const JsonValue document = parseJson(text, kCommandLimits);
    return commandFromJson(JsonPlaced(document, ""));
  } catch (const JsonError& error) {
    return failureOf(error, name);
  }
}

}  // namespace nidus
