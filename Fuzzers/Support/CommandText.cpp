#include "Support/CommandText.h"

#include <string_view>

#include "AssistantHost/CommandReader.h"
#include "HomePlatform/Json/JsonText.h"
#include "PlatformModel/Assistant/VAHAFilter.h"
#include "PlatformModel/System/NDDictionary.h"
#include "Support/Finding.h"

namespace nidus {
namespace {

NDDictionary searchForm(const VAHASearchCriteriaFilter& filter) {
  NDDictionary form;
  form.setIfPresent("homeName", filter.homeName());
  form.setIfPresent("entityType", filter.entityType());
  form.setIfPresent("attribute", filter.attribute());
  form.setIfPresent("serviceType", filter.serviceType());
  form.setIfPresent("roomName", filter.roomName());
  form.setIfPresent("zoneName", filter.zoneName());
  form.setIfPresent("groupName", filter.groupName());
  form.setIfPresent("serviceName", filter.serviceName());
  form.setIfPresent("sceneName", filter.sceneName());
  return form;
}

NDDictionary filterForm(const VAHAFilter& filter) {
  NDDictionary form;
  if (const auto* search = dynamic_cast<const VAHASearchCriteriaFilter*>(&filter)) {
    form.set("search", NDDictionaryValue(searchForm(*search)));
  } else if (const auto* named = dynamic_cast<const VAHAIdentifierFilter*>(&filter)) {
    NDDictionaryList identifiers;
    for (const NDURL& each : named->identifiers()) identifiers.emplace_back(each.text());
    form.set("identifiers", NDDictionaryValue(std::move(identifiers)));
  }
  return form;
}

NDDictionary actionForm(const VAHAAction& action) {
  NDDictionary form;
  form.setIfPresent("actionType", action.actionType());
  form.setIfPresent("attribute", action.attribute());
  if (action.value()) form.set("value", NDDictionaryValue(action.value()->dictionary()));
  return form;
}

}  // namespace

std::string commandText(const VAHACommand& command) {
  NDDictionary form;
  if (command.filter()) form.set("filter", NDDictionaryValue(filterForm(*command.filter())));
  NDDictionaryList actions;
  for (const VAHAActionRef& action : command.actions()) actions.emplace_back(actionForm(*action));
  if (!actions.empty()) form.set("actions", NDDictionaryValue(std::move(actions)));
  std::string text;
  appendJson(text, form);
  return text;
}

void checkCommandSurvives(const VAHACommand& command) {
  const std::string text = commandText(command);
  const auto again = readCommand(text, "written");
  if (!again) reportFinding("A command that was written is refused: " + again.failure().message);
  expectSameText("A command changes when it is written and read", text, commandText(**again));
  if (command.filter() && command.filter()->description().empty()) {
    reportFinding("A filter has no description: " + text);
  }
}

}  // namespace nidus
