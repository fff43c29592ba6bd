#include "nidus/Commands/DemoSteps.h"

#include "HomePlatform/Json/JsonText.h"

namespace nidus {
namespace {

const NDDictionary* dictionaryAt(const NDDictionary& parent, std::string_view key) {
  const NDDictionaryValue* value = parent.find(key);
  return value ? std::get_if<NDDictionary>(&value->content()) : nullptr;
}

std::string textAt(const NDDictionary& parent, std::string_view key) {
  const NDDictionaryValue* value = parent.find(key);
  const auto* text = value ? std::get_if<NDString>(&value->content()) : nullptr;
  return text ? text->str() : std::string();
}

void appendResult(std::string& summary, const NDDictionary& result) {
  if (const auto* entity = dictionaryAt(result, "entity")) summary += textAt(*entity, "name") + ' ';
  summary += textAt(result, "outcome");
  const auto* value = dictionaryAt(result, "resultValue");
  if (!value || value->empty()) return;
  summary += ' ';
  appendJson(summary, value->begin()->second);
}

}  // namespace

const std::vector<DemoStep>& demoSteps() {
  static const std::vector<DemoStep> kSteps = {
      {"How bright are the lights in the living room?", false,
       R"({"filter": {"search": {"roomName": "Living Room", "serviceType": "LIGHT"}}, "actions": [{"actionType": "GET", "attribute": "BRIGHTNESS"}]})",
       "COMMAND_SUCCESS: Ceiling Light SUCCESS 65, Floor Lamp SUCCESS 40"},
      {"Which lights are on?", false,
       R"({"filter": {"search": {"serviceType": "LIGHT"}}, "actions": [{"actionType": "GET", "attribute": "POWER", "value": {"boolean": true}}]})",
       "COMMAND_SUCCESS: Kitchen Ceiling SUCCESS true, Counter Lights SUCCESS true, "
       "Ceiling Light SUCCESS true, Floor Lamp SUCCESS true, Desk Lamp SUCCESS true, "
       "Night Light SUCCESS true, Garage Light UNREACHABLE"},
      {"Turn on the light in the Café Corner, spelled without its accent", false,
       R"({"filter": {"search": {"roomName": "Cafe Corner", "serviceType": "LIGHT"}}, "actions": [{"actionType": "SET", "attribute": "POWER", "value": {"boolean": true}}]})",
       "COMMAND_SUCCESS: Café Lamp SUCCESS true"},
      {"Raise a brightness of 80 by 50: it stops at the limit", false,
       R"({"filter": {"search": {"serviceName": "Kitchen Ceiling"}}, "actions": [{"actionType": "INCREASE", "attribute": "BRIGHTNESS", "value": {"integer": 50}}]})",
       "COMMAND_SUCCESS: Kitchen Ceiling SUCCESS 100"},
      {"Toggle the desk lamp", false,
       R"({"filter": {"search": {"serviceName": "Desk Lamp"}}, "actions": [{"actionType": "TOGGLE", "attribute": "POWER"}]})",
       "COMMAND_SUCCESS: Desk Lamp SUCCESS"},
      {"How warm can the living room be set?", false,
       R"({"filter": {"search": {"roomName": "Living Room", "serviceType": "THERMOSTAT"}}, "actions": [{"actionType": "GET_MAXIMUM", "attribute": "TEMPERATURE"}]})",
       "COMMAND_SUCCESS: Thermostat SUCCESS 30.0"},
      {"Unlock the front door while the device is locked: two replies", true,
       R"({"filter": {"search": {"serviceName": "Front Door", "serviceType": "LOCK"}}, "actions": [{"actionType": "SET", "attribute": "LOCKED", "value": {"boolean": false}}]})",
       "REQUIRES_UNLOCK:; FOUND_NO_MATCHING_ENTITIES:"},
      {"The same while the device is unlocked", false,
       R"({"filter": {"search": {"serviceName": "Front Door", "serviceType": "LOCK"}}, "actions": [{"actionType": "SET", "attribute": "LOCKED", "value": {"boolean": false}}]})",
       "COMMAND_SUCCESS: Front Door SUCCESS false"},
      {"Turn on a lamp that can not be reached", false,
       R"({"filter": {"search": {"serviceName": "Garage Light"}}, "actions": [{"actionType": "SET", "attribute": "POWER", "value": {"boolean": true}}]})",
       "COMMAND_SUCCESS: Garage Light UNREACHABLE"},
      {"An outlet with a lamp in it is a light", false,
       R"({"filter": {"search": {"serviceName": "Window Lamp", "serviceType": "LIGHT"}}, "actions": [{"actionType": "SET", "attribute": "POWER", "value": {"boolean": true}}]})",
       "COMMAND_SUCCESS: Window Lamp SUCCESS true"},
      {"The lights of the other home", false,
       R"({"filter": {"search": {"homeName": "Lake Cabin", "serviceType": "LIGHT"}}, "actions": [{"actionType": "GET", "attribute": "BRIGHTNESS"}]})",
       "COMMAND_SUCCESS: Cabin Lamp SUCCESS 75, Bunk Light SUCCESS 25, Jetty Lights SUCCESS 50"},
      {"Run a scene", false,
       R"({"filter": {"search": {"sceneName": "Soirée"}}, "actions": [{"actionType": "SET", "attribute": "ENABLED", "value": {"boolean": true}}]})",
       "COMMAND_SUCCESS: Soirée SUCCESS true"},
      {"A room that there is not", false,
       R"({"filter": {"search": {"roomName": "Attic"}}, "actions": [{"actionType": "GET", "attribute": "POWER"}]})",
       "FOUND_NO_MATCHING_ENTITIES:"},
  };
  return kSteps;
}

std::string summaryOf(const std::vector<NDDictionary>& replies) {
  std::string summary;
  for (const NDDictionary& reply : replies) {
    if (!summary.empty()) summary += "; ";
    summary += textAt(reply, "commandOutcome") + ':';
    const NDDictionaryValue* results = reply.find("actionResults");
    const auto* list = results ? std::get_if<NDDictionaryList>(&results->content()) : nullptr;
    if (!list) continue;
    for (const NDDictionaryValue& result : *list) {
      summary += &result == &list->front() ? " " : ", ";
      appendResult(summary, std::get<NDDictionary>(result.content()));
    }
  }
  return summary;
}

}  // namespace nidus
