#include "HomePlatform/Store/HomeDocument.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sstream>
#include <string>

#include "HomePlatform/Support/RandomHome.h"

namespace nidus {
namespace {

using testing::HasSubstr;
using testing::StartsWith;

Result<std::vector<HomeData>> read(const std::string& text) {
  std::istringstream in(text);
  return readHomeDocument(in, "home.json");
}

/// The message without the name of the document; empty when it is accepted.
std::string problemOf(const std::string& text) {
  const auto homes = read(text);
  if (homes) return {};
  constexpr std::size_t kNameLength = 11;
  EXPECT_THAT(homes.failure().message, StartsWith("home.json: "));
  EXPECT_EQ(homes.failure().kind, Failure::Kind::badInput);
  return homes.failure().message.substr(kNameLength);
}

/// UUIDs of a short form: "#7" stands for one that ends in 7.
std::string expanded(std::string text) {
  for (auto at = text.find('#'); at != std::string::npos; at = text.find('#', at)) {
    text.replace(at, 1, "9E01A3C4-0000-4000-8000-00000000000");
  }
  return text;
}

std::string document(const std::string& homes) {
  return expanded(R"({"format": "nidus-home/1", "homes": [)" + homes + "]}");
}

std::string home(const std::string& members) {
  return document(R"({"uuid": "#0", "name": "Flat", )" + members + '}');
}

/// A home with the accessory #1, its service 8 and within that the characteristic 9.
std::string characteristic(const std::string& members) {
  return home(R"("accessories": [{"uuid": "#1", "name": "Lamp", "services": [{"instanceID": 8,
    "serviceType": "s", "characteristics": [{"instanceID": 9, "characteristicType": "c")" +
              members + "}]}]}]");
}

constexpr const char* kLamp = R"({"uuid": "#1", "name": "Lamp", "services": [
  {"instanceID": 8, "serviceType": "s", "characteristics": [
    {"instanceID": 9, "characteristicType": "c"}]},
  {"instanceID": 9, "serviceType": "s"}]})";

std::string homeWithLamp(const std::string& members) {
  return home(R"("accessories": [)" + std::string(kLamp) + "], " + members);
}

struct Case {
  const char* label;
  std::string text;
  std::string problem;
};

void expectProblems(const std::vector<Case>& cases) {
  for (const auto& [label, text, problem] : cases) {
    SCOPED_TRACE(label);
    EXPECT_EQ(problemOf(text), expanded(problem));
  }
}

TEST(ReadHomeDocumentTest, RefusesWrongDocuments) {
  expectProblems({
      {"empty file", "", "the document is empty"},
      {"no object", "[]", "expected an object"},
      {"null", "null", "expected an object"},
      {"no format", R"({"homes": []})", "missing required key \"format\""},
      {"no homes", R"({"format": "nidus-home/1"})", "missing required key \"homes\""},
      {"homes null", R"({"format": "nidus-home/1", "homes": null})", "/homes: expected an array"},
      {"homes an object", R"({"format": "nidus-home/1", "homes": {}})",
       "/homes: expected an array"},
      {"other format", R"({"format": "nidus-home/2", "homes": [{"new": 1}]})",
       "/format: expected \"nidus-home/1\""},
      {"format no text", R"({"format": 1, "homes": []})", "/format: expected a text"},
      {"format a list", R"({"format": ["nidus-home/1"], "homes": []})", "/format: expected a text"},
      {"unknown key", R"({"format": "nidus-home/1", "homes": [], "x": 1})",
       "/x: no such key; expected one of format, homes"},
      {"key twice", R"({"format": "nidus-home/1", "homes": [], "homes": []})",
       "/homes: the key stands twice"},
  });
}

TEST(ReadHomeDocumentTest, FindsWrongFormatAtTheEndToo) {
  EXPECT_EQ(problemOf(R"({"homes": [], "format": "x"})"), "/format: expected \"nidus-home/1\"");
}

TEST(ReadHomeDocumentTest, NamesLineOfSyntaxErrors) {
  EXPECT_THAT(problemOf("{\"format\": \"nidus-home/1\",\n \"homes\": [}"),
              StartsWith("line 2, column 12: "));
  EXPECT_THAT(problemOf(document("") + " {}"), StartsWith("line 1, column "));
}

TEST(ReadHomeDocumentTest, RefusesWrongTypes) {
  expectProblems({
      {"home no object", document("7"), "/homes/0: expected an object"},
      {"home null", document("null"), "/homes/0: expected an object"},
      {"home a list", document("[]"), "/homes/0: expected an object"},
      {"name", document(R"({"uuid": "#0", "name": 7})"), "/homes/0/name: expected a text"},
      {"name null", document(R"({"uuid": "#0", "name": null})"), "/homes/0/name: expected a text"},
      {"uuid", document(R"({"uuid": "x", "name": ""})"),
       "/homes/0/uuid: expected a UUID such as \"#1\""},
      {"primary", home(R"("primary": 1)"), "/homes/0/primary: expected true or false"},
      {"rooms", home(R"("rooms": "x")"), "/homes/0/rooms: expected an array"},
      {"room", home(R"("rooms": ["#1"])"), "/homes/0/rooms/0: expected an object"},
      {"zone's rooms", home(R"("zones": [{"uuid": "#1", "name": "", "rooms": "#2"}])"),
       "/homes/0/zones/0/rooms: expected an array"},
      {"zone's room", home(R"("zones": [{"uuid": "#1", "name": "", "rooms": [1]}])"),
       "/homes/0/zones/0/rooms/0: expected a UUID such as \"#1\""},
      {"reachable", home(R"("accessories": [{"uuid": "#1", "name": "", "reachable": "no"}])"),
       "/homes/0/accessories/0/reachable: expected true or false"},
      {"metadata", characteristic(R"(, "metadata": [])"),
       "/homes/0/accessories/0/services/0/characteristics/0/metadata: expected an object"},
      {"value", characteristic(R"(, "value": [1])"),
       "/homes/0/accessories/0/services/0/characteristics/0/value: "
       "expected true, false, a number or a text"},
      {"property", characteristic(R"(, "properties": [1])"),
       "/homes/0/accessories/0/services/0/characteristics/0/properties/0: expected a text"},
      {"faults", home(R"("faults": 4)"), "/homes/0/faults: expected an object"},
  });
}

TEST(ReadHomeDocumentTest, RefusesMissingKeys) {
  expectProblems({
      {"home's uuid", document(R"({"name": ""})"), "/homes/0: missing required key \"uuid\""},
      {"home's name", document(R"({"uuid": "#0"})"), "/homes/0: missing required key \"name\""},
      {"room", home(R"("rooms": [{"name": ""}])"),
       "/homes/0/rooms/0: missing required key \"uuid\""},
      {"zone", home(R"("zones": [{"uuid": "#1"}])"),
       "/homes/0/zones/0: missing required key \"name\""},
      {"accessory", home(R"("accessories": [{}])"),
       "/homes/0/accessories/0: missing required key \"uuid\""},
      {"service",
       home(R"("accessories": [{"uuid": "#1", "name": "", "services": [{"instanceID": 8}]}])"),
       "/homes/0/accessories/0/services/0: missing required key \"serviceType\""},
      {"group", home(R"("serviceGroups": [{"uuid": "#1"}])"),
       "/homes/0/serviceGroups/0: missing required key \"name\""},
      {"group's service", homeWithLamp(R"("serviceGroups": [{"uuid": "#2", "name": "",
         "services": [{"accessory": "#1"}]}])"),
       "/homes/0/serviceGroups/0/services/0: missing required key \"service\""},
      {"action's value", homeWithLamp(R"("actionSets": [{"uuid": "#2", "name": "",
         "actions": [{"accessory": "#1", "service": 8, "characteristic": 9}]}])"),
       "/homes/0/actionSets/0/actions/0: missing required key \"value\""},
      {"trigger", home(R"("triggers": [{"uuid": "#1"}])"),
       "/homes/0/triggers/0: missing required key \"name\""},
  });
}

TEST(ReadHomeDocumentTest, RefusesUnknownKeys) {
  const std::string accessory = "/homes/0/accessories/0";
  const std::string leaf = accessory + "/services/0/characteristics/0";
  expectProblems({
      {"home", home(R"("room": [])"),
       "/homes/0/room: no such key; expected one of uuid, name, primary, faults, rooms, zones, "
       "accessories, serviceGroups, actionSets, triggers"},
      {"room", home(R"("rooms": [{"uuid": "#1", "name": "", "zone": 1}])"),
       "/homes/0/rooms/0/zone: no such key; expected one of uuid, name"},
      {"accessory", home(R"("accessories": [{"uuid": "#1", "name": "", "x~/y": {"z": []}}])"),
       accessory + "/x~0~1y: no such key; expected one of uuid, name, room, reachable, "
                   "requiresUnlock, faults, services"},
      {"characteristic", characteristic(R"(, "type": "")"),
       leaf + "/type: no such key; expected one of instanceID, characteristicType, properties, "
              "value, deviceValue, metadata, faults"},
      {"metadata", characteristic(R"(, "metadata": {"max": 1})"),
       leaf + "/metadata/max: no such key; expected one of format, units, minimumValue, "
              "maximumValue, stepValue"},
      {"faults", characteristic(R"(, "faults": {"execute": 1})"),
       leaf + "/faults/execute: no such key; expected one of read, write"},
      {"action set's faults",
       home(R"("actionSets": [{"uuid": "#1", "name": "", "faults": {"read": 4}}])"),
       "/homes/0/actionSets/0/faults/read: no such key; expected one of execute"},
      {"action", homeWithLamp(R"("actionSets": [{"uuid": "#2", "name": "", "actions": [
         {"accessory": "#1", "service": 8, "characteristic": 9, "value": 1, "x": 1}]}])"),
       "/homes/0/actionSets/0/actions/0/x: no such key; expected one of accessory, service, "
       "characteristic, value"},
  });
}

TEST(ReadHomeDocumentTest, RefusesRepeatedIdentities) {
  expectProblems({
      {"homes", document(R"({"uuid": "#0", "name": ""}, {"uuid": "#0", "name": ""})"),
       "/homes/1/uuid: another home has the UUID #0"},
      {"rooms", home(R"("rooms": [{"uuid": "#1", "name": ""}, {"uuid": "#1", "name": ""}])"),
       "/homes/0/rooms/1/uuid: another object of this home has the UUID #1"},
      {"letter case", document(R"({"uuid": "9e01a3c4-0000-4000-8000-00000000000a", "name": ""},
                   {"uuid": "9E01A3C4-0000-4000-8000-00000000000A", "name": ""})"),
       "/homes/1/uuid: another home has the UUID 9E01A3C4-0000-4000-8000-00000000000A"},
      {"trigger and room",
       home(R"("triggers": [{"uuid": "#1", "name": ""}], "rooms": [{"uuid": "#1", "name": ""}])"),
       "/homes/0/triggers/0/uuid: another object of this home has the UUID #1"},
      {"services", home(R"("accessories": [{"uuid": "#1", "name": "", "services": [
         {"instanceID": 8, "serviceType": ""}, {"instanceID": 8, "serviceType": ""}]}])"),
       "/homes/0/accessories/0/services/1/instanceID: "
       "another service of this accessory has the instance ID 8"},
      {"characteristics of two services",
       home(R"("accessories": [{"uuid": "#1", "name": "", "services": [
         {"instanceID": 8, "serviceType": "", "characteristics": [
           {"instanceID": 9, "characteristicType": ""}]},
         {"instanceID": 10, "serviceType": "", "characteristics": [
           {"instanceID": 11, "characteristicType": ""},
           {"instanceID": 9, "characteristicType": ""}]}]}])"),
       "/homes/0/accessories/0/services/1/characteristics/1/instanceID: "
       "another characteristic of this accessory has the instance ID 9"},
  });
}

TEST(ReadHomeDocumentTest, AllowsWhatMayRepeat) {
  EXPECT_EQ(problemOf(document(R"(
      {"uuid": "#0", "name": "Flat", "primary": true,
       "rooms": [{"uuid": "#1", "name": "Flat"}, {"uuid": "#0", "name": "Flat"}]},
      {"uuid": "#2", "name": "Flat", "primary": true, "rooms": [{"uuid": "#1", "name": "Flat"}],
       "accessories": [
         {"uuid": "#3", "name": "", "services": [{"instanceID": 9, "serviceType": "",
           "characteristics": [{"instanceID": 9, "characteristicType": ""}]}]},
         {"uuid": "#4", "name": "", "services": [{"instanceID": 9, "serviceType": "",
           "characteristics": [{"instanceID": 9, "characteristicType": ""}]}]}],
       "zones": [{"uuid": "#5", "name": "", "rooms": ["#1", "#1"]}]})")),
            "");
}

TEST(ReadHomeDocumentTest, RefusesReferencesToNothing) {
  expectProblems({
      {"accessory's room", home(R"("accessories": [{"uuid": "#1", "name": "", "room": "#2"}])"),
       "/homes/0/accessories/0/room: no room of this home has the UUID #2"},
      {"an accessory is no room",
       home(R"("accessories": [{"uuid": "#1", "name": "", "room": "#1"}])"),
       "/homes/0/accessories/0/room: no room of this home has the UUID #1"},
      {"room of another home",
       document(R"({"uuid": "#0", "name": "", "rooms": [{"uuid": "#1", "name": ""}]},
         {"uuid": "#2", "name": "", "zones": [{"uuid": "#3", "name": "", "rooms": ["#1"]}]})"),
       "/homes/1/zones/0/rooms/0: no room of this home has the UUID #1"},
      {"group's accessory",
       homeWithLamp(R"("serviceGroups": [{"uuid": "#2", "name": "", "services": [
         {"accessory": "#1", "service": 8}, {"accessory": "#3", "service": 8}]}])"),
       "/homes/0/serviceGroups/0/services/1/accessory: "
       "no accessory of this home has the UUID #3"},
      {"group's service", homeWithLamp(R"("serviceGroups": [{"uuid": "#2", "name": "", "services": [
         {"accessory": "#1", "service": 7}]}])"),
       "/homes/0/serviceGroups/0/services/0/service: "
       "the accessory #1 has no service with the instance ID 7"},
      {"characteristic of another service",
       homeWithLamp(R"("actionSets": [{"uuid": "#2", "name": "", "actions": [
         {"accessory": "#1", "service": 9, "characteristic": 9, "value": 1}]}])"),
       "/homes/0/actionSets/0/actions/0/characteristic: the service 9 of the accessory #1 has "
       "no characteristic with the instance ID 9"},
      {"action's service", homeWithLamp(R"("actionSets": [{"uuid": "#2", "name": "", "actions": [
         {"accessory": "#1", "service": 5, "characteristic": 9, "value": 1}]}])"),
       "/homes/0/actionSets/0/actions/0/service: "
       "the accessory #1 has no service with the instance ID 5"},
      {"action's accessory", homeWithLamp(R"("actionSets": [{"uuid": "#2", "name": "", "actions": [
         {"accessory": "#0", "service": 8, "characteristic": 9, "value": 1}]}])"),
       "/homes/0/actionSets/0/actions/0/accessory: no accessory of this home has the UUID #0"},
  });
}

TEST(ReadHomeDocumentTest, ResolvesReferencesInAnyOrder) {
  EXPECT_EQ(problemOf(home(R"("actionSets": [{"actions": [
      {"value": 1, "characteristic": 9, "service": 8, "accessory": "#1"}],
      "name": "", "uuid": "#3"}],
    "serviceGroups": [{"services": [{"service": 9, "accessory": "#1"}], "name": "", "uuid": "#4"}],
    "zones": [{"rooms": ["#2"], "uuid": "#5", "name": ""}],
    "accessories": [)" + std::string(kLamp) +
                           R"(], "rooms": [{"name": "", "uuid": "#2"}])")),
            "");
}

TEST(ReadHomeDocumentTest, RefusesWhatIsListedTwice) {
  expectProblems({
      {"property", characteristic(R"(, "properties": ["readable", "notifies", "readable"])"),
       "/homes/0/accessories/0/services/0/characteristics/0/properties/2: "
       "\"readable\" is listed twice"},
      {"unknown property", characteristic(R"(, "properties": ["readable", "Writable"])"),
       "/homes/0/accessories/0/services/0/characteristics/0/properties/1: "
       "expected \"readable\", \"writable\" or \"notifies\""},
      {"service of a group",
       homeWithLamp(R"("serviceGroups": [{"uuid": "#2", "name": "", "services": [
         {"accessory": "#1", "service": 8}, {"accessory": "#1", "service": 8}]}])"),
       "/homes/0/serviceGroups/0/services/1: the service is listed twice"},
  });
}

TEST(ReadHomeDocumentTest, ChecksInstanceIDs) {
  const std::string problem =
      "/homes/0/accessories/0/services/0/instanceID: "
      "expected an integer from 1 to 9223372036854775807";
  const auto service = [](const std::string& instanceID) {
    return home(R"("accessories": [{"uuid": "#1", "name": "", "services": [{"instanceID": )" +
                instanceID + R"(, "serviceType": ""}]}])");
  };
  for (const char* wrong : {"0", "-1", "1.0", "\"1\"", "true", "null"}) {
    EXPECT_EQ(problemOf(service(wrong)), problem) << wrong;
  }
  EXPECT_EQ(problemOf(service("1")), "");
  EXPECT_EQ(problemOf(service("9223372036854775807")), "");
}

TEST(ReadHomeDocumentTest, ChecksFaultCodes) {
  const std::string place = "/homes/0/faults/read: ";
  EXPECT_EQ(problemOf(home(R"("faults": {"read": 0})")),
            place + "expected an error code other than 0");
  for (const char* wrong : {"2147483648", "-2147483649", "4.0", "\"4\""}) {
    EXPECT_EQ(problemOf(home(std::string(R"("faults": {"read": )") + wrong + '}')),
              place + "expected an integer from -2147483648 to 2147483647");
  }
  EXPECT_EQ(problemOf(home(R"("faults": {"read": -2147483648, "write": 2147483647})")), "");
}

TEST(ReadHomeDocumentTest, RefusesNullInActions) {
  expectProblems({
      {"value", homeWithLamp(R"("actionSets": [{"uuid": "#2", "name": "", "actions": [
         {"accessory": "#1", "service": 8, "characteristic": 9, "value": null}]}])"),
       "/homes/0/actionSets/0/actions/0/value: expected true, false, a number or a text"},
      {"service", homeWithLamp(R"("actionSets": [{"uuid": "#2", "name": "", "actions": [
         {"accessory": "#1", "service": null, "characteristic": 9, "value": 1}]}])"),
       "/homes/0/actionSets/0/actions/0/service: "
       "expected an integer from 1 to 9223372036854775807"},
  });
}

TEST(ReadHomeDocumentTest, RefusesValuesThatDoNotFit) {
  const std::string leaf = "/homes/0/accessories/0/services/0/characteristics/0";
  expectProblems({
      {"value", characteristic(R"(, "value": 256, "metadata": {"format": "uint8"})"),
       leaf + "/value: expected a value that fits the format \"uint8\""},
      {"device value before metadata",
       characteristic(R"(, "metadata": {"format": "string"}, "deviceValue": 1)"),
       leaf + "/deviceValue: expected a value that fits the format \"string\""},
      {"limit", characteristic(R"(, "metadata": {"minimumValue": "x", "format": "float"})"),
       leaf + "/metadata/minimumValue: expected a value that fits the format \"float\""},
      {"step", characteristic(R"(, "metadata": {"stepValue": -1, "format": "uint64"})"),
       leaf + "/metadata/stepValue: expected a value that fits the format \"uint64\""},
  });
}

TEST(ReadHomeDocumentTest, ConvertsValuesAndLimits) {
  const auto homes = read(characteristic(R"(, "value": 40.5, "deviceValue": true,
    "metadata": {"maximumValue": 99.5, "stepValue": 1, "format": "uint8", "minimumValue": false})"));
  ASSERT_TRUE(homes);
  const auto& data = (*homes)[0].accessories[0].services[0].characteristics[0];
  EXPECT_EQ(data.value->integerValue(), 41);
  EXPECT_TRUE(data.deviceValue->isInteger());
  EXPECT_EQ(data.metadata->maximumValue->integerValue(), 100);
  EXPECT_TRUE(data.metadata->minimumValue->isInteger());
}

TEST(ReadHomeDocumentTest, TakesValueForDeviceValue) {
  for (const char* members : {R"(, "value": 5)", R"(, "deviceValue": null, "value": 5)"}) {
    const auto homes = read(characteristic(members));
    ASSERT_TRUE(homes);
    const auto& data = (*homes)[0].accessories[0].services[0].characteristics[0];
    EXPECT_EQ(data.deviceValue, data.value);
  }
}

TEST(ReadHomeDocumentTest, KeepsDeviceValueWithoutValue) {
  const auto homes = read(characteristic(R"(, "deviceValue": 5)"));
  ASSERT_TRUE(homes);
  const auto& data = (*homes)[0].accessories[0].services[0].characteristics[0];
  EXPECT_FALSE(data.value);
  EXPECT_EQ(data.deviceValue->integerValue(), 5);
}

TEST(ReadHomeDocumentTest, TakesNullForAbsentEverywhere) {
  const auto homes = read(home(R"("primary": null, "rooms": null, "zones": null,
    "serviceGroups": null, "actionSets": null, "triggers": null, "faults": null, "accessories": [
      {"uuid": "#1", "name": "", "room": null, "reachable": null, "requiresUnlock": null,
       "faults": null, "services": [{"instanceID": 8, "serviceType": "", "name": null,
         "associatedServiceType": null, "characteristics": [
           {"instanceID": 9, "characteristicType": "", "properties": null, "value": null,
            "deviceValue": null, "faults": {"read": null},
            "metadata": {"format": null, "units": null, "minimumValue": null,
                         "maximumValue": null, "stepValue": null}}]}]}])"));
  ASSERT_TRUE(homes) << homes.failure().message;
  const AccessoryData& accessory = (*homes)[0].accessories[0];
  EXPECT_TRUE(accessory.reachable);
  EXPECT_FALSE(accessory.room);
  EXPECT_TRUE(accessory.services[0].characteristics[0].metadata);
}

TEST(ReadHomeDocumentTest, KeepsEmptyTexts) {
  const auto homes = read(characteristic(R"(, "metadata": {"units": ""})"));
  ASSERT_TRUE(homes);
  const auto& metadata = (*homes)[0].accessories[0].services[0].characteristics[0].metadata;
  EXPECT_TRUE(metadata->units);
  EXPECT_FALSE(metadata->format);
}

TEST(ReadHomeDocumentTest, RefusesPartsOfAbsurdSize) {
  std::string numbers = "0";
  for (int i = 0; i < 250'001; ++i) numbers += ",0";
  EXPECT_THAT(problemOf(home("\"x\": [" + numbers + "]")),
              HasSubstr(": an array has at most 250000 elements"));
}

TEST(ReadHomeDocumentTest, SharesTextsThatRepeat) {
  const auto homes = read(home(R"("accessories": [{"uuid": "#1", "name": "", "services": [
    {"instanceID": 1, "serviceType": "light"}, {"instanceID": 2, "serviceType": "light"}]}])"));
  ASSERT_TRUE(homes);
  const auto& services = (*homes)[0].accessories[0].services;
  EXPECT_EQ(services[0].serviceType.view().data(), services[1].serviceType.view().data());
}

TEST(HomeDocumentEventsTest, PutHomesIntoTheList) {
  const std::string text = documentOf(RandomHome(3).homes());
  std::vector<HomeData> homes;
  readJson(text, *makeHomeDocumentEvents(homes));
  EXPECT_EQ(documentOf(homes), text);
}

TEST(WriteHomeDocumentTest, LeavesDefaultsOut) {
  const auto homes = read(home(R"("primary": false, "rooms": [], "faults": {}, "accessories": [
    {"uuid": "#1", "name": "Lamp", "reachable": true, "requiresUnlock": false, "services": [
      {"instanceID": 8, "serviceType": "s", "name": null, "characteristics": [
        {"instanceID": 9, "characteristicType": "c", "properties": [], "value": 1,
         "deviceValue": 1, "metadata": {}}]}]}])"));
  ASSERT_TRUE(homes);
  EXPECT_EQ(documentOf(*homes), expanded(R"({"format": "nidus-home/1",
  "homes": [
    {"uuid": "#0", "name": "Flat",
      "accessories": [
        {"uuid": "#1", "name": "Lamp",
          "services": [
            {"instanceID": 8, "serviceType": "s",
              "characteristics": [
                {"instanceID": 9, "characteristicType": "c", "value": 1, "metadata": {}}
              ]}
          ]}
      ]}
  ]}
)"));
}

TEST(WriteHomeDocumentTest, WritesDeviceValueOfAnotherKind) {
  struct CaseOfValues {
    const char* members;
    const char* written;
  };
  const CaseOfValues cases[] = {
      {R"(, "value": 1, "deviceValue": true)", R"("value": 1, "deviceValue": true})"},
      {R"(, "value": 1, "deviceValue": 1.0)", R"("value": 1, "deviceValue": 1.0})"},
      {R"(, "value": 0.0, "deviceValue": -0.0)", R"("value": 0.0, "deviceValue": -0.0})"},
      {R"(, "value": "1", "deviceValue": 1)", R"("value": "1", "deviceValue": 1})"},
      {R"(, "value": "a", "deviceValue": "a")", R"("value": "a"})"},
  };
  for (const auto& [members, expected] : cases) {
    const auto homes = read(characteristic(members));
    ASSERT_TRUE(homes);
    EXPECT_THAT(documentOf(*homes), HasSubstr(expected));
  }
}

TEST(WriteHomeDocumentTest, WritesOneLineWithoutIndentation) {
  std::ostringstream out;
  writeHomeDocument(out, {}, false);
  EXPECT_EQ(out.str(), R"({"format": "nidus-home/1", "homes": []})");
}

TEST(WriteHomeDocumentTest, RoundTripsRandomDocuments) {
  for (unsigned seed = 0; seed < 500; ++seed) {
    const std::string text = documentOf(RandomHome(seed).homes());
    const auto homes = read(text);
    ASSERT_TRUE(homes) << seed << ": " << homes.failure().message;
    ASSERT_EQ(documentOf(*homes), text) << seed;
  }
}

}  // namespace
}  // namespace nidus
