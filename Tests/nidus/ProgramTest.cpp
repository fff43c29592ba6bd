#include "nidus/ProgramTest.h"

namespace nidus {
namespace {

std::string lamp(const std::string& name, const std::string& number, bool reachable) {
  return lampDocument("DD00DD00-0000-4000-8000-00000000000" + number, name,
                      R"("room": "BB00BB00-0000-4000-8000-000000000001", "reachable": )" +
                          std::string(reachable ? "true, " : "false, "));
}

constexpr const char kLock[] =
    R"({"uuid": "DD00DD00-0000-4000-8000-000000000003", "name": "Door", "requiresUnlock": true,
        "services": [{"instanceID": 8, "name": "Door",
        "serviceType": "com.corvane.nidus.service.lock", "characteristics": [
          {"instanceID": 9, "characteristicType": "com.corvane.nidus.characteristic.power",
           "properties": ["readable", "writable"], "value": false,
           "metadata": {"format": "bool"}}]}]})";

}  // namespace

std::string lampDocument(const std::string& uuid, const std::string& name,
                         const std::string& more) {
  return R"({"uuid": ")" + uuid + R"(", "name": ")" + name + R"(", )" + more +
         R"("services": [{"instanceID": 8, "name": ")" + name +
         R"(", "serviceType": "com.corvane.nidus.service.light", "characteristics": [
             {"instanceID": 9, "characteristicType": "com.corvane.nidus.characteristic.power",
              "properties": ["readable", "writable"], "value": true,
              "metadata": {"format": "bool"}},
             {"instanceID": 10, "characteristicType": "com.corvane.nidus.characteristic.brightness",
              "properties": ["readable", "writable"], "value": 40,
              "metadata": {"format": "int", "units": "percentage", "minimumValue": 0,
                           "maximumValue": 100}}]}]})";
}

std::string smallHome() {
  return R"({"uuid": "AA00AA00-0000-4000-8000-000000000001", "name": "Cottage", "primary": true,
      "rooms": [{"uuid": "BB00BB00-0000-4000-8000-000000000001", "name": "Kitchen"}],
      "zones": [{"uuid": "CC00CC00-0000-4000-8000-000000000001", "name": "Downstairs",
                 "rooms": ["BB00BB00-0000-4000-8000-000000000001"]}],
      "accessories": [)" +
         lamp("Lamp", "1", true) + "," + lamp("Away", "2", false) + "," + kLock + R"(],
      "serviceGroups": [{"uuid": "EE00EE00-0000-4000-8000-000000000001", "name": "Corner",
        "services": [{"accessory": "DD00DD00-0000-4000-8000-000000000001", "service": 8}]}],
      "actionSets": [{"uuid": "FF00FF00-0000-4000-8000-000000000001", "name": "Night"}]})";
}

std::string emptyHome(const std::string& name, int number) {
  return R"({"uuid": "AA00AA00-0000-4000-8000-00000000000)" + std::to_string(number) +
         R"(", "name": ")" + name + "\"}";
}

std::string documentOf(const std::vector<std::string>& homes) {
  std::string document = R"({"format": "nidus-home/1", "homes": [)";
  for (const std::string& home : homes) document += (&home == &homes.front() ? "" : ",") + home;
  return document + "]}";
}

std::string readCommandLine(const std::string& serviceName) {
  return R"({"filter": {"search": {"serviceName": ")" + serviceName +
         R"("}}, "actions": [{"actionType": "GET", "attribute": "POWER"}]})";
}

std::string setCommandLine(const std::string& serviceName, bool isOn) {
  return R"({"filter": {"search": {"serviceName": ")" + serviceName +
         R"("}}, "actions": [{"actionType": "SET", "attribute": "POWER", "value": {"boolean": )" +
         (isOn ? "true" : "false") + "}}]}";
}

}  // namespace nidus
