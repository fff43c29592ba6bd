#include "nidus/HomeEditing/SampleHomes.h"

#include <sstream>

#include "HomePlatform/Store/HomeDocument.h"

namespace nidus {
namespace {

constexpr const char kSample[] = R"({"format": "nidus-home/1", "homes": [
  {"uuid": "AA000000-0000-4000-8000-000000000001", "name": "Beach House", "primary": true,
   "rooms": [{"uuid": "BB000000-0000-4000-8000-000000000001", "name": "Kitchen"},
             {"uuid": "BB000000-0000-4000-8000-000000000002", "name": "Study"}],
   "zones": [{"uuid": "CC000000-0000-4000-8000-000000000001", "name": "Downstairs",
              "rooms": ["BB000000-0000-4000-8000-000000000001"]},
             {"uuid": "CC000000-0000-4000-8000-000000000002", "name": "Upstairs"}],
   "accessories": [
     {"uuid": "DD000000-0000-4000-8000-000000000001", "name": "Ceiling lamp",
      "room": "BB000000-0000-4000-8000-000000000001",
      "services": [{"instanceID": 8, "name": "Lamp",
        "serviceType": "com.corvane.nidus.service.light", "characteristics": [
         {"instanceID": 9, "characteristicType": "com.corvane.nidus.characteristic.power",
          "properties": ["readable", "writable"], "value": true, "metadata": {"format": "bool"}},
         {"instanceID": 10, "characteristicType": "com.corvane.nidus.characteristic.brightness",
          "properties": ["readable", "writable"], "value": 40,
          "metadata": {"format": "int", "units": "percentage", "minimumValue": 0,
                       "maximumValue": 100, "stepValue": 1}}]}]},
     {"uuid": "DD000000-0000-4000-8000-000000000002", "name": "Floor lamp",
      "services": [{"instanceID": 8, "name": "Lamp",
        "serviceType": "com.corvane.nidus.service.light", "characteristics": [
         {"instanceID": 9, "characteristicType": "com.corvane.nidus.characteristic.power",
          "properties": ["readable", "writable"], "value": true, "metadata": {"format": "bool"}}]},
        {"instanceID": 11, "serviceType": "com.corvane.nidus.service.battery"}]}],
   "serviceGroups": [{"uuid": "EE000000-0000-4000-8000-000000000001", "name": "Corner",
     "services": [{"accessory": "DD000000-0000-4000-8000-000000000001", "service": 8}]},
     {"uuid": "EE000000-0000-4000-8000-000000000002", "name": "Rest"}],
   "actionSets": [{"uuid": "FF000000-0000-4000-8000-000000000001", "name": "Night", "actions": [
     {"accessory": "DD000000-0000-4000-8000-000000000001", "service": 8, "characteristic": 9,
      "value": false},
     {"accessory": "DD000000-0000-4000-8000-000000000001", "service": 8, "characteristic": 10,
      "value": 5},
     {"accessory": "DD000000-0000-4000-8000-000000000002", "service": 8, "characteristic": 9,
      "value": false}]}],
   "triggers": [{"uuid": "99000000-0000-4000-8000-000000000001", "name": "Sunset"}]},
  {"uuid": "AA000000-0000-4000-8000-000000000009", "name": "Cottage",
   "rooms": [{"uuid": "BB000000-0000-4000-8000-000000000009", "name": "Kitchen"}]}]})";

}  // namespace

std::string sampleDocument() { return kSample; }

std::vector<HomeData> sampleHomes() {
  std::istringstream in(kSample);
  auto homes = readHomeDocument(in, "the sample homes");
  EXPECT_TRUE(homes) << homes.failure().message;
  return std::move(*homes);
}

std::string textOf(const std::vector<HomeData>& homes) {
  std::ostringstream out;
  writeHomeDocument(out, homes, true);
  return out.str();
}

}  // namespace nidus
