#include "Assistant/CommandRequest.h"

#include <string_view>
#include <utility>
#include <variant>

namespace nidus {
namespace {

/// A command as the assistant makes it.
class Request final : public VAHACommand {};

const NDDictionary* dictionaryAt(const NDDictionary& dictionary, std::string_view key) {
  const NDDictionaryValue* value = dictionary.find(key);
  return value ? std::get_if<NDDictionary>(&value->content()) : nullptr;
}

std::string textAt(const NDDictionary& dictionary, std::string_view key, const char* otherwise) {
  const NDDictionaryValue* value = dictionary.find(key);
  return value ? std::get<NDString>(value->content()).str() : otherwise;
}

std::string textOf(const NDDictionaryValue& value) {
  struct Describe {
    std::string operator()(std::nullptr_t) const { return "null"; }
    std::string operator()(bool flag) const { return flag ? "true" : "false"; }
    std::string operator()(std::int64_t number) const { return std::to_string(number); }
    std::string operator()(float number) const { return NDValue::floating(number)->description(); }
    std::string operator()(const NDString& text) const { return "'" + text.str() + "'"; }
    std::string operator()(const NDDictionaryList&) const { return "list"; }
    std::string operator()(const NDDictionary&) const { return "dictionary"; }
  };
  return std::visit(Describe(), value.content());
}

std::string resultSummary(const NDDictionary& result) {
  const NDDictionary* entity = dictionaryAt(result, "entity");
  std::string text = entity ? textAt(*entity, "name", "?") : "no entity";
  text += " " + textAt(result, "outcome", "no outcome");
  const NDDictionary* value = dictionaryAt(result, "resultValue");
  if (result.find("resultAttribute")) text += " " + textAt(result, "resultAttribute", "");
  if (!value) return text;
  for (const auto& [key, content] : *value) {
    text += key == "units" ? " " + textAt(*value, key, "") : "=" + textOf(content);
  }
  return text;
}

}  // namespace

VAHAValueRef booleanValue(bool value) {
  auto made = VAHABooleanValue::booleanValue();
  made->setValue(value);
  return made;
}

VAHAValueRef integerValue(std::int64_t value, const NDString& units) {
  auto made = VAHAIntegerValue::integerValue();
  made->setValue(value);
  made->setUnits(units);
  return made;
}

VAHAValueRef floatValue(float value, const NDString& units) {
  auto made = VAHAFloatValue::floatValue();
  made->setValue(value);
  made->setUnits(units);
  return made;
}

VAHAValueRef stringValue(const NDString& value) {
  auto made = VAHAStringValue::stringValue();
  made->setValue(value);
  return made;
}

std::shared_ptr<VAHASearchCriteriaFilter> searchFilter(const Search& search) {
  auto filter = std::make_shared<VAHASearchCriteriaFilter>();
  filter->setHomeName(search.home);
  filter->setEntityType(search.entityType);
  filter->setAttribute(search.attribute);
  filter->setServiceType(search.serviceType);
  filter->setRoomName(search.room);
  filter->setZoneName(search.zone);
  filter->setGroupName(search.group);
  filter->setServiceName(search.service);
  filter->setSceneName(search.scene);
  return filter;
}

VAHAActionRef makeAction(const Action& action) {
  auto made = std::make_shared<VAHAAction>();
  made->setActionType(action.type);
  made->setAttribute(action.attribute);
  made->setValue(action.value);
  return made;
}

std::shared_ptr<NDAssistantCommand> makeCommand(
    std::shared_ptr<const VAHAFilter> filter, const std::vector<Action>& actions,
    std::shared_ptr<NDAssistantCommandObserver> observer) {
  Request request;
  std::vector<VAHAActionRef> made;
  made.reserve(actions.size());
  for (const Action& action : actions) made.push_back(makeAction(action));
  request.setFilter(std::move(filter));
  request.setActions(std::move(made));
  return std::make_shared<NDAssistantCommand>(request, std::move(observer));
}

std::shared_ptr<NDAssistantCommand> makeCommand(
    const Search& search, const std::vector<Action>& actions,
    std::shared_ptr<NDAssistantCommandObserver> observer) {
  return makeCommand(std::shared_ptr<const VAHAFilter>(searchFilter(search)), actions,
                     std::move(observer));
}

std::string summary(const VAHAActionResult& result) { return resultSummary(result.dictionary()); }

std::string summary(const NDDictionary& reply) {
  std::string text = textAt(reply, "commandOutcome", "no outcome");
  const NDDictionaryValue* results = reply.find("actionResults");
  if (!results) return text + " without results";
  for (const auto& result : std::get<NDDictionaryList>(results->content())) {
    text += "; " + resultSummary(std::get<NDDictionary>(result.content()));
  }
  return text;
}

}  // namespace nidus
